#include "views/SplitWindow.h"

#include "foundation/DateText.h"
#include "foundation/NumberText.h"
#include "market/Company.h"
#include "market/NoteCompanyEvent.h"
#include "platform/Box.h"
#include "platform/Button.h"
#include "platform/CheckBox.h"
#include "platform/StringView.h"
#include "portfolio/Account.h"
#include "views/Look.h"
#include "views/ModelText.h"
#include "views/PageView.h"

#include <algorithm>

using namespace look;

namespace {

constexpr uint32 kApplyPressed = 'Appl';
constexpr uint32 kQuotesTicked = 'SpQu';
constexpr float kWidth = 720;
constexpr float kTextLine = 18;
constexpr float kButtonWidth = 96;

std::string plural(unsigned n, const char* what)
{
    return countText(static_cast<int>(n)) + ' ' + what + (n == 1 ? "" : "s");
}

std::string headline(const SplitPlan& plan)
{
    const Company& company = *plan.company();
    return textOf(company.getAbbreviation()) + "  " + textOf(company.getName()) + ":  " +
           plural(static_cast<unsigned>(plan.from()), "share") + (plan.from() == 1 ? " becomes " : " become ") +
           std::to_string(plan.to()) + " on " + dateText(plan.day());
}

/// What the fractions come to, and where it goes.
std::string settlementText(const SplitPlan& plan)
{
    const auto& holdings = plan.holdings();
    const auto settled = std::ranges::find_if(holdings, [](const auto& holding) { return holding.fraction != 0; });
    if (settled == holdings.end())
        return "No fraction of a share is left over. The balances of the accounts stay as they are.";
    return fractionText(static_cast<int>(settled->fraction), plan.from()) +
           " of a share is paid out: a sale of 1 share on that day, at " + priceText(settled->saleQuote) + ", brings " +
           amountText(settled->paidOut) + ' ' + textOf(plan.company()->getCurrencyRepresentation()) +
           ", rate cost paid, to " + textOf(settled->account->getName()) + '.';
}

/// As many rows as there are, within what a small screen has room for.
float tradesHeight(const SplitPlan& plan)
{
    constexpr std::size_t kFewest = 3, kMost = 8;
    const auto rows = static_cast<float>(std::clamp(plan.trades() + plan.holdings().size(), kFewest, kMost));
    return kBoxTop + kHeadingHeight + rows * kListRow + 2 + kBoxSide;
}

float valueHeight(const SplitPlan& plan)
{
    constexpr std::size_t kMost = 2; // more holdings of one company have come from a strange file
    const auto rows = static_cast<float>(2 * std::min(plan.holdings().size(), kMost));
    return kBoxTop + kHeadingHeight + rows * kListRow + 2 + kGap + kTextLine + kBoxSide;
}

BRect frameFor(BPoint middle, const SplitPlan& plan)
{
    const auto warnings = static_cast<float>(splitWarnings(plan).size());
    const float trades = plan.holdings().empty() ? kTextLine : tradesHeight(plan) + kMargin + valueHeight(plan);
    const float height = kMargin + kFieldHeight + warnings * kTextLine + kGap + kFieldHeight + kMargin + trades +
                         kMargin + kButtonHeight + kMargin;
    return {middle.x - kWidth / 2, middle.y, middle.x + kWidth / 2, middle.y + height};
}

/// A line of text in `frame`.
BStringView* addLine(BView* parent, BRect frame, const char* name, const std::string& text, rgb_color color = kText)
{
    auto* line = new BStringView(frame, name, text.c_str());
    line->SetHighColor(color);
    line->SetToolTip(text.c_str()); // a name can be longer than the line
    parent->AddChild(line);         // which owns it
    return line;
}

} // namespace

std::vector<std::string> splitWarnings(const SplitPlan& plan)
{
    std::vector<std::string> warnings;
    if (const NoteCompanyEvent* note = plan.appliedNote())
        warnings.push_back("Applied before: the note \"" + textOf(note->getTitle()) + "\" of that day says so (" +
                           textOf(note->getText()) + ").");
    if (plan.looksSplit())
        warnings.push_back("The quotes look split already: " + priceText(plan.lastQuote()) + " on " +
                           dateText(plan.lastQuoteDay()) + ", " + priceText(plan.nextQuote()) + " on " +
                           dateText(plan.nextQuoteDay()) + ". If they are, take the tick off.");
    if (plan.hasSimulatedSales())
        warnings.push_back("Simulated sales of this company go: they are in old shares.");
    return warnings;
}

