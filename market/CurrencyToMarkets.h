#pragma once

#include "foundation/OneToManyAssociation.h"

class Currency;
class Market;

/// The markets that trade in a currency.
class CurrencyToMarkets final : public OneToManyAssociation<CurrencyToMarkets, Currency, Market> {
public:
    using OneToManyAssociation::OneToManyAssociation;
    static auto& link(auto& market) { return market.currency_; }
};

/// The market's link to its currency.
class MarketsToCurrency final : public ManyToOneAssociation<MarketsToCurrency, Market, Currency> {
public:
    static auto& list(auto& currency) { return currency.markets_; }
};
