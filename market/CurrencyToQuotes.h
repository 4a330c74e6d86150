#pragma once

#include "foundation/OneToManyAssociation.h"
#include "market/Quote.h"

class Currency;
class CurrencyQuote;

/// A currency's rates, by date.
class CurrencyToQuotes final : public OneToManyAssociation<CurrencyToQuotes, Currency, CurrencyQuote, true> {
public:
    using OneToManyAssociation::OneToManyAssociation;
    static auto& link(auto& quote) { return quote.currency_; }
    static int compare(const void* a, const void* b) { return sortQuotesByDate(a, b); }
};

/// The rate's link to its currency.
class QuotesToCurrency final : public ManyToOneAssociation<QuotesToCurrency, CurrencyQuote, Currency, true> {
public:
    // By way of the series, where a quote of the same day is replaced and the trend follows.
    static int enter(auto& currency, CurrencyQuote* quote) { return currency.addQuote(quote); }
    static int leave(auto& currency, CurrencyQuote* quote) { return currency.removeQuote(quote); }
};
