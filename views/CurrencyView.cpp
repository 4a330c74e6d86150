#include "views/CurrencyView.h"

#include "platform/Box.h"
#include "views/Look.h"
#include "views/ModelText.h"

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

CurrencyView::CurrencyView(BRect frame, const char* name, BWindow*) : SeriesPage(frame, name)
{
    addLoadAndSave(this);
    makeCurrencies({kMargin, kCurrenciesTop, kRight, kCurrenciesEnd});
    makeMarkets({kMargin, kQuotesTop, kQuotesLeft - kMargin, kQuotesEnd});
    addQuotes({kQuotesLeft, kQuotesTop, kRight, kQuotesEnd}, "Rates in the reference currency",
              {'RQSe', 'RTQd', 'RTQv', 'RBAq', 'RBUq', 'RBRq'});
    addChart({kMargin, kChartTop, kRight, kPageHeight - kMargin});
}

void CurrencyView::makeCurrencies(BRect frame)
{
    BBox* box = addBox(this, frame, "Currencies");
    const float right = frame.Width() - kBoxSide;
    const float bottom = frame.Height() - kBoxSide;
    // The widths of the list's columns.
    constexpr float kListEnd = kBoxSide + 150 + 62 + 96 + 82 + kScrollBar;
    currencies_ = new CurrencyListView("lstCurrencies");
    currencies_->addTo(box, {kBoxSide, kBoxTop, kListEnd, bottom}, "Currencies");
    currencies_->SetSelectionMessage(new BMessage('Crsl'));
    currencies_->setHint("No currency yet: this is where to begin. Type a name and a symbol, such as Euro and EUR, and "
                         "press Add. The first one becomes the reference, in which totals are given.");

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
    markets_ = new MarketListView("lstMarkets");
    markets_->addTo(box, {kBoxSide, kBoxTop, kBoxSide + width, frame.Height() - kBoxSide}, "Markets");
    markets_->setHint(
        "The markets of the currency that is selected will stand here. They are added on the page Company "
        "(Alt+1).");
}

void CurrencyView::setCurrencyRefName(const String& name)
{
    showText(*referenceName_, name);
    // With the reference all rates have changed, those in the lists as well.
    currencies_->InvalidateItems();
    redrawQuotes();
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
    // The rows stand in the order of the catalogue, before and after: there, too, the last one takes the free place.
    currencies_->removeByLast(currency);
    // No row of a market or a rate outlives the currency that owns them.
    if (currency == marketsOf_)
        SetMarketList(nullptr);
    if (isShown(currency))
        SetQuoteList(nullptr);
}

void CurrencyView::SetMarketList(Currency* currency)
{
    // Unlike quotes, markets are few: the list is filled anew in any case, and keeps what is selected.
    marketsOf_ = currency;
    std::vector<Market*> markets;
    if (currency != nullptr)
        markets.assign(currency->markets().begin(), currency->markets().end());
    markets_->setAll(markets);
}

void CurrencyView::AddMarket(Market* market)
{
    const Currency* currency = market->currency();
    if (currency != nullptr && currency == marketsOf_)
        markets_->add(market);
}

void CurrencyView::fillChart(QuoteChart& chart, const Currency& currency) const
{
    // Rates are shown in the reference currency, whose name the page has in its field.
    const std::string reference = textOf(referenceName_->Text());
    chart.showSeries(currency, textOf(currency.getRepresentation()), reference.empty() ? "???" : reference, false, {});
}

CurrencyView::Places CurrencyView::places(const std::vector<Currency*>& currencies) const
{
    Places places;
    places.currencies = currencies_->selection();
    const Currency* currency = GetSelectedCurrency();
    if (currency == nullptr || currency != marketsOf_ || !isShown(currency))
        return places;
    places.shownCurrency = static_cast<std::size_t>(std::ranges::find(currencies, currency) - currencies.begin());
    places.markets = markets_->places(currency->markets());
    places.quotes = quoteSelection();
    return places;
}

void CurrencyView::restore(const Places& places, const std::vector<Currency*>& currencies)
{
    currencies_->addAll(currencies);
    currencies_->restoreSelection(places.currencies);
    Currency* currency = GetSelectedCurrency();
    if (currency == nullptr)
        return;
    SetMarketList(currency);
    SetQuoteList(currency);
    // Of several selected ones another may be the first now: the list may be sorted by another column.
    if (!places.shownCurrency || currencies[*places.shownCurrency] != currency)
        return;
    markets_->restore(places.markets, currency->markets());
    restoreQuoteSelection(places.quotes);
}

void CurrencyView::DeleteAllCurrencies()
{
    currencies_->clear();
    SetMarketList(nullptr);
    SetQuoteList(nullptr);
}
