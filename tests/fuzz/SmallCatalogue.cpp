#include "tests/fuzz/SmallCatalogue.h"

#include "market/Catalogue.h"
#include "market/Company.h"
#include "market/Currency.h"
#include "market/Market.h"

namespace {

Currency* addCurrency(Catalogue& catalogue, const char* name)
{
    auto* currency = new Currency(name, name, catalogue.getReferenceCurrency()); // owned by the catalogue
    catalogue.addCurrency(currency);
    return currency;
}

Market* addMarket(Currency* currency, const char* name)
{
    auto* market = new Market(name);
    market->setCurrency(currency); // which owns it
    return market;
}

/// Sixteen quotes, one every ninth day from the first day of 1999 on: up to a top and down again.
void addHill(Company* company, float height)
{
    Date day(1, 1, 1999);
    for (int i = 0; i < 16; ++i, day + 9)
        new CompanyQuote(company, day, height + static_cast<float>(i < 10 ? i : 24 - 2 * i)); // owned by the company
}

} // namespace

void fillSmallCatalogue(Catalogue& catalogue)
{
    Currency* reference = addCurrency(catalogue, "E");
    catalogue.setReferenceCurrency(reference);
    Currency* dollar = addCurrency(catalogue, "D");
    Currency* withoutRates = addCurrency(catalogue, "N");
    for (Date day(1, 1, 1999); day < Date(1, 1, 2000); day + 30) {
        new CurrencyQuote(reference, day, 1);
        new CurrencyQuote(dollar, day, 1.0F + static_cast<float>(day.getMonth()) / 8);
    }
    Market* home = addMarket(reference, "P");
    Market* abroad = addMarket(dollar, "Y");
    addHill(new Company(home, "Alpha", "A"), 50);
    new CompanyQuote(new Company(home, "Beta", "B"), Date(3, 5, 1999), 7.5F);
    addHill(new Company(abroad, "Gamma", "C"), 3);
    new Company(abroad, "Delta", "A"); // the ticker of another market's company
    addHill(new Company(addMarket(withoutRates, "Z"), "Epsilon", "F"), 20);
}
