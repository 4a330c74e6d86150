#include "platform/Application.h"

#include "platform/Font.h"
#include "platform/GraphicsDefs.h"
#include "platform/Message.h"
#include "platform/Window.h"
#include "platform/qt/Canvas.h"
#include "platform/qt/EndSignals.h"

#include <QApplication>
#include <QFont>
#include <QLoggingCategory>
#include <QPalette>
#include <QStyle>
#include <QStyleFactory>

#include <clocale>
#include <langinfo.h>

BApplication* be_app = nullptr;

namespace {

// Qt keeps references to these.
int argumentCount = 1;
char programName[] = "pelorin";
char* arguments[] = {programName, nullptr};

QPalette panelColors()
{
    // All that is light or dark on a desktop is set, so that none of it comes from there.
    QPalette palette(toQt(kPanelGrey), toQt(kPanelGrey));
    palette.setColor(QPalette::Base, Qt::white);
    palette.setColor(QPalette::AlternateBase, toQt(kSecondRow));
    palette.setColor(QPalette::Highlight, toQt(kSelection));
    palette.setColor(QPalette::HighlightedText, Qt::white);
    palette.setColor(QPalette::ToolTipBase, toQt(kToolTipGround));
    palette.setColor(QPalette::ToolTipText, Qt::black);
    palette.setColor(QPalette::PlaceholderText, toQt(kFaintGrey));
    palette.setColor(QPalette::Link, toQt(kSelection));
    palette.setColor(QPalette::LinkVisited, toQt(kSelection));
    for (const auto role : {QPalette::WindowText, QPalette::Text, QPalette::ButtonText})
        palette.setColor(QPalette::Disabled, role, toQt(kFaintGrey));
    return palette;
}

/// The same look on every desktop: the measures of the pages hold for this style and font only, and the colours for
/// light grounds.
void setLook()
{
    if (QApplication::style()->objectName() != "fusion")
        QApplication::setStyle(QStyleFactory::create("Fusion"));
    const QPalette colors = panelColors(), shown = QApplication::palette();
    const auto isOther = [&](QPalette::ColorRole role) { return shown.color(role) != colors.color(role); };
    if (isOther(QPalette::Window) || isOther(QPalette::Base) || isOther(QPalette::Text) || isOther(QPalette::Highlight))
        QApplication::setPalette(colors);
    const QFont font = be_plain_font->toQt();
    if (QApplication::font().pixelSize() != font.pixelSize() || QApplication::font().family() != font.family())
        QApplication::setFont(font);
}

/// What a desktop sets for all programs, late in the start or when a person changes it there, does not stay.
class OwnLook final : public QApplication {
public:
    using QApplication::QApplication;

protected:
    bool event(QEvent* event) override
    {
        const bool isDone = QApplication::event(event);
        if (event->type() == QEvent::ApplicationFontChange || event->type() == QEvent::ApplicationPaletteChange)
            QMetaObject::invokeMethod(this, setLook, Qt::QueuedConnection); // whoever changes it has done so
        return isDone;
    }
};

} // namespace

void BApplication::UseNoDisplay()
{
    qputenv("QT_QPA_PLATFORM", "offscreen");
    QLoggingCategory::setFilterRules("default.warning=false"); // that there is no session, which is none's concern
    // In a locale without UTF-8 a line on standard error would tell that another one is taken.
    if (QByteArray(std::setlocale(LC_ALL, "") == nullptr ? "" : nl_langinfo(CODESET)) != "UTF-8")
        qputenv("LC_ALL", "C.UTF-8");
}

BApplication::BApplication(const char* signature) : BLooper(signature), signature_(signature)
{
    // A test program makes the connection to the desktop itself, and several applications on it one after the other.
    if (QCoreApplication::instance() == nullptr) {
        QApplication::setDesktopSettingsAware(false); // neither its colours nor its fonts
        new OwnLook(argumentCount, arguments);        // lives as long as the process
        // It has taken over the desktop's way to write numbers. The program's own has a point, whatever the desktop's.
        std::setlocale(LC_NUMERIC, "C");
        const QString name = QString::fromStdString(signature_.substr(signature_.find_last_of("./") + 1));
        QApplication::setApplicationName(name);
        QApplication::setDesktopFileName(name.toLower());
    }
    QApplication::setPalette(panelColors());
    setLook();
    // The program ends when it is asked to, as the window does when it closes, and not because no window is there:
    // while it starts there is none, either.
    QApplication::setQuitOnLastWindowClosed(false);
    be_app = this;
}

BApplication::~BApplication()
{
    BWindow::closeAll();
    be_app = nullptr;
}

int BApplication::Run()
{
    // At once, and not by the queue: a command that waits for an answer would hold it up, and the desktop does not
    // wait.
    const EndSignals ending([this] {
        BMessage quit(B_QUIT_REQUESTED);
        DispatchMessage(&quit, this);
    });
    const int status = QApplication::exec();
    // `exec` has been left, so no more messages are handled. The windows are not asked again: whoever ended the program
    // has done so.
    BWindow::closeAll();
    return status;
}

void BApplication::Quit()
{
    QCoreApplication::quit();
}

void BApplication::MessageReceived(BMessage* message)
{
    if (message->what == B_QUIT_REQUESTED && QuitRequested())
        Quit();
    else
        BLooper::MessageReceived(message);
}
