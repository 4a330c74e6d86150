#include "views/CompanyView.h"

#include "foundation/NumberText.h"
#include "platform/Box.h"
#include "platform/CheckBox.h"
#include "platform/StringView.h"
#include "views/CompanyFlags.h"
#include "views/Look.h"
#include "views/ModelText.h"

using namespace look;

namespace {

// Where the groups of the page begin and end.
constexpr float kRight = kPageWidth - kMargin;
constexpr float kTopEnd = kMargin + kButtonHeight;
constexpr float kListsTop = kTopEnd + kMargin;
constexpr float kListsEnd = kListsTop + 194;
constexpr float kMarketsEnd = kMargin + 292;
constexpr float kQuotesTop = kListsEnd + kMargin;
constexpr float kQuotesEnd = kQuotesTop + 266;
constexpr float kQuotesRight = kMargin + 414;
constexpr float kChartTop = kQuotesEnd + kMargin;

} // namespace

CompanyView::CompanyView(BRect frame, const char* name, BWindow*) : SeriesPage(frame, name)
{
    addLoadAndSave(this);
    makeMarkets({kMargin, kListsTop, kMarketsEnd, kListsEnd});
    makeCompanies({kMarketsEnd + kMargin, kListsTop, kRight, kListsEnd});
    makeQuotes({kMargin, kQuotesTop, kQuotesRight, kQuotesEnd});
    events_ = new EventBox({kQuotesRight + kMargin, kQuotesTop, kRight, kQuotesEnd});
    AddChild(events_);
    addChart({kMargin, kChartTop, kRight, kPageHeight - kMargin})->setFlagStyles(companyFlagStyles());
}

void CompanyView::makeMarkets(BRect frame)
{
    BBox* box = addBox(this, frame, "Markets");
    const float right = frame.Width() - kBoxSide;
    const float bottom = frame.Height() - kBoxSide;
    const float buttonTop = bottom - kButtonHeight;
    const float fieldTop = buttonTop - kGap - kFieldHeight;
    markets_ = new MarketListView("lstMarkets");
    markets_->addTo(box, {kBoxSide, kBoxTop, right, fieldTop - kGap}, "Markets");
    markets_->SetSelectionMessage(new BMessage('MSel'));
    markets_->setHint("No market yet. A market has a currency: add that first on the page Currency (Alt+2). Then type "
                      "a name and the currency's symbol, and press Add.");
    constexpr float kCurrencyWidth = 112;
    marketName_ = addField(box, {kBoxSide, fieldTop, right - kCurrencyWidth - kGap, fieldTop + kFieldHeight},
                           "txtMarketName", "Name", 'CTMn', 40);
    marketCurrency_ = addField(box, {right - kCurrencyWidth, fieldTop, right, fieldTop + kFieldHeight},
                               "txtMarketCurrencyRepresentation", "Currency", 'CTMc', 62);
    addButtons(box, {kBoxSide, buttonTop, right, bottom},
               {{"btnAddMarket", "Add", 'CBAm'},
                {"btnUpdateMarket", "Update", 'CBUm'},
                {"btnRemoveMarket", "Remove", 'CBRm'}});
}

void CompanyView::makeCompanies(BRect frame)
{
    BBox* box = companiesBox_ = addBox(this, frame, "Companies");
    const float right = frame.Width() - kBoxSide;
    const float bottom = frame.Height() - kBoxSide;
    // The widths of the list's columns.
    constexpr float kListEnd = kBoxSide + 66 + 176 + kScrollBar;
    companies_ = new CompanyListView("lstCompanies");
    companies_->addTo(box, {kBoxSide, kBoxTop, kListEnd, bottom}, "Companies");
    companies_->SetSelectionMessage(new BMessage('CSel'));
    companies_->setHint("The companies of the market that is selected will stand here. Type ticker and name, and press "
                        "Add. \"Import...\" brings many at once, with their prices.");

    constexpr float kLeft = kListEnd + kMargin;
    constexpr float kNarrow = 44;
    constexpr float kWide = 116;
    float top = kBoxTop;
    const auto add = [&](auto make, const char* name, const char* label, uint32 code, float divider) {
        BTextControl* field = make(box, BRect(kLeft, top, right, top + kFieldHeight), name, label, code, divider);
        top += kRow;
        return field;
    };
    abbreviation_ = add(addField, "txtAbbreviation", "Ticker", 'CTCa', kNarrow);
    companyName_ = add(addField, "txtName", "Name", 'CTCn', kNarrow);
    relativeDailyChange_ = add(addNumber, "txtRelativeDailyChange", "Rel. Daily Change", 'CTRe', kWide);
    diffWithAverage_ = add(addNumber, "txtDiffWithAverage", "Diff. with Average", 'CTDi', kWide);
    relativeDailyChange_->SetEditable(false);
    diffWithAverage_->SetEditable(false);
    const float fetchTop = bottom - kButtonHeight;
    const float buttonTop = fetchTop - kGap - kButtonHeight;
    addButtons(box, {kLeft, buttonTop, right, buttonTop + kButtonHeight},
               {{"btnAddCompany", "Add", 'CBAc'},
                {"btnUpdateCompany", "Update", 'CBUc'},
                {"btnRemoveCompany", "Remove", 'CBRc'}});
    addButton(box, {kLeft, fetchTop, right, bottom}, "btnSetLastThreeMonths", "Set Last Three Months", 'CB3M');
    explain(*box,
            {{"txtRelativeDailyChange", "Slope of the trend per day, in proportion to its value on the last day"},
             {"txtDiffWithAverage", "How far the last quote is from the trend, in proportion to it"},
             {"btnUpdateCompany", "Takes over ticker and name, and fetches the latest quote"},
             {"btnSetLastThreeMonths", "Fetches the quotes of three months, on the markets NASDAQ, NYSE and AMEX"}});
}

