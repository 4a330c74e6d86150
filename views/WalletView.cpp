#include "views/WalletView.h"

#include "foundation/DateText.h"
#include "foundation/NumberText.h"
#include "market/Currency.h"
#include "platform/Box.h"
#include "platform/Button.h"
#include "platform/SearchControl.h"
#include "platform/StringView.h"
#include "valuation/Evolution.h"
#include "valuation/QuoteCoverage.h"
#include "valuation/Returns.h"
#include "valuation/State.h"
#include "valuation/Totals.h"
#include "views/EvolutionChart.h"
#include "views/Look.h"
#include "views/ModelText.h"

#include <cmath>

namespace {

using namespace look;

// Where the groups of the page begin and end.
constexpr float kRight = kPageWidth - kMargin;
constexpr float kTopEnd = kMargin + kButtonHeight;
constexpr float kFileEnd = kTopEnd + 22;
constexpr float kTotalsTop = kFileEnd;
constexpr float kReturnsTop = kTotalsTop + kBoxTop + 2 + kFieldHeight; // below the totals
constexpr float kTotalsEnd = kReturnsTop + 18;
constexpr float kAccountsTop = kTotalsTop + 62;
constexpr float kAccountsEnd = kAccountsTop + 148;
constexpr float kHoldingsTop = kAccountsEnd + kMargin;
constexpr float kHoldingsEnd = kHoldingsTop + 210;
constexpr float kChartTop = kHoldingsEnd + kMargin;

/// " 7.51 %", or in a few words why there is none.
std::string returnText(const AnnualReturn& annual)
{
    return annual.isKnown() ? ' ' + percentText(annual.rate) : std::string(": ") + annual.reason();
}

/// Sets a line that ends at `right`. @return where it begins.
float place(BStringView& line, const std::string& text, bool isFaint, float right)
{
    line.SetText(text.c_str());
    line.SetHighColor(isFaint ? kFaint : kText);
    const float width = std::ceil(line.StringWidth(text.c_str()));
    line.MoveTo(right - width, line.Frame().top);
    line.ResizeTo(width, 16);
    return right - width;
}

} // namespace

WalletView::WalletView(BRect frame, const char* name, BWindow*) : PageView(frame, name)
{
    makeTop();
    makeTotals();
    makeCoverage();
    makeReturns();
    makeAccounts();
    makeHoldings();
    makeChart();
}

WalletView::~WalletView() = default;

void WalletView::makeTop()
{
    date_ =
        addDate(this, {kMargin, kMargin + 1, kMargin + 144, kMargin + 1 + kFieldHeight}, "txtDate", "Date", 'WTDa', 38);
    computeEvolution_ = addCheckBox(this, {kMargin + 156, kMargin + 1, kMargin + 308, kMargin + 1 + kFieldHeight},
                                    "cbxComputeEvolution", "Compute Evolution", 'WCCe');
    constexpr float kButtonWidth = 110;
    addButtons(this, {kRight - 4 * kButtonWidth - 3 * kGap, kMargin, kRight, kTopEnd},
               {{"btnLoadPortoFolio", "Load from File", 'WBLd'},
                {"btnSavePortoFolio", "Save to File", 'WBSv'},
                {"btnReinitPortoFolio", "Reinit", 'WBRe'},
                {"btnUpdateAllQuotes", "Update Quotes", 'WBUp'}});
    addOpenFile(this, {kMargin, kTopEnd, kRight, kTopEnd + 18});
    explain(*this, {{"txtDate", "The day to value at.  Up and Down: a day on and back; Page Up and Page Down: a month"},
                    {"cbxComputeEvolution",
                     "Draws the value of every day since the first operation, and gives the time-weighted return"},
                    {"btnLoadPortoFolio", "Loads the portfolio from a file.  Ctrl+O"},
                    {"btnSavePortoFolio", "Saves the portfolio to a file.  Ctrl+S"},
                    {"btnReinitPortoFolio", "Begins an empty portfolio. Asks nothing; Undo brings the former one back"},
                    {"btnUpdateAllQuotes", "Fetches the latest quote of every company that is or was held"}});
}

