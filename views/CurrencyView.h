#pragma once

#include "foundation/Date.h"
#include "foundation/String.h"
#include "views/PageView.h"

class Currency;
class CurrencyListView;
class CurrencyQuote;
class Market;
class MarketListView;
class QuoteBox;
class QuoteChart;

/// The page of currencies, with the markets and rates of the selected currency.
///
/// A row is taken out by `Delete...` before its object is destroyed. What is told of an object that is not shown has
/// no effect.
class CurrencyView final : public PageView {
public:
    CurrencyView(BRect frame, const char* name, BWindow* window);

    String getCurrencyName() const;
    void setCurrencyName(const String& name);
    /// The symbol.
    String getCurrencyRepresentation() const;
    void setCurrencyRepresentation(const String& representation);
    /// Shows the name of the reference currency. Its rates and those of the others may have changed with it.
    void setCurrencyRefName(const String& name);
    /// Null when none is selected.
    Currency* GetSelectedCurrency() const;
    void AddCurrency(Currency* currency, bool selected);
    void ModifyCurrency(Currency* currency);
    /// Takes the row out, the last one moves into its place.
    void DeleteCurrency(Currency* currency);

    // Markets of the selected currency.
    /// Null shows none.
    void SetMarketList(Currency* currency);
    void AddMarket(Market* market);
    void ModifyMarket(Market* market);
    void DeleteMarket(Market* market);

    // Rates of the selected currency.
    Date getQuoteDate() const;
    void setQuoteDate(const Date& date);
    float getQuoteValue() const;
    void setQuoteValue(float value);
    /// Null when none is selected.
    CurrencyQuote* GetSelectedQuote() const;
    /// @return a new array, by date; the caller deletes it.
    CurrencyQuote** getAllSelectedQuotes(int* n) const;
    void AddQuote(CurrencyQuote* quote);
    void ModifyQuote(CurrencyQuote* quote);
    void DeleteQuote(CurrencyQuote* quote);
    /// The same for many at once.
    void DeleteQuotes(CurrencyQuote* const* quotes, int n);
    /// Shows the rates of `currency`, which stay as they are when they are shown already; null shows none.
    void SetQuoteList(Currency* currency);
    /// Draws the rates of the selected currency anew.
    void UpdateQuotesChart();

private:
    void makeCurrencies(BRect frame);
    void makeMarkets(BRect frame);

    CurrencyListView* currencies_ = nullptr;
    BTextControl* name_ = nullptr;
    BTextControl* representation_ = nullptr;
    BTextControl* referenceName_ = nullptr;
    MarketListView* markets_ = nullptr;
    QuoteBox* quotes_ = nullptr;
    QuoteChart* chart_ = nullptr;

    const Currency* marketsOf_ = nullptr; // whose markets are listed; never looked into
};
