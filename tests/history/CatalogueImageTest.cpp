#include "history/CatalogueImage.h"

#include "market/Catalogue.h"
#include "market/Currency.h"
#include "market/Market.h"

#include <gtest/gtest.h>

namespace {

TEST(CatalogueImage, HoldsWhatHasChangedAndNoMore)
{
    constexpr int kQuotes = 15000;
    Catalogue catalogue;
    catalogue.addCurrency(new Currency("Euro", "EUR", nullptr));
    auto* market = new Market("Paris");
    market->setCurrency(catalogue.getCurrencies()[0]);
    for (int i = 0; i < 20; ++i) {
        auto* company = new Company(market, "Company", "C");
        Date day(1, 1, 1980);
        for (int j = 0; j < kQuotes; ++j)
            new CompanyQuote(company, day + 1, static_cast<float>(i + j));
    }
    const auto first = CatalogueImage::of(catalogue, nullptr);
    EXPECT_EQ(CatalogueImage::of(catalogue, first), first);

    // One quote: what is kept besides is about one company.
    market->companies()[7]->getQuote(100U)->setValue(5);
    const auto changed = CatalogueImage::of(catalogue, first);
    EXPECT_GT(first->bytesBeside(*changed), 12U * kQuotes);
    EXPECT_LT(first->bytesBeside(*changed), 400000U);
    // The last company takes the place of one that goes, and its quotes are kept but once.
    delete market->companies()[3];
    const auto removed = CatalogueImage::of(catalogue, changed);
    EXPECT_LT(changed->bytesBeside(*removed), 400000U);

    // A quote that is given its own value makes no other image; nor does a way back.
    market->companies()[7]->getQuote(100U)->setValue(5);
    EXPECT_EQ(CatalogueImage::of(catalogue, removed), removed);
    first->restore(catalogue);
    EXPECT_EQ(CatalogueImage::of(catalogue, first), first);
    EXPECT_EQ(market->companies()[7]->getQuote(100U)->getValue(), 107);
}

TEST(CatalogueImage, KeepsWhatAFileLeavesOut)
{
    Catalogue catalogue;
    for (const char* name : {"Euro", "Euro", "Yen"})
        catalogue.addCurrency(new Currency(name, "E", nullptr));
    const auto& currencies = catalogue.getCurrencies();
    catalogue.setReferenceCurrency(currencies[1]); // which has the name and the symbol of the one before
    currencies[2]->setReferenceCurrency(currencies[1]);
    auto* market = new Market("Paris");
    market->setCurrency(currencies[2]);
    auto* company = new Company(market, "Company", "C");
    new CompanyQuote(company, Date(1, 1, 2024), 1);
    (new CompanyQuote(company, Date(2, 1, 2024), 2))->setDate(Date(1, 1, 2024)); // two of one day
    const auto image = CatalogueImage::of(catalogue, nullptr);

    catalogue.rebaseOn(currencies[2]);
    delete company;
    image->restore(catalogue);
    EXPECT_EQ(catalogue.getReferenceCurrency(), currencies[1]);
    EXPECT_EQ(currencies[2]->storedReference(), currencies[1]);
    EXPECT_EQ(currencies[0]->storedReference(), nullptr);
    ASSERT_EQ(market->companies()[0]->getNbrQuotes(), 2U);
    EXPECT_EQ(market->companies()[0]->getQuote(1U)->getValue(), 2);
    EXPECT_EQ(CatalogueImage::of(catalogue, image), image);
}

} // namespace