void WalletView::makeTotals()
{
    totalsBox_ = addBox(this, {kMargin, kTotalsTop, kRight, kTotalsEnd}, "Totals");
    // They stand side by side, each with the room that its label needs.
    constexpr float kAmount = 124; // room for millions
    constexpr float kPercent = 70;
    float left = kBoxSide;
    const auto add = [&](const char* name, const char* label, uint32 code, float labelWidth, float valueWidth) {
        const BRect frame(left, kBoxTop + 2, left + labelWidth + valueWidth, kBoxTop + 2 + kFieldHeight);
        BTextControl* field = addNumber(totalsBox_, frame, name, label, code, labelWidth);
        field->SetEditable(false);
        left = frame.right + kMargin;
        return field;
    };
    totalDeposit_ = add("txtTotalDeposit", "Total Deposit", 'WTTd', 84, kAmount);
    totalValue_ = add("txtTotalValue", "Total Value", 'WTTv', 74, kAmount);
    profit_ = add("txtProfit", "Profit", 'WTPr', 42, kAmount);
    annualRevenue_ = add("txtAnnualRevenu", "Annual Revenu", 'WTAr', 96, kPercent);
}

/// On the upper edge of the totals' box, as its title.
void WalletView::makeCoverage()
{
    constexpr float kTop = kTotalsTop - 2;
    AddChild(coverage_ = new BStringView({kMargin, kTop, kRight, kTop + 18}, "txtEstimated", ""));
    coverage_->SetViewColor(kGenerated);
    coverage_->SetAlignment(B_ALIGN_CENTER);
    constexpr float kWidth = 72;
    constexpr float kButtonRight = kRight - kBoxSide;
    goToLastQuotes_ =
        addButton(this, {kButtonRight - kWidth, kTop, kButtonRight, kTop + 18}, "btnLastQuotes", "Go There", 'WBGd');
    goToLastQuotes_->SetToolTip("Values the portfolio on the last day with all quotes");
    hideCoverage();
}

/// In the box of the totals, below "Annual Revenu".
void WalletView::makeReturns()
{
    const auto add = [this](const char* name, const char* tip) {
        auto* line = new BStringView({kMargin, kReturnsTop, kRight, kReturnsTop + 16}, name, "");
        line->SetToolTip(tip);
        AddChild(line);
        return line;
    };
    returnRange_ =
        add("txtReturnRange", "The days that the two returns are of: those that the chart shows, or else all\n"
                              "since the first operation. Both are per year, with interest on interest.");
    moneyWeighted_ = add("txtMoneyWeighted",
                         "The interest rate at which an account, with your deposits and withdrawals on their days,\n"
                         "would have come to the same value: what your money earned. Spreadsheets call it XIRR.");
    timeWeighted_ = add("txtTimeWeighted",
                        "The growth from day to day, multiplied, whenever you paid in how much: what your choice of\n"
                        "shares earned, to be compared with funds. It needs the value of every day.");
}

void WalletView::makeAccounts()
{
    BBox* box = addBox(this, {kMargin, kAccountsTop, kRight, kAccountsEnd}, "Accounts");
    const float bottom = kAccountsEnd - kAccountsTop - kBoxSide;
    constexpr float kListEnd = kBoxSide + 440;
    accounts_ = new AccountStateListView("lstAccounts");
    accounts_->addTo(box, {kBoxSide, kBoxTop, kListEnd, bottom}, "Accounts");
    accounts_->SetSelectionMessage(new BMessage('Acsl'));
    accounts_->setHint(
        "No account yet. Type a name and a currency's symbol, and press Add. Currencies are added on the "
        "page Currency (Alt+2).");

    constexpr float kLeft = kListEnd + 2 * kMargin;
    const float right = kRight - kMargin - kBoxSide;
    constexpr float kDivider = 62;
    float top = kBoxTop;
    accountName_ = addField(box, {kLeft, top, right, top + kFieldHeight}, "txtAccountName", "Name", 'WTAn', kDivider);
    top += kRow;
    accountCurrency_ =
        addField(box, {kLeft, top, right, top + kFieldHeight}, "txtAccountCurrency", "Currency", 'WTAc', kDivider);
    top += kRow;
    defaultTransferAccount_ = addCheckBox(box, {kLeft, top, right, top + kFieldHeight}, "cbxDefaultTransferAccount",
                                          "Default Transfer Account for this currency", 'WCDt');
    defaultTransferAccount_->SetToolTip("Gets a part of the gain of simulated sales in its currency");
    // The last two bear the names of the quote buttons of other pages. Intended: controls are found by these names.
    addButtons(
        box, {kLeft, bottom - kButtonHeight, right, bottom},
        {{"btnAddAccount", "Add", 'WBAa'}, {"btnUpdateQuote", "Update", 'WBUa'}, {"btnRemoveQuote", "Remove", 'WBRa'}});
}

