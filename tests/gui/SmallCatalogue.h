#pragma once

#include "app/PLWindow.h"
#include "market/Company.h"
#include "market/Currency.h"
#include "market/Market.h"

/// The market data that the tests of accounts and operations work with: the euro, which is the reference, and the
/// dollar at half of it; two markets of the name Paris, the first with AAA, in dollars, the second with BBB, in euros,
/// at 10 on 01/11/2024.
inline void addSmallCatalogue(PLWindow& window)
{
    auto* euro = new Currency("Euro", "EUR", nullptr);
    auto* dollar = new Currency("Dollar", "USD", euro);
    new CurrencyQuote(euro, Date(1, 1, 2020), 1);
    new CurrencyQuote(dollar, Date(1, 1, 2020), 0.5F);
    for (Currency* currency : {dollar, euro}) {
        window.catalogue().addCurrency(currency);
        (new Market("Paris"))->setCurrency(currency);
    }
    window.setReferenceCurrency(euro);
    const auto markets = window.catalogue().getMarkets();
    new Company(markets[0], "Alpha", "AAA");
    auto* beta = new Company(markets[1], "Beta", "BBB");
    new CompanyQuote(beta, Date(1, 11, 2024), 10);
    window.UpdateState();
}
