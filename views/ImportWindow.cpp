#include "views/ImportWindow.h"

#include "platform/Button.h"
#include "platform/CheckBox.h"
#include "platform/MenuField.h"
#include "platform/MenuItem.h"
#include "platform/Message.h"
#include "platform/PopUpMenu.h"
#include "platform/StringView.h"
#include "platform/TextControl.h"
#include "views/Look.h"
#include "views/PageView.h"
#include "views/SplitLists.h"

#include <algorithm>

using namespace look;

namespace {

constexpr uint32 kImportPressed = 'ImIm';
constexpr uint32 kChosen = 'ImCh';
constexpr uint32 kTyped = 'ImTy';
constexpr uint32 kSkipTicked = 'ImSk';
constexpr float kWidth = 792;
constexpr float kHeight = 560; // shows as a whole on a screen of 600 lines
constexpr float kTextLine = 18;
constexpr float kButtonWidth = 96;
constexpr float kDivider = 148;

/// Rows with texts of their own.
class ImportListView final : public PlainListView {
public:
    using PlainListView::PlainListView;

    void show(ImportSheet::Rows& cells)
    {
        std::vector<ColumnItem*> rows; // the list owns them
        for (auto& row : cells)
            rows.push_back(new PlainRow(std::move(row)));
        showRows(rows);
        settle();
    }
};

BStringView* addLine(BView* parent, BRect frame, const char* name, const std::string& text, rgb_color color)
{
    auto* line = new BStringView(frame, name, text.c_str());
    line->SetHighColor(color);
    line->SetToolTip(text.c_str()); // it can be longer than the line
    parent->AddChild(line);         // which owns it
    return line;
}

const char* nameIn(const BMessage& message)
{
    const char* name = "";
    message.FindString("name", &name);
    return name;
}

} // namespace

ImportWindow::ImportWindow(BPoint middle, const std::shared_ptr<ImportPreview>& preview, ImportSheet first,
                           const BMessenger& target)
    : BWindow({middle.x - kWidth / 2, middle.y, middle.x + kWidth / 2, middle.y + kHeight}, "Import", B_MODAL_WINDOW,
              B_NOT_RESIZABLE),
      preview_(preview), target_(target)
{
    preview_->setProgress([this](const std::string& text) {
        headline_->SetText(text.c_str());
        headline_->Sync();
    });
    const bool isDoubtful = first.hasRefused || !first.problem.empty();
    show(std::move(first));
    // Enter, pressed without reading, imports nothing of which a part is refused.
    panel_->FindView(isDoubtful ? "btnCancel" : "btnImport")->MakeFocus();
}

ImportWindow::~ImportWindow()
{
    preview_->setProgress(nullptr);
}

void ImportWindow::show(ImportSheet sheet)
{
    // All controls are made anew, since each answer may bring or answer other questions; the keyboard stays where it
    // was.
    const BView* focus = CurrentFocus();
    const std::string focused = focus != nullptr ? focus->Name() : "";
    delete panel_;
    ++sheet_;
    const BRect whole(0, 0, kWidth, kHeight); // what of it has no room is given up below
    panel_ = new PageView(whole, "ImportView");
    AddChild(panel_);
    BRect area = whole.InsetByCopy(kMargin, kMargin); // what is left, from above
    area.top = makeLines(area, sheet);
    area.top = makeQuestions(area, sheet);
    BRect buttons = area;
    buttons.top = area.bottom - kButtonHeight;
    area.bottom = buttons.top - kMargin;
    makeLists(area, sheet);
    makeButtons(buttons, sheet);
    if (Bounds().Height() < kHeight)
        GiveWay(kWidth, Bounds().Height());
    if (BView* view = focused.empty() ? nullptr : panel_->FindView(focused.c_str()))
        view->MakeFocus();
}

BMessage ImportWindow::answer(uint32 code, const char* control) const
{
    BMessage message(code);
    message.AddInt32("sheet", sheet_);
    message.AddString("name", control);
    return message;
}

BView* ImportWindow::makeMenu(BRect frame, const ImportSheet::Question& question)
{
    // Filled before a field shows it, which fills itself anew with each change of its menu.
    auto* menu = new BPopUpMenu(question.name);
    for (std::size_t i = 0; i < question.items.size(); ++i) {
        auto* message = new BMessage(answer(kChosen, question.name));
        message->AddInt32("item", static_cast<int32>(i));
        menu->AddItem(new BMenuItem(question.items[i].c_str(), message));
    }
    if (BMenuItem* marked = menu->ItemAt(question.marked))
        marked->SetMarked(true);
    auto* field = new BMenuField(frame, question.name, question.label.c_str(), menu);
    field->SetDivider(kDivider);
    field->SetAlignment(B_ALIGN_RIGHT);
    panel_->AddChild(field);
    return field;
}

BView* ImportWindow::makeField(BRect frame, const ImportSheet::Question& question)
{
    auto* field = new BTextControl(frame, question.name, question.label.c_str(), question.text.c_str(),
                                   new BMessage(answer(kTyped, question.name)));
    field->SetDivider(kDivider);
    field->SetAlignment(B_ALIGN_RIGHT, B_ALIGN_LEFT);
    panel_->AddChild(field);
    return field;
}