SplitWindow::SplitWindow(BPoint middle, const SplitPlan& split, const SplitPlan& kept, const BMessenger& target)
    : BWindow(frameFor(middle, split), "Apply Split", B_MODAL_WINDOW, B_NOT_RESIZABLE), split_(split), kept_(kept),
      target_(target)
{
    auto* panel = panel_ = new PageView(Bounds(), "SplitView");
    AddChild(panel);
    BRect area = Bounds().InsetByCopy(kMargin, kMargin); // what is left, from above
    addLine(panel, {area.left, area.top, area.right, area.top + kFieldHeight}, "txtSplit", headline(split_))
        ->SetFont(be_bold_font, B_FONT_FAMILY_AND_STYLE);
    area.top += kFieldHeight;
    const std::vector<std::string> warnings = splitWarnings(split_);
    for (const std::string& warning : warnings) {
        addLine(panel, {area.left, area.top, area.right, area.top + kTextLine}, "txtWarning", warning, kWarning);
        area.top += kTextLine;
    }
    area.top += kGap;
    makeQuotes(panel, {area.left, area.top, area.right, area.top + kFieldHeight});
    area.top += kFieldHeight + kMargin;
    makeTrades(panel, area);
    makeButtons(panel, {area.left, area.bottom - kButtonHeight, area.right, area.bottom});
    // Enter, pressed without reading, does nothing that was warned of.
    (warnings.empty() ? apply_ : cancel_)->MakeFocus();
    showPlan();
}

void SplitWindow::makeQuotes(BView* panel, BRect area)
{
    const bool areThere = split_.quotes() > 0;
    const std::string label = areThere ? "Split the " + plural(split_.quotes(), "quote") + " before that day, from " +
                                             dateText(split_.firstQuoteDay()) + " on"
                                       : "There are no quotes before that day";
    constexpr float kSample = 300;
    quotes_ = PageView::addCheckBox(panel, {area.left, area.top, area.right - kSample, area.bottom}, "cbxSplitQuotes",
                                    label.c_str(), kQuotesTicked);
    quotes_->SetValue(areThere ? B_CONTROL_ON : B_CONTROL_OFF);
    quotes_->SetEnabled(areThere);
    sample_ = addLine(panel, {area.right - kSample, area.top, area.right, area.bottom}, "txtQuoteSample", "");
    sample_->SetAlignment(B_ALIGN_RIGHT);
}

void SplitWindow::makeTrades(BView* panel, BRect area)
{
    if (split_.holdings().empty()) {
        addLine(panel, {area.left, area.top, area.right, area.top + kTextLine}, "txtNoTrades",
                "There are no purchases or sales before that day in the open portfolio.");
        return;
    }
    const float end = area.top + tradesHeight(split_);
    BBox* box = PageView::addBox(panel, {area.left, area.top, area.right, end}, "Purchases and Sales before that Day");
    trades_ = new SplitTradeListView("lstSplitTrades");
    trades_->addTo(box, {kBoxSide, kBoxTop, area.Width() - kBoxSide, end - area.top - kBoxSide}, box->Label());

    const float height = valueHeight(split_);
    valueBox_ = PageView::addBox(panel, {area.left, end + kMargin, area.right, end + kMargin + height}, "Value");
    holdings_ = new SplitHoldingListView("lstSplitHoldings");
    const float lineTop = height - kBoxSide - kTextLine;
    holdings_->addTo(valueBox_, {kBoxSide, kBoxTop, area.Width() - kBoxSide, lineTop - kGap}, "Value");
    settlement_ =
        addLine(valueBox_, {kBoxSide, lineTop, area.Width() - kBoxSide, lineTop + kTextLine}, "txtSettlement", "");
}

void SplitWindow::makeButtons(BView* panel, BRect area)
{
    area.left = area.right - 2 * kButtonWidth - kGap;
    PageView::addButtons(panel, area,
                         {{"btnApply", "Apply", kApplyPressed}, {"btnCancel", "Cancel", B_QUIT_REQUESTED}});
    apply_ = static_cast<BButton*>(panel->FindView("btnApply"));
    cancel_ = static_cast<BButton*>(panel->FindView("btnCancel"));
}

bool SplitWindow::areQuotesSplit() const
{
    return quotes_->Value() == B_CONTROL_ON;
}

void SplitWindow::showPlan()
{
    const SplitPlan& plan = areQuotesSplit() ? split_ : kept_;
    const auto put = [](BStringView& line, const std::string& text) {
        line.SetText(text.c_str());
        line.SetToolTip(text.c_str());
    };
    const std::string last = dateText(plan.lastQuoteDay()) + ":  " + priceText(plan.lastQuote());
    if (plan.quotes() > 0)
        put(*sample_, areQuotesSplit() ? last + " becomes " + priceText(plan.priceAfter()) : last + " stays");
    apply_->SetEnabled(!plan.isEmpty());
    if (trades_ == nullptr)
        return;
    trades_->show(plan);
    holdings_->show(plan);
    valueBox_->SetLabel(("Holding and Value at the Price of " + dateText(plan.priceDay()) + ", in " +
                         textOf(plan.company()->getCurrencyRepresentation()))
                            .c_str());
    put(*settlement_, settlementText(plan));
}

void SplitWindow::GiveWay(float, float height)
{
    if (height < Bounds().Height())
        ResizeTo(kWidth, panel_->shrinkTo(height));
}

void SplitWindow::MessageReceived(BMessage* message)
{
    switch (message->what) {
    case kQuotesTicked:
        showPlan();
        break;
    case kApplyPressed: {
        BMessage applied(kApplied);
        applied.AddInt32("quotes", areQuotesSplit() ? 1 : 0);
        target_.SendMessage(&applied);
        askToClose();
        break;
    }
    default:
        BWindow::MessageReceived(message);
    }
}