void CompanyView::makeQuotes(BRect frame)
{
    QuoteBox* box = addQuotes(frame, "Quotes", {'CQSe', 'CTQd', 'CTQv', 'CBAq', 'CBUq', 'CBRq'});
    // Splits and the band are about a company's quotes only: their controls go into what the box leaves free.
    const BRect area = box->freeArea();
    float top = area.top + kMargin;
    auto* title = new BStringView({area.left, top, area.right, top + kFieldHeight}, "", "Split of the selected quotes");
    box->AddChild(title);
    top += kFieldHeight;
    constexpr float kFirst = 44 + 34;
    constexpr float kSecond = 22 + 34;
    splitNumerator_ = addTypedNumber(box, {area.left, top + 1, area.left + kFirst, top + 1 + kFieldHeight},
                                     "txtSplitRangeNum", "Factor", 'CTSp', 44);
    splitDenominator_ =
        addTypedNumber(box, {area.left + kFirst, top + 1, area.left + kFirst + kSecond, top + 1 + kFieldHeight},
                       "txtSplitRangeDenum", "to", 'CTSp', 22);
    addButton(box, {area.left + kFirst + kSecond + kGap, top, area.right, top + kButtonHeight}, "btnSplitQuotes",
              "Split", 'CBSq');
    withSafe_ = addCheckBox(box, {area.left, area.bottom - kFieldHeight, area.right, area.bottom}, "cbWithSafe",
                            "With Safe", 'CCWs');
    explain(*box, {{"btnSplitQuotes", "Multiplies the selected quotes; operations stay as they are"},
                   {"cbWithSafe", "Shades a band of one standard deviation of the quotes about the trend"}});
}

void CompanyView::AddMarket(Market* market, bool selected)
{
    markets_->add(market);
    if (selected)
        markets_->select(market);
}

void CompanyView::DeleteMarket(Market* market)
{
    markets_->remove(market);
    // Its companies go with it, and so do the quotes and events of the one that is selected.
    if (market == shownMarket_)
        SetCompanyList(nullptr);
}

void CompanyView::SetMarketList(const std::vector<Market*>& markets)
{
    // What is selected stays so where it is still there; no message is sent, so the fields keep what is typed in them.
    markets_->setAll(markets);
    // The market whose companies were shown may be gone, and another one at its address.
    SetCompanyList(nullptr);
}

void CompanyView::nameTrend(const String& currency)
{
    const std::string title = "Companies";
    companiesBox_->SetLabel(currency.hasText() ? (title + " - trend of the currency " + textOf(currency)).c_str()
                                               : title.c_str());
}

void CompanyView::setRelativeDailyChange(float change)
{
    relativeDailyChange_->SetText(finePercentText(change).c_str());
}

void CompanyView::setDiffWithAverage(float difference)
{
    diffWithAverage_->SetText(percentText(difference).c_str());
}

void CompanyView::AddCompany(Company* company, bool selected)
{
    markets_->InvalidateItems(); // they count their companies
    // A company without market would otherwise be taken for one of a page that shows none.
    const Market* market = company->market();
    if (market == nullptr || market != shownMarket_)
        return;
    companies_->add(company);
    if (selected)
        companies_->select(company);
}