float ImportWindow::makeLines(BRect area, const ImportSheet& sheet)
{
    const float middle = area.top + kFieldHeight;
    headline_ = addLine(panel_, {area.left, area.top, area.right, middle}, "txtImport", sheet.headline, kText);
    headline_->SetFont(be_bold_font, B_FONT_FAMILY_AND_STYLE);
    const bool isPossible = sheet.problem.empty();
    addLine(panel_, {area.left, middle, area.right, middle + kTextLine}, "txtImportNote",
            isPossible ? sheet.note : sheet.problem, isPossible ? kText : kWarning);
    return middle + kTextLine + kGap;
}

float ImportWindow::makeQuestions(BRect area, const ImportSheet& sheet)
{
    const float width = (area.Width() - kMargin) / 2;
    float left = area.left;
    float top = area.top - kRow;
    for (const ImportSheet::Question& question : sheet.questions) {
        left = question.isFirst ? area.left : area.left + width + kMargin;
        top += question.isFirst ? kRow : 0;
        const BRect frame(left, top, left + width, top + kFieldHeight);
        BView* control = question.items.empty() ? makeField(frame, question) : makeMenu(frame, question);
        control->SetToolTip(question.toolTip);
    }
    return top + kRow + kGap;
}

void ImportWindow::makeLists(BRect area, ImportSheet& sheet)
{
    constexpr std::size_t kMostAccounts = 4; // that show at once
    if (!sheet.cash.empty()) {
        const auto rows = static_cast<float>(std::min(sheet.cash.size(), kMostAccounts));
        const float height = kBoxTop + kHeadingHeight + rows * kListRow + 2 + kBoxSide;
        BBox* box = PageView::addBox(panel_, {area.left, area.bottom - height, area.right, area.bottom},
                                     sheet.cashTitle.c_str());
        auto* list = new ImportListView("lstImportCash", {{"Account", kRemainingWidth},
                                                          {"Currency", 90},
                                                          {"Before", 140, B_ALIGN_RIGHT},
                                                          {"After", 140, B_ALIGN_RIGHT}});
        list->addTo(box, {kBoxSide, kBoxTop, area.Width() - kBoxSide, height - kBoxSide}, sheet.cashTitle.c_str());
        list->show(sheet.cash);
        area.bottom -= height + kMargin;
    }
    BBox* box = PageView::addBox(panel_, area, sheet.title.c_str());
    auto* list = new ImportListView("lstImport", sheet.columns);
    list->addTo(box, {kBoxSide, kBoxTop, area.Width() - kBoxSide, area.Height() - kBoxSide}, sheet.title.c_str());
    list->show(sheet.rows);
}

void ImportWindow::makeButtons(BRect area, const ImportSheet& sheet)
{
    const float left = area.right - 2 * kButtonWidth - kGap;
    if (sheet.asksToSkip) {
        auto* box = PageView::addCheckBox(panel_, {area.left, area.top, left - kMargin, area.bottom}, "cbxImportOthers",
                                          "Import the other lines when some are refused", kSkipTicked);
        box->SetMessage(new BMessage(answer(kSkipTicked)));
        box->SetValue(sheet.skips ? B_CONTROL_ON : B_CONTROL_OFF);
    }
    area.left = left;
    PageView::addButtons(panel_, area,
                         {{"btnImport", "Import", kImportPressed}, {"btnCancel", "Cancel", B_QUIT_REQUESTED}});
    auto* import = static_cast<BButton*>(panel_->FindView("btnImport"));
    import->SetMessage(new BMessage(answer(kImportPressed)));
    import->SetEnabled(sheet.problem.empty());
    import->SetToolTip(sheet.problem.c_str());
}

void ImportWindow::MessageReceived(BMessage* message)
{
    int32 sheet = 0, item = 0;
    if (message->FindInt32("sheet", &sheet) == B_OK && sheet != sheet_)
        return;
    switch (message->what) {
    case kChosen:
        if (message->FindInt32("item", &item) == B_OK)
            preview_->choose(nameIn(*message), static_cast<std::size_t>(item));
        showAgain();
        break;
    case kTyped:
        if (const auto* field = dynamic_cast<BTextControl*>(panel_->FindView(nameIn(*message)))) {
            preview_->type(field->Name(), field->Text());
            showAgain();
        }
        break;
    case kSkipTicked:
        preview_->setSkips(static_cast<BCheckBox*>(panel_->FindView("cbxImportOthers"))->Value() == B_CONTROL_ON);
        showAgain();
        break;
    case kImportPressed: {
        const BMessage imported(kImported);
        target_.SendMessage(&imported);
        isImported_ = true;
        askToClose();
        break;
    }
    default:
        BWindow::MessageReceived(message);
    }
}

void ImportWindow::GiveWay(float, float height)
{
    if (height < kHeight)
        ResizeTo(kWidth, panel_->shrinkTo(height));
}

bool ImportWindow::QuitRequested()
{
    const BMessage left(kLeft);
    if (!isImported_)
        target_.SendMessage(&left);
    return true;
}