void WalletView::makeHoldings()
{
    holdingsBox_ = addBox(this, {kMargin, kHoldingsTop, kRight, kHoldingsEnd}, "Holdings");
    holdingsHeight_ = kHoldingsEnd - kHoldingsTop;
    shares_ = new ShareStateListView("lstShares");
    shares_->addTo(holdingsBox_,
                   {kBoxSide, kBoxTop, kRight - kMargin - kBoxSide, kHoldingsEnd - kHoldingsTop - kBoxSide},
                   "Holdings");
    shares_->setHint("What is held on the day will stand here. Money is paid in, and shares are bought, on the page "
                     "Operations (Alt+4).");
    // On the upper edge of the box: the list has the room below it.
    constexpr float kWidth = 220;
    constexpr float kFilterTop = kHoldingsTop - 4;
    filter_ = new BSearchControl({kRight - kBoxSide - kWidth, kFilterTop, kRight - kBoxSide, kFilterTop + 20},
                                 "txtFilter", "Filter", "any words or amounts");
    filter_->SetDivider(44);
    filter_->SetAlignment(B_ALIGN_RIGHT, B_ALIGN_LEFT);
    filter_->SetToolTip("Shows holdings with all of these words.  Ctrl+F; Escape shows all again");
    filter_->SetHooks(
        [this] {
            shares_->setFilter(filter_->Text());
            tellFiltered();
        },
        [this] { shares_->MakeFocus(); });
    AddChild(filter_);
}

void WalletView::tellFiltered()
{
    const int shown = shares_->CountItems();
    const int all = shares_->CountRows();
    std::string title = "Holdings";
    if (shown < all)
        title += " - " + countText(shown) + " of " + countText(all) + " shown";
    holdingsBox_->SetLabel(title.c_str());
}

void WalletView::showChart(bool isShown)
{
    // The holdings have the room of a chart that is not asked for.
    const BRect box = holdingsBox_->Frame(), list = shares_->Frame();
    const float height = isShown ? holdingsHeight_ : evolution_->Frame().bottom - box.top;
    holdingsBox_->ResizeTo(box.Width(), height);
    shares_->ResizeTo(list.Width(), list.Height() + height - box.Height());
    if (isShown)
        evolution_->Show();
    else
        evolution_->Hide();
}

void WalletView::Shrunk()
{
    holdingsHeight_ = holdingsBox_->Frame().Height();
    showChart(isComputeEvolution());
}

void WalletView::makeChart()
{
    evolution_ = new EvolutionChart({kMargin, kChartTop, kRight, kPageHeight - kMargin});
    // The chart draws its own notice when it is empty; this one says why it is.
    const BRect reasonPlace(10, 30, 700, 50); // below the chart's own "No data"
    noEvolution_ = new BStringView(reasonPlace, "txtNoEvolution", "");
    evolution_->AddChild(noEvolution_);
    AddChild(evolution_);
    showChart(false);
}

void WalletView::SetState(const State* state, const Totals& totals, const std::vector<HoldingFigures>& figures)
{
    // Before: the lists are empty or show states that are still alive. After: they show those of `state`, and what
    // `ClearState` has kept in mind is selected.
    SetAccountStateList(state);
    shares_->clear();
    hideCoverage();
    hideReturns();
    if (state != nullptr) {
        shares_->showColumn(ShareStateItem::kEndDate, state->isAutomatic());
        shares_->addAllOf(*state, totals, figures);
        // When the rows are there. They are found again by account and share, since all states are new.
        accounts_->recall();
        shares_->recall();
    }
    tellFiltered();
    showTotals(totals);
}

void WalletView::showCoverage(const Date& day, const QuoteCoverage& quotes, const QuoteCoverage& rates)
{
    // Where no quote is missing a rate may be: these are fetched from nowhere.
    const std::string ofQuotes = coverageText(quotes, "quotes", day);
    const std::string ofRates = coverageText(rates, "rates", day);
    const std::string text = estimateText(quotes, rates, day);
    if (text.empty())
        return hideCoverage();
    lastQuotedDay_ = ofQuotes.empty() ? rates.lastFullDay : quotes.lastFullDay;
    const bool isDay = !lastQuotedDay_.isUndefined();
    coverage_->SetText(text.c_str());
    coverage_->SetToolTip((ofRates.empty() || ofQuotes.empty() ? "" : "Also, " + ofRates + ".").c_str());
    const float right = kRight - kBoxSide - (isDay ? 72 + kGap : 0);
    const float width = coverage_->StringWidth(text.c_str()) + 2 * kGap;
    coverage_->MoveTo(right - width, coverage_->Frame().top);
    coverage_->ResizeTo(width, 18);
    coverage_->Show();
    if (isDay)
        goToLastQuotes_->Show();
    else
        goToLastQuotes_->Hide();
}

