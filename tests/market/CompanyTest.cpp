#include "market/Company.h"
#include "market/Currency.h"
#include "market/Market.h"
#include "market/SplitCompanyEvent.h"

#include <gtest/gtest.h>
#include <memory>

TEST(CompanyTest, AMarketFindsTheFirstCompanyOfATicker)
{
    Market market("NYSE");
    auto* none = new Company(&market, "No ticker", String());
    auto* first = new Company(&market, "First", "BG");
    auto* second = new Company(&market, "Second", "BG");
    Company* found = none;
    const std::pair<String, Company*> cases[] = {{"BG", first}, {"bg", nullptr}, {"B", nullptr}, {String(), nullptr}};
    for (const auto& [ticker, company] : cases) {
        EXPECT_EQ(market.getCompany(ticker, &found), company != nullptr ? 0 : -1);
        EXPECT_EQ(found, company) << ticker.getCharacterArray();
    }
    delete none; // the last company takes its place
    EXPECT_EQ(market.getCompany("BG", &found), 0);
    EXPECT_EQ(found, second);
}

TEST(CompanyTest, TheSymbolOfTheMoneyComesFromTheMarketsCurrency)
{
    Currency euro("Euro", "EUR", nullptr);
    auto* market = new Market("NYSE");
    const Company company(market, "Big", "BG");
    EXPECT_FALSE(company.getCurrencyRepresentation().hasText());
    EXPECT_FALSE(Company().getCurrencyRepresentation().hasText());
    market->setCurrency(&euro);
    EXPECT_EQ(company.getCurrencyRepresentation(), "EUR");
}

TEST(CompanyTest, AnEventThatChangesItsDayStaysWithItsCompanyAndComesLast)
{
    Company company;
    auto* first = new SplitCompanyEvent(&company, Date(3, 5, 1999), 2, 1);
    auto* second = new SplitCompanyEvent(&company, Date(4, 5, 1999), 3, 1);
    SplitCompanyEvent alone(nullptr, Date(3, 5, 1999), 2, 1);
    for (SplitCompanyEvent* event : {first, &alone}) {
        EXPECT_EQ(event->setDate(Date(5, 5, 1999)), 0);
        EXPECT_EQ(event->getDate(), Date(5, 5, 1999));
    }
    unsigned n;
    CompanyEvent** events = company.getAllEvents(&n);
    EXPECT_EQ(std::vector<CompanyEvent*>(events, events + n), (std::vector<CompanyEvent*>{second, first}));
    Company* linked;
    EXPECT_EQ(first->getCompany(&linked), 0);
    EXPECT_EQ(alone.getCompany(&linked), -1);
}
