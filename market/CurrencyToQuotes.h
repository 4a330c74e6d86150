#pragma once

#include "foundation/OneToManyAssociation.h"

class Currency;
class CurrencyQuote;

/// A currency's rates, by date.
class CurrencyToQuotes final : public OneToManyAssociation<Currency, CurrencyQuote> {
public:
    explicit CurrencyToQuotes(Currency* owner);

private:
    ManyToOneAssociation<CurrencyQuote, Currency>& backLink(CurrencyQuote& e) const override;
};

/// The rate's link to its currency.
class QuotesToCurrency final : public ManyToOneAssociation<CurrencyQuote, Currency> {
public:
    using ManyToOneAssociation::ManyToOneAssociation;

private:
    int xAdd(Currency* partner) override;
    int xRemove(Currency* partner) override;
};
