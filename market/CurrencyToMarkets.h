#pragma once

#include "foundation/OneToManyAssociation.h"

class Currency;
class Market;

/// The markets that trade in a currency.
class CurrencyToMarkets final : public OneToManyAssociation<Currency, Market> {
public:
    explicit CurrencyToMarkets(Currency* owner) : OneToManyAssociation(owner) {}

private:
    ManyToOneAssociation<Market, Currency>& backLink(Market& e) const override;
};

/// The market's link to its currency.
class MarketsToCurrency final : public ManyToOneAssociation<Market, Currency> {
public:
    using ManyToOneAssociation::ManyToOneAssociation;

private:
    int xAdd(Currency* partner) override;
    int xRemove(Currency* partner) override;
};
