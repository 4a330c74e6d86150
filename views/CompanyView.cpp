#include "views/CompanyView.h"

#include "platform/Box.h"
#include "platform/CheckBox.h"
#include "platform/Message.h"
#include "platform/StringView.h"
#include "platform/TextControl.h"
#include "views/CompanyListView.h"
#include "views/EventBox.h"
#include "views/Look.h"
#include "views/MarketListView.h"
#include "views/NumberControl.h"
#include "views/QuoteBox.h"
#include "views/QuoteChart.h"

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

CompanyView::CompanyView(BRect frame, const char* name, BWindow*) : PageView(frame, name)
{
    addLoadAndSave(this);
    makeMarkets({kMargin, kListsTop, kMarketsEnd, kListsEnd});
    makeCompanies({kMarketsEnd + kMargin, kListsTop, kRight, kListsEnd});
    makeQuotes({kMargin, kQuotesTop, kQuotesRight, kQuotesEnd});
    events_ = new EventBox({kQuotesRight + kMargin, kQuotesTop, kRight, kQuotesEnd});
    AddChild(events_);
    chart_ = new QuoteChart({kMargin, kChartTop, kRight, kPageHeight - kMargin});
    AddChild(chart_);
}

void CompanyView::makeMarkets(BRect frame)
{
    BBox* box = addBox(this, frame, "Markets");
    const float right = frame.Width() - kBoxSide;
    const float bottom = frame.Height() - kBoxSide;
    const float buttonTop = bottom - kButtonHeight;
    const float fieldTop = buttonTop - kGap - kFieldHeight;
    markets_ = new MarketListView("lstMarkets", right - kBoxSide - kScrollBar - MarketListView::kOtherWidth);
    markets_->addTo(box, {kBoxSide, kBoxTop, right, fieldTop - kGap}, "Markets");
    markets_->SetSelectionMessage(new BMessage('MSel'));
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
    BBox* box = addBox(this, frame, "Companies");
    const float right = frame.Width() - kBoxSide;
    const float bottom = frame.Height() - kBoxSide;
    constexpr float kListEnd = kBoxSide + 66 + 176 + kScrollBar;
    companies_ = new CompanyListView("lstCompanies");
    companies_->addTo(box, {kBoxSide, kBoxTop, kListEnd, bottom}, "Companies");
    companies_->SetSelectionMessage(new BMessage('CSel'));

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
    quotes_ = new QuoteBox(frame, "Quotes", {'CQSe', 'CTQd', 'CTQv', 'CBAq', 'CBUq', 'CBRq'});
    AddChild(quotes_);
    const BRect area = quotes_->freeArea();
    float top = area.top + kMargin;
    auto* title = new BStringView({area.left, top, area.right, top + kFieldHeight}, "", "Split of the selected quotes");
    quotes_->AddChild(title);
    top += kFieldHeight;
    constexpr float kFirst = 44 + 34;
    constexpr float kSecond = 22 + 34;
    splitNumerator_ = addTypedNumber(quotes_, {area.left, top + 1, area.left + kFirst, top + 1 + kFieldHeight},
                                     "txtSplitRangeNum", "Factor", 'CTSp', 44);
    splitDenominator_ =
        addTypedNumber(quotes_, {area.left + kFirst, top + 1, area.left + kFirst + kSecond, top + 1 + kFieldHeight},
                       "txtSplitRangeDenum", "to", 'CTSp', 22);
    addButton(quotes_, {area.left + kFirst + kSecond + kGap, top, area.right, top + kButtonHeight}, "btnSplitQuotes",
              "Split", 'CBSq');
    withSafe_ = addCheckBox(quotes_, {area.left, area.bottom - kFieldHeight, area.right, area.bottom}, "cbWithSafe",
                            "With Safe", 'CCWs');
    explain(*quotes_, {{"btnSplitQuotes", "Multiplies the selected quotes; operations stay as they are"},
                       {"cbWithSafe", "Shades a band of one standard deviation of the quotes about the trend"}});
}
