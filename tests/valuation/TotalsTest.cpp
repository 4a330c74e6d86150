#include "valuation/Totals.h"
#include "tests/support/SmallPortfolio.h"
#include "valuation/QuoteCoverage.h"
#include "valuation/State.h"

#include <gtest/gtest.h>

namespace {

struct Portfolio : SmallPortfolio {
    Totals at(int day) { return {State(&wallet, daysAfterStart(day), false), catalogue}; }
    Account* account(Currency* currency, float amount)
    {
        Account* account = addAccount(wallet, "Account", currency);
        deposit(account, 0, amount);
        return account;
    }
    void hold(Company* company, int quantity, Account* account = nullptr)
    {
        trade(new Share(&wallet, company), account, 0, quantity, 5);
    }
};

} // namespace

TEST(TotalsTest, EverythingCountsInTheReferenceCurrencyOfTheStatesDay)
{
    Portfolio p;
    p.wallet.setSellRateCost(0);
    new CurrencyQuote(p.euro, daysAfterStart(10), 4); // the reference, too, is divided by
    new CurrencyQuote(p.dollar, daysAfterStart(10), 6);
    setTrend(p.alpha, 3);
    setTrend(p.beta, 8);
    p.account(p.dollar, 100);
    p.hold(p.beta, 10);
    p.hold(p.alpha, -7, p.account(p.euro, 1000));
    const Totals totals = p.at(10);
    EXPECT_TRUE(totals.isKnown);
    EXPECT_EQ(totals.totalDeposit, 1000 + 100 * 2);
    EXPECT_EQ(totals.totalValue, 10 * 8 * 6 / 4.0F - 7 * 3 + (1000 + 7 * 5) + 100 * 6 / 4.0F);
    EXPECT_EQ(totals.profit, totals.totalValue - totals.totalDeposit);
    EXPECT_FLOAT_EQ(totals.annualRevenue, 365.25F / 10 * totals.profit / 1200);
}

TEST(TotalsTest, SumsAreRoundedAfterEveryAddition)
{
    Portfolio p;
    constexpr int kLastWholeNumber = 16777216; // from here on a float has no odd numbers
    setTrend(p.alpha, 1);
    for (const int quantity : {kLastWholeNumber, 1, 1})
        p.hold(p.alpha, quantity);
    p.account(p.euro, 1);
    p.account(p.euro, 1);
    EXPECT_EQ(p.at(0).totalValue, kLastWholeNumber + 2.0F) << "the single shares are lost, the cash is one sum";
}

TEST(TotalsTest, WhatIsInNoKnownCurrencyDoesNotCount)
{
    Portfolio p;
    Currency unlisted("Franc", "FRF", nullptr), sameSymbol("Former euro", "EUR", nullptr);
    p.account(&unlisted, 100);
    p.account(nullptr, 100);
    p.account(p.euro, 100);
    p.hold(nullptr, 10);
    EXPECT_EQ(p.at(0).totalValue, 100);
    p.account(&sameSymbol, 100);
    EXPECT_EQ(p.at(0).totalValue, 200) << "the symbol tells";
}

TEST(TotalsTest, RevenueIsAYearsProfitOnTheDeposit)
{
    const struct {
        float deposited, gained; // by a sale on the first day
        int day;
        float revenue;
        const char* why;
    } cases[] = {{1000, 5, 365, 365.25F / 365 * 5 / 1000, "a year"},
                 {1000, -5, 730, 365.25F / 730 * -5 / 1000, "a loss in two years"},
                 {1000, 5, 0, 0, "on the first day"},
                 {1000, 0, -3, 0, "before the first operation"},
                 {0, 5, 365, 0, "nothing deposited"}};
    for (const auto& c : cases) {
        Portfolio p;
        p.wallet.setSellRateCost(0);
        p.wallet.setBuyRateCost(0);
        p.hold(p.alpha, c.gained < 0 ? 1 : -1, p.account(p.euro, c.deposited)); // worth nothing without quotes
        const Totals totals = p.at(c.day);
        EXPECT_FLOAT_EQ(totals.annualRevenue, c.revenue) << c.why;
        EXPECT_EQ(totals.profit, c.gained) << c.why;
    }
}

TEST(TotalsTest, WithoutAReferenceOrItsRateNothingHasAValue)
{
    for (const bool hasReference : {false, true}) {
        Portfolio p;
        p.account(p.dollar, 100);
        new CurrencyQuote(p.euro, kStart, 0);
        p.catalogue.setReferenceCurrency(hasReference ? p.euro : nullptr);
        const Totals totals = p.at(5);
        EXPECT_EQ(totals.isKnown, hasReference);
        EXPECT_EQ(totals.totalDeposit, hasReference ? 200 : 0);
        EXPECT_EQ(totals.totalValue + totals.profit + totals.annualRevenue, 0);
    }
}

TEST(QuoteCoverageTest, CountsTheQuotesThatAreNotOfTheDay)
{
    const struct {
        std::vector<int> alpha, beta; // days with quotes
        int day;
        unsigned older, unknown;
        int last; // day with both, -1 for none
        const char* why;
    } cases[] = {
        {{0, 5, 6}, {0, 4, 6, 9}, 6, 0, 0, 6, "both of the day"},
        {{0, 5, 6}, {0, 4, 6, 9}, 9, 1, 0, 6, "one of the day, behind the other's last"},
        {{0, 5, 6}, {0, 4, 6, 9}, 5, 1, 0, 0, "each has one between"},
        {{0, 5, 6}, {0, 4, 6, 9}, 30, 2, 0, 6, "behind all"},
        {{1, 3, 5}, {2, 4, 6}, 6, 1, 0, -1, "never on one day"},
        {{7}, {0}, 6, 1, 1, -1, "one begins later"},
        {{}, {6}, 6, 0, 1, -1, "one has none"},
    };
    for (const auto& c : cases) {
        Portfolio p;
        for (const int day : c.alpha)
            new CompanyQuote(p.alpha, daysAfterStart(day), 1);
        for (const int day : c.beta)
            new CompanyQuote(p.beta, daysAfterStart(day), 1);
        p.hold(p.alpha, 1);
        p.hold(p.beta, -1);
        p.hold(p.alpha, 0); // is not held
        const QuoteCoverage coverage = quoteCoverage(State(&p.wallet, daysAfterStart(c.day), false));
        EXPECT_EQ(coverage.needed, 2U) << c.why;
        EXPECT_EQ(coverage.older, c.older) << c.why;
        EXPECT_EQ(coverage.unknown, c.unknown) << c.why;
        EXPECT_EQ(coverage.lastFullDay, c.last < 0 ? Date() : daysAfterStart(c.last)) << c.why;
    }
}

TEST(QuoteCoverageTest, RatesAreThoseOfForeignMoneyAndHoldings)
{
    Portfolio p;
    const auto older = [&](int day) {
        return rateCoverage(State(&p.wallet, daysAfterStart(day), false), p.catalogue).older;
    };
    p.account(p.euro, 100);
    p.account(p.dollar, 0);
    EXPECT_EQ(older(3), 0U) << "the reference, and no money";
    p.hold(p.beta, 1);
    p.account(p.dollar, 10);
    EXPECT_EQ(older(0), 0U);
    EXPECT_EQ(older(3), 1U);
}
