#include "views/CurrencyView.h"

#include "market/Currency.h"
#include "market/Market.h"
#include "platform/Box.h"
#include "platform/Message.h"
#include "platform/TextControl.h"
#include "views/CurrencyListView.h"
#include "views/Look.h"
#include "views/MarketListView.h"
#include "views/ModelText.h"
#include "views/QuoteBox.h"
#include "views/QuoteChart.h"
#include "views/QuoteListView.h"
#include "views/Selection.h"

using namespace look;

namespace {

// Where the groups of the page begin and end.
constexpr float kRight = kPageWidth - kMargin;
constexpr float kTopEnd = kMargin + kButtonHeight;
constexpr float kCurrenciesTop = kTopEnd + kMargin;
constexpr float kCurrenciesEnd = kCurrenciesTop + 230;
constexpr float kQuotesTop = kCurrenciesEnd + kMargin;
constexpr float kQuotesEnd = kQuotesTop + 194;
constexpr float kQuotesLeft = kRight - 434;
constexpr float kChartTop = kQuotesEnd + kMargin;

} // namespace

CurrencyView::CurrencyView(BRect frame, const char* name, BWindow*) : PageView(frame, name)
{
    addLoadAndSave(this);
    makeCurrencies({kMargin, kCurrenciesTop, kRight, kCurrenciesEnd});
    makeMarkets({kMargin, kQuotesTop, kQuotesLeft - kMargin, kQuotesEnd});
    quotes_ = new QuoteBox({kQuotesLeft, kQuotesTop, kRight, kQuotesEnd}, "Rates in the reference currency",
                           {'RQSe', 'RTQd', 'RTQv', 'RBAq', 'RBUq', 'RBRq'});
    AddChild(quotes_);
    chart_ = new QuoteChart({kMargin, kChartTop, kRight, kPageHeight - kMargin});
    AddChild(chart_);
}

void CurrencyView::makeCurrencies(BRect frame)
{
    BBox* box = addBox(this, frame, "Currencies");
    const float right = frame.Width() - kBoxSide;
    const float bottom = frame.Height() - kBoxSide;
    constexpr float kListEnd = kBoxSide + 150 + 62 + 96 + 82 + kScrollBar;
    currencies_ = new CurrencyListView("lstCurrencies");
    currencies_->addTo(box, {kBoxSide, kBoxTop, kListEnd, bottom}, "Currencies");
    currencies_->SetSelectionMessage(new BMessage('Crsl'));

    constexpr float kLeft = kListEnd + 2 * kMargin;
    constexpr float kDivider = 118;
    float top = kBoxTop;
    const auto add = [&](auto make, const char* name, const char* label, uint32 code) {
        BTextControl* field = make(box, BRect(kLeft, top, right, top + kFieldHeight), name, label, code, kDivider);
        top += kRow;
        return field;
    };
    name_ = add(addField, "txtCurrencyName", "Name", 'RTNa');
    representation_ = add(addField, "txtCurrencyRepresentation", "Symbol", 'RTRe');
    referenceName_ = add(addField, "txtReferenceCurrencyName", "Reference", 'RTRn');
    referenceName_->SetEditable(false);
    // These two stay empty. Intended: the figures of the selected currency show in the fields of the same names on the
    // company page.
    for (BTextControl* field : {add(addNumber, "txtRelativeDailyChange", "Rel. Daily Change", 'RTRe'),
                                add(addNumber, "txtDiffWithAverage", "Diff. with Average", 'RTDi')}) {
        field->SetEditable(false);
        field->SetToolTip("The company page shows this figure of the selected currency");
    }
    const float referenceTop = bottom - kButtonHeight;
    const float buttonTop = referenceTop - kGap - kButtonHeight;
    addButtons(box, {kLeft, buttonTop, right, buttonTop + kButtonHeight},
               {{"btnAddCurrency", "Add", 'RBAd'},
                {"btnUpdateCurrency", "Update", 'RBUp'},
                {"btnRemoveCurrency", "Remove", 'RBRe'}});
    addButton(box, {kLeft, referenceTop, right, bottom}, "btnSetReferenceCurrency", "Set Reference Currency", 'RBSr');
    explain(*box, {{"btnSetReferenceCurrency", "Has all rates and totals given in the selected currency"}});
}