void WalletView::showReturns(const Returns& returns, const Date& first, const Date& last, bool hasDays)
{
    constexpr float kApart = 18;
    const AnnualReturn& time = returns.timeWeighted;
    const bool isToTick = !hasDays && time.kind != AnnualReturn::Kind::kNoDay;
    const std::string why = isToTick ? ": tick Compute Evolution" : returnText(time);
    float left = place(*timeWeighted_, "Time-weighted return" + why, !time.isKnown(), kRight - kBoxSide - 4);
    left = place(*moneyWeighted_, "Money-weighted return" + returnText(returns.moneyWeighted),
                 !returns.moneyWeighted.isKnown(), left - kApart);
    const std::string range = "From " + dateText(first) + " to " + dateText(last) + ", per year:";
    // A gain of a few days can have a dozen digits within a year.
    const bool isRoom = left - kApart - returnRange_->StringWidth(range.c_str()) > kMargin;
    const bool isRange = returns.moneyWeighted.kind != AnnualReturn::Kind::kNoDay;
    place(*returnRange_, isRoom && isRange ? range : "", false, left - kApart);
}

void WalletView::hideReturns()
{
    for (BStringView* line : {returnRange_, moneyWeighted_, timeWeighted_})
        line->SetText("");
}

std::pair<Date, Date> WalletView::daysInView() const
{
    return evolution_->daysInView();
}

void WalletView::setRangeHook(const std::function<void()>& hook)
{
    evolution_->setRangeHook(hook);
}

void WalletView::hideCoverage()
{
    lastQuotedDay_ = Date();
    coverage_->SetText("");
    coverage_->Hide();
    goToLastQuotes_->Hide();
}

void WalletView::ClearState()
{
    // The rows look into states that are about to be destroyed, so they go first; what was selected is kept by account
    // and share, which stay.
    accounts_->remember();
    shares_->remember();
    accounts_->clear();
    shares_->clear();
    showTotals({});
    hideCoverage();
    hideReturns();
}

void WalletView::ForgetSelection()
{
    accounts_->forget();
    shares_->forget();
}

void WalletView::showTotals(const Totals& totals)
{
    if (!totals.isKnown) {
        totalsBox_->SetLabel("Totals");
        for (BTextControl* field : {totalDeposit_, totalValue_, profit_, annualRevenue_})
            field->SetText("");
        return;
    }
    const std::string symbol = textOf(totals.reference->getRepresentation());
    const bool hasRate = totals.reference->getNbrQuotes() > 0;
    // Where the reference has no rate, all values are 0, which would look like a loss of everything.
    totalsBox_->SetLabel(hasRate ? "Totals" : ("Totals: " + symbol + " has no rate, so nothing has a value").c_str());
    const auto show = [&](BTextControl* field, float amount) {
        field->SetText((amountText(amount) + ' ' + symbol).c_str());
    };
    show(totalDeposit_, totals.totalDeposit);
    show(totalValue_, totals.totalValue);
    show(profit_, totals.profit);
    annualRevenue_->SetText(percentText(totals.annualRevenue).c_str());
}

void WalletView::UpdateEvolution(const std::vector<EvolutionPoint>& points, const Currency* reference,
                                 EvolutionOutcome outcome)
{
    ClearEvolution();
    evolution_->setHint(outcome == EvolutionOutcome::kBuilt
                            ? "The value of each day since the first operation will be drawn here."
                            : "");
    evolution_->showPoints(points, reference != nullptr ? textOf(reference->getRepresentation()) : "???");
    // What is too long to be drawn, or has no beginning, is said in the chart; there it is looked for.
    if (outcome != EvolutionOutcome::kBuilt)
        noEvolution_->SetText(outcome == EvolutionOutcome::kTooLong
                                  ? "The evolution would be too long: is the date of an operation mistyped?"
                                  : "The first operation has no real date.");
}

void WalletView::ClearEvolution()
{
    evolution_->showNothing();
    noEvolution_->SetText("");
    showChart(isComputeEvolution());
}

void WalletView::SetAccountStateList(const State* state)
{
    accounts_->clear();
    if (state == nullptr)
        return;
    const auto accounts = state->accountStates();
    accounts_->addAll({accounts.begin(), accounts.end()});
}

AccountState* WalletView::GetSelectedAccountState() const
{
    return accounts_->selected();
}

std::pair<ListPlaces, ListPlaces> WalletView::selections() const
{
    return {accounts_->selection(), shares_->selection()};
}

void WalletView::restoreSelections(const std::pair<ListPlaces, ListPlaces>& selections)
{
    accounts_->restoreSelection(selections.first);
    shares_->restoreSelection(selections.second);
}
