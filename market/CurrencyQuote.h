#pragma once

#include "market/MarketLinks.h"
#include "market/Quote.h"

/// One dated rate of a currency: the price of one unit of it in the reference currency.
///
/// A rate belongs to at most one currency; deleting the currency deletes its rates.
class CurrencyQuote final : public Quote {
public:
    CurrencyQuote() = default;
    /// Links the rate into `currency`'s series; it replaces a rate of the same day.
    CurrencyQuote(Currency* currency, const Date& date, float value);
    ~CurrencyQuote() override;

    /// @return 0; -1 and a null `*out` when the rate has no currency.
    int getCurrency(Currency** out) const { return currency_.get(out); }
    /// The same; null when there is none.
    Currency* currency() const { return currency_.partner(); }
    int setCurrency(Currency* currency);

protected:
    void notifyChange() override;

private:
    friend class CurrencyToQuotes;
    QuotesToCurrency currency_;
};