void CurrencyView::makeMarkets(BRect frame)
{
    BBox* box = addBox(this, frame, "Markets");
    const float width = frame.Width() - 2 * kBoxSide;
    markets_ = new MarketListView("lstMarkets", width - kScrollBar - MarketListView::kOtherWidth);
    markets_->addTo(box, {kBoxSide, kBoxTop, kBoxSide + width, frame.Height() - kBoxSide}, "Markets");
}

// --- Currencies.

String CurrencyView::getCurrencyName() const
{
    return name_->Text();
}

void CurrencyView::setCurrencyName(const String& name)
{
    showText(*name_, name);
}

String CurrencyView::getCurrencyRepresentation() const
{
    return representation_->Text();
}

void CurrencyView::setCurrencyRepresentation(const String& representation)
{
    showText(*representation_, representation);
}

void CurrencyView::setCurrencyRefName(const String& name)
{
    showText(*referenceName_, name);
    currencies_->InvalidateItems();
    quotes_->list().InvalidateItems();
}

Currency* CurrencyView::GetSelectedCurrency() const
{
    return currencies_->selected();
}

void CurrencyView::AddCurrency(Currency* currency, bool selected)
{
    currencies_->add(currency);
    if (selected)
        currencies_->select(currency);
}

void CurrencyView::ModifyCurrency(Currency* currency)
{
    currencies_->modify(currency);
    markets_->InvalidateItems(); // they show its symbol
}

void CurrencyView::DeleteCurrency(Currency* currency)
{
    const int32 place = currencies_->indexOf(currency);
    currencies_->remove(currency);
    const int32 last = currencies_->CountItems() - 1;
    if (place >= 0 && place < last)
        currencies_->move(last, place);
    if (currency == marketsOf_)
        SetMarketList(nullptr);
    if (quotes_->isOf(currency))
        SetQuoteList(nullptr);
}

// --- Markets.

void CurrencyView::SetMarketList(Currency* currency)
{
    marketsOf_ = currency;
    unsigned n = 0;
    Market** markets = currency != nullptr ? currency->getAllMarkets(&n) : nullptr;
    markets_->setAll({markets, markets + n});
}

void CurrencyView::AddMarket(Market* market)
{
    Currency* currency;
    if (market->getCurrency(&currency) == 0 && currency == marketsOf_)
        markets_->add(market);
}

void CurrencyView::ModifyMarket(Market* market)
{
    markets_->modify(market);
}

void CurrencyView::DeleteMarket(Market* market)
{
    markets_->remove(market);
}

// --- Rates.

Date CurrencyView::getQuoteDate() const
{
    return quotes_->getDate();
}

void CurrencyView::setQuoteDate(const Date& date)
{
    quotes_->setDate(date);
}

float CurrencyView::getQuoteValue() const
{
    return quotes_->getValue();
}

void CurrencyView::setQuoteValue(float value)
{
    quotes_->setValue(value);
}

CurrencyQuote* CurrencyView::GetSelectedQuote() const
{
    return static_cast<CurrencyQuote*>(quotes_->list().selected());
}

CurrencyQuote** CurrencyView::getAllSelectedQuotes(int* n) const
{
    return newArrayOf<CurrencyQuote>(quotes_->list().allSelected(), n);
}

void CurrencyView::AddQuote(CurrencyQuote* quote)
{
    Currency* currency;
    if (quote->getCurrency(&currency) == 0 && quotes_->isOf(currency))
        quotes_->list().insert(quote);
    currencies_->InvalidateItems(); // they show their latest rate
}

void CurrencyView::ModifyQuote(CurrencyQuote* quote)
{
    quotes_->list().update(quote);
    currencies_->InvalidateItems();
}

void CurrencyView::DeleteQuote(CurrencyQuote* quote)
{
    DeleteQuotes(&quote, 1);
}

void CurrencyView::DeleteQuotes(CurrencyQuote* const* quotes, int n)
{
    quotes_->list().removeAll({quotes, quotes + n});
    currencies_->InvalidateItems();
}

void CurrencyView::SetQuoteList(Currency* currency)
{
    quotes_->showQuotes(currency);
    if (currency == nullptr)
        UpdateQuotesChart();
}

void CurrencyView::UpdateQuotesChart()
{
    const Currency* currency = GetSelectedCurrency();
    if (currency == nullptr) {
        chart_->showNothing();
        return;
    }
    const std::string reference = textOf(referenceName_->Text());
    chart_->showSeries(*currency, textOf(currency->getRepresentation()), reference.empty() ? "???" : reference, false);
}