void CompanyView::ModifyCompany(Company* company)
{
    companies_->modify(company);
    // Of a company that is not shown, list and chart come when it is selected.
    if (!isShown(company))
        return;
    SetQuoteList(company);
    UpdateQuotesChart();
}

void CompanyView::DeleteCompany(Company* company)
{
    companies_->remove(company);
    markets_->InvalidateItems(); // they count their companies
    // No row of a quote or an event outlives the company that owns them.
    if (isShown(company))
        SetQuoteList(nullptr);
    if (company == eventsOf_)
        SetCompanyEventList(nullptr);
}

void CompanyView::SetCompanyList(Market* market)
{
    if (market != shownMarket_)
        companies_->clear(); // what is selected in it is not to be found again
    shownMarket_ = market;
    std::vector<Company*> companies;
    if (market != nullptr)
        companies.assign(market->companies().begin(), market->companies().end());
    // Here, too, a company that was selected stays so.
    companies_->setAll(companies);
    // Quotes and events stay only when the company that they are of is selected here still.
    const Company* selected = GetSelectedCompany();
    if (selected == nullptr || !isShown(selected)) {
        SetQuoteList(nullptr);
        SetCompanyEventList(nullptr);
    }
}

double CompanyView::getSplitFactor() const
{
    const double denominator = splitDenominator_->getNumber();
    return denominator != 0 ? splitNumerator_->getNumber() / denominator : 0;
}

void CompanyView::fillChart(QuoteChart& chart, const Company& company) const
{
    const String unit = company.getCurrencyRepresentation();
    chart.showSeries(company, textOf(company.getAbbreviation()), unit.isUndefined() ? "???" : textOf(unit),
                     withSafe_->Value() == B_CONTROL_ON, companyFlags(company, leavingEvents_));
}

CompanyEvent** CompanyView::GetAllSelectedCompanyEvents(int* n) const
{
    return newArrayOf<CompanyEvent>(events_->list().allSelected(), n);
}

void CompanyView::AddCompanyEvent(CompanyEvent* event, bool selected)
{
    const Company* company = event->company();
    if (company == nullptr || company != eventsOf_)
        return;
    events_->list().insert(event);
    if (selected)
        events_->list().select(event);
    UpdateQuotesChart();
}

void CompanyView::ModifyCompanyEvent(CompanyEvent* event)
{
    events_->list().update(event);
    UpdateQuotesChart();
}

void CompanyView::DeleteCompanyEvents(std::span<CompanyEvent* const> events)
{
    events_->list().removeAll({events.begin(), events.end()});
    // The company still has them; the chart, like the list, has them no more.
    leavingEvents_ = events;
    UpdateQuotesChart();
    leavingEvents_ = {};
}

void CompanyView::SetCompanyEventList(Company* company)
{
    if (company != eventsOf_)
        events_->list().clear(); // what is selected in it is not to be found again
    eventsOf_ = company;
    std::vector<CompanyEvent*> events;
    if (company != nullptr)
        events.assign(company->events().begin(), company->events().end());
    events_->list().showAll(events);
}

CompanyView::Places CompanyView::places(const std::vector<Market*>& markets) const
{
    Places places;
    places.markets = markets_->places(markets);
    const auto shown = std::ranges::find(markets, shownMarket_);
    if (shown != markets.end()) {
        places.shownMarket = static_cast<std::size_t>(shown - markets.begin());
        places.companies = companies_->places((*shown)->companies());
    }
    const Company* company = GetSelectedCompany();
    if (shown == markets.end() || company == nullptr || company != eventsOf_ || !isShown(company))
        return places;
    const auto& companies = (*shown)->companies();
    places.shownCompany = static_cast<std::size_t>(std::ranges::find(companies, company) - companies.begin());
    places.events = events_->list().places(company->events());
    places.quotes = quoteSelection();
    return places;
}

void CompanyView::restore(const Places& places, const std::vector<Market*>& markets)
{
    markets_->restore(places.markets, markets);
    if (!places.shownMarket)
        return;
    // Quotes and events follow the company that is selected, each list with what was selected in it.
    shownMarket_ = markets[*places.shownMarket];
    companies_->restore(places.companies, shownMarket_->companies());
    Company* company = GetSelectedCompany();
    if (company == nullptr)
        return;
    SetQuoteList(company);
    SetCompanyEventList(company);
    // Of several selected ones another may be the first now: the list may be sorted by another column.
    if (!places.shownCompany || shownMarket_->companies()[*places.shownCompany] != company)
        return;
    restoreQuoteSelection(places.quotes);
    events_->list().restore(places.events, company->events());
}
