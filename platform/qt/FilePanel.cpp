#include "platform/FilePanel.h"

#include "platform/DialogAnswers.h"
#include "platform/Entry.h"
#include "platform/Message.h"
#include "platform/View.h"
#include "platform/Window.h"
#include "platform/qt/WindowWidget.h"

#include <QFileDialog>
#include <QFileInfo>
#include <QLineEdit>
#include <QScreen>
#include <QTreeView>

#include <filesystem>

namespace {

class Dialog final : public QFileDialog {
public:
    /// `flavors` is looked at when a choice is made.
    Dialog(QWidget* parent, const uint32& flavors) : QFileDialog(parent), flavors_(flavors) {}

protected:
    void accept() override
    {
        // The dialog would go into a folder that is named; one without a name is the folder that it is in. One that is
        // only selected in the list is gone into.
        const QFileInfo chosen(selectedFiles().value(0));
        const auto* field = findChild<QLineEdit*>("fileNameEdit");
        const bool isNamed =
            field != nullptr && !field->text().isEmpty() && chosen == QFileInfo(directory(), field->text());
        if ((flavors_ & B_DIRECTORY_NODE) != 0 && isNamed && chosen.isDir() &&
            chosen != QFileInfo(directory().absolutePath()))
            QDialog::accept();
        else
            QFileDialog::accept();
    }

private:
    const uint32& flavors_;
};

} // namespace

BFilePanel::BFilePanel(file_panel_mode mode, const BMessenger* target, const entry_ref* start, uint32 nodeFlavors,
                       BMessage* message, bool modal)
    : mode_(mode), target_(target != nullptr ? *target : BMessenger()), title_(mode == B_OPEN_PANEL ? "Load" : "Save"),
      message_(message != nullptr ? message : new BMessage(mode == B_OPEN_PANEL ? B_REFS_RECEIVED : B_SAVE_REQUESTED)),
      flavors_(nodeFlavors), modal_(modal)
{
    BPath path;
    if (start != nullptr && BEntry(start).GetPath(&path) == B_OK)
        SetPanelDirectory(path.Path());
}

BFilePanel::~BFilePanel() = default;

QFileDialog& BFilePanel::dialog()
{
    if (dialog_ != nullptr)
        return *dialog_;
    // A panel belongs to the window that it answers to, which keeps it in front of that.
    auto* window = target_.IsValid() ? dynamic_cast<BWindow*>(target_.Target()->Looper()) : nullptr;
    dialog_ = std::make_unique<Dialog>(window != nullptr ? &window->widget() : nullptr, flavors_);
    dialog_->setObjectName(mode_ == B_OPEN_PANEL ? "OpenPanel" : "SavePanel");
    // The desktop's own panel takes no part in this program's event loop and cannot be found by tests.
    dialog_->setOption(QFileDialog::DontUseNativeDialog);
    dialog_->setAcceptMode(mode_ == B_OPEN_PANEL ? QFileDialog::AcceptOpen : QFileDialog::AcceptSave);
    dialog_->setFileMode(mode_ == B_OPEN_PANEL ? QFileDialog::ExistingFile : QFileDialog::AnyFile);
    dialog_->setModal(modal_);
    // Who types a name fast and presses Enter would leave its list of proposals open behind the panel.
    if (auto* field = dialog_->findChild<QLineEdit*>("fileNameEdit"))
        field->setCompleter(nullptr);
    // The files have no types.
    if (auto* columns = dialog_->findChild<QTreeView*>("treeView"))
        columns->hideColumn(2);
    QObject::connect(dialog_.get(), &QFileDialog::accepted, [this] { accept(); });
    return *dialog_;
}

void BFilePanel::SetPanelDirectory(const char* path)
{
    directory_ = path;
    if (dialog_ != nullptr)
        dialog_->setDirectory(QString::fromUtf8(path));
}

void BFilePanel::SetSaveText(const char* text, const char* ending)
{
    saveText_ = text;
    saveEnding_ = ending;
}

void BFilePanel::Show()
{
    if (const auto& answer = DialogAnswers::current().panel) {
        const std::string path = answer(*this);
        if (!path.empty())
            send(path);
        return;
    }
    // The kit remembers the folder and the dialog does not: from here on it shows what the kit has.
    QFileDialog& shown = dialog();
    shown.setWindowTitle(QString::fromStdString(title_));
    shown.setDirectory(directory_.empty() ? QDir::homePath() : QString::fromStdString(directory_));
    if (mode_ == B_SAVE_PANEL) {
        shown.setDefaultSuffix(QString::fromStdString(saveEnding_));
        // The name of the last time may be that of another file.
        if (auto* field = shown.findChild<QLineEdit*>("fileNameEdit"))
            field->clear();
        shown.selectFile(QString::fromStdString(saveText_));
    }
    shown.resize(shown.size().boundedTo(shown.screen()->availableGeometry().size()));
    shown.show();
    shown.raise();
    shown.activateWindow();
}

void BFilePanel::accept()
{
    // The next time it comes up in the folder where this choice was made.
    directory_ = dialog_->directory().absolutePath().toStdString();
    send(dialog_->selectedFiles().value(0).toStdString());
}

void BFilePanel::send(const std::string& path) const
{
    if (path.empty())
        return;
    // A reference is a folder and a name in it. The folder that a save panel tells is one itself.
    const std::filesystem::path chosen(path);
    const std::filesystem::path folder = chosen.parent_path();
    const entry_ref file{folder.string(), chosen.filename().string()};
    const entry_ref place{folder.parent_path().string(), folder.filename().string()};
    BMessage answer = *message_;
    if (mode_ == B_OPEN_PANEL) {
        answer.AddRef("refs", &file);
    } else {
        answer.AddRef("directory", &place);
        answer.AddString("name", file.name.c_str());
    }
    target_.SendMessage(&answer);
}
