#include "tests/support/SmallPortfolio.h"

#include <cmath>
#include <gtest/gtest.h>
#include <memory>

namespace {

using Rates = std::vector<float>;

Currency* addCurrency(Catalogue& catalogue, const char* symbol, const std::vector<std::pair<short, float>>& rates)
{
    auto* currency = new Currency(symbol, symbol, catalogue.getReferenceCurrency());
    for (const auto& [day, value] : rates)
        new CurrencyQuote(currency, Date(day, 5, 1999), value);
    catalogue.addCurrency(currency);
    return currency;
}

} // namespace

TEST(CurrencyTest, ANewReferenceDividesTheOtherRatesByItsOwnOfTheDay)
{
    Catalogue catalogue;
    Currency* a = addCurrency(catalogue, "A", {{1, 1}, {3, 1}, {5, 1}});
    catalogue.rebaseOn(a);
    EXPECT_EQ(catalogue.getReferenceCurrency(), a);
    Currency* b = addCurrency(catalogue, "B", {{1, 2}, {3, 3}});
    Currency* c = addCurrency(catalogue, "C", {{2, 6}, {3, 7}});
    EXPECT_EQ(a->getPente(), 0);
    catalogue.rebaseOn(a);
    EXPECT_EQ(valuesOf(*a), Rates(3, 1.0F)) << "the first reference changes no rate";
    EXPECT_EQ(valuesOf(*b), (Rates{2, 3})) << "nor does the present one";

    catalogue.rebaseOn(b);
    EXPECT_EQ(catalogue.getReferenceCurrency(), b);
    EXPECT_EQ(valuesOf(*a), (Rates{0.5F, 1.0F / 3, 0.25F})) << "B is at 2, 3, and by its line at 4";
    EXPECT_EQ(valuesOf(*b), Rates(2, 1.0F));
    EXPECT_EQ(valuesOf(*c), (Rates{3, 7.0F / 3})) << "between its rates B keeps the last, 2";
    EXPECT_FLOAT_EQ(a->getPente(), -0.0625F) << "the trend follows";

    catalogue.rebaseOn(addCurrency(catalogue, "D", {}));
    EXPECT_EQ(valuesOf(*b), Rates(2, INFINITY)) << "a rate of 0 is not guarded against";
}

TEST(CurrencyTest, ARemovedCurrencyLeavesItsPlaceToTheLastAndNoPointerBehind)
{
    Catalogue catalogue;
    Currency* a = addCurrency(catalogue, "A", {{1, 1}});
    catalogue.rebaseOn(a);
    Currency* b = addCurrency(catalogue, "B", {{1, 2}});
    Currency* c = addCurrency(catalogue, "C", {{1, 4}});
    Currency* d = addCurrency(catalogue, "D", {{1, 8}});
    const auto removed = [&catalogue](Currency* currency) {
        catalogue.removeCurrency(currency);
        return std::unique_ptr<Currency>(currency);
    };
    removed(b);
    EXPECT_EQ(catalogue.getCurrencies(), (std::vector<Currency*>{a, d, c}));
    EXPECT_EQ(valuesOf(*d), Rates{8}) << "the reference stays";
    removed(a);
    EXPECT_EQ(catalogue.getCurrencies(), (std::vector<Currency*>{c, d}));
    EXPECT_EQ(catalogue.getReferenceCurrency(), c);
    EXPECT_EQ(valuesOf(*d), Rates{2}) << "in the new reference";
    Currency *ofC, *ofD;
    EXPECT_EQ(c->getReferenceCurrency(&ofC) + d->getReferenceCurrency(&ofD), 0);
    EXPECT_TRUE(ofC == c && ofD == c) << "without a stored one a currency is its own";
    removed(d);
    removed(c);
    EXPECT_EQ(catalogue.getReferenceCurrency(), nullptr);
}
