#include "report/ReportWindow.h"

#include "platform/Button.h"
#include "platform/MenuField.h"
#include "platform/Message.h"
#include "platform/PaperView.h"
#include "platform/PopUpMenu.h"
#include "platform/StringView.h"
#include "report/PortfolioReport.h"
#include "views/Look.h"
#include "views/PageView.h"

using namespace look;

namespace {

constexpr uint32 kChanged = 'TRpC';
constexpr uint32 kSavePressed = 'TRpP';
constexpr uint32 kPrintPressed = 'TRpD';
constexpr float kWidth = 760;
constexpr float kHeight = 740;

BMenuField* addMenu(BView* panel, BRect frame, const char* name, const char* label,
                    const std::vector<std::string>& items, int32 marked)
{
    auto* menu = new BPopUpMenu(name);
    for (const std::string& item : items)
        menu->AddItem(new BMenuItem(item.c_str(), new BMessage(kChanged)));
    if (BMenuItem* item = menu->ItemAt(marked))
        item->SetMarked(true);
    auto* field = new BMenuField(frame, name, label, menu);
    field->SetDivider(field->StringWidth(label) + kGap);
    panel->AddChild(field); // which owns it
    return field;
}

BFilePanel makePanel(ReportWindow& window)
{
    const BMessenger target(&window);
    return BFilePanel(B_SAVE_PANEL, &target, nullptr, B_FILE_NODE, new BMessage(ReportWindow::kPlaced), true);
}

int32 markedIn(const BMenuField& field)
{
    return field.Menu()->IndexOf(field.Menu()->FindMarked());
}

} // namespace

ReportWindow::ReportWindow(BPoint middle, std::shared_ptr<const PortfolioReport> report, const std::string& fileName,
                           const std::string& folder, const BMessenger& target)
    : BWindow({middle.x - kWidth / 2, middle.y, middle.x + kWidth / 2, middle.y + kHeight}, "Report", B_MODAL_WINDOW,
              0),
      report_(std::move(report)), fileName_(fileName), target_(target), savePanel_(makePanel(*this))
{
    savePanel_.SetTitle("Save as PDF");
    if (!folder.empty())
        savePanel_.SetPanelDirectory(folder.c_str());
    auto* panel = new PageView(Bounds(), "ReportView"); // the window owns it
    AddChild(panel);
    const BRect area = Bounds().InsetByCopy(kMargin, kMargin);
    const float end = area.top + kButtonHeight;
    makeControls(panel, {area.left, area.top, area.right, end});
    told_ = new BStringView({area.left, end, area.right, end + kFieldHeight}, "txtReport", "");
    panel->AddChild(told_);
    paper_ = new PaperView({area.left, end + kFieldHeight, area.right, area.bottom}, "paperPages", B_FOLLOW_ALL_SIDES);
    panel->AddChild(paper_);
    show();
    panel->FindView("btnSavePdf")->MakeFocus();
}

void ReportWindow::makeControls(BView* panel, BRect area)
{
    constexpr float kButtonWidth = 104, kYearWidth = 176, kPaperWidth = 132;
    std::vector<std::string> years;
    for (const int year : report_->years())
        years.push_back(std::to_string(year));
    years.emplace_back("All");
    const BRect menu(area.left, area.top, area.left + kYearWidth, area.bottom);
    year_ = addMenu(panel, menu, "reportYear", "Operations of", years, 0);
    const bool isLetter = usualPaperSize() == PaperSize::kLetter;
    const float left = menu.right + kMargin;
    size_ = addMenu(panel, {left, area.top, left + kPaperWidth, area.bottom}, "reportPaper", "Paper", {"A4", "Letter"},
                    isLetter ? 1 : 0);
    area.left = area.right - 3 * kButtonWidth - 2 * kGap;
    PageView::addButtons(panel, area,
                         {{"btnSavePdf", "Save as PDF...", kSavePressed},
                          {"btnPrint", "Print...", kPrintPressed},
                          {"btnCloseReport", "Close", B_QUIT_REQUESTED}});
}

const PaperDocument& ReportWindow::document() const
{
    return *paper_->Document();
}

void ReportWindow::show()
{
    const int32 item = markedIn(*year_), all = year_->Menu()->CountItems() - 1;
    const auto year = item == all ? std::nullopt : std::optional(report_->years()[static_cast<std::size_t>(item)]);
    paper_->SetDocument(report_->make(year, markedIn(*size_) == 0 ? PaperSize::kA4 : PaperSize::kLetter));
    const int pages = document().CountPages();
    tell(std::to_string(pages) + (pages == 1 ? " page" : " pages"), false);
}

void ReportWindow::tell(const std::string& text, bool isFailure)
{
    told_->SetHighColor(isFailure ? kWarning : kText);
    told_->SetText(text.c_str());
    told_->SetToolTip(text.c_str());
}

void ReportWindow::print()
{
    switch (paper_->Print()) {
    case PaperView::Outcome::kPrinted:
        return tell("Sent to the printer", false);
    case PaperView::Outcome::kFailed:
        return tell("Not printed: the printer has refused the pages", true);
    case PaperView::Outcome::kNoPrinter:
        return tell("There is no printer here. A file that is saved as PDF can be printed elsewhere.", true);
    case PaperView::Outcome::kLeft:
        return; // perhaps with the window
    }
}

void ReportWindow::MessageReceived(BMessage* message)
{
    switch (message->what) {
    case kChanged:
        show();
        // The first pages are the same whatever year was chosen.
        paper_->ShowPage(document().LastPart());
        break;
    case kSavePressed:
        savePanel_.SetSaveText((fileName_ + ".pdf").c_str(), "pdf");
        savePanel_.Show();
        break;
    case kPlaced:
        target_.SendMessage(message);
        break;
    case kPrintPressed:
        print();
        break;
    default:
        BWindow::MessageReceived(message);
    }
}
