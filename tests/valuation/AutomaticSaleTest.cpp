#include "tests/support/SmallPortfolio.h"
#include "valuation/AccountState.h"
#include "valuation/ShareState.h"
#include "valuation/State.h"

#include <cmath>
#include <gtest/gtest.h>
#include <iterator>

namespace {

constexpr int kPeriod = 90;

/// A hundred shares bought at 10 on the first day, paid by an account that is not the one for profits.
struct HundredShares : SmallPortfolio {
    explicit HundredShares(float trend, float slope = 0)
    {
        setTrend(alpha, trend, slope);
        profits->setDefaultTransferAccount(true);
        trade(share, main, 0, 100, 10);
    }
    State* at(int day, bool automatic = true) { return new State(&wallet, daysAfterStart(day), automatic); }

    Account* main = addAccount(wallet, "Main", euro);
    Account* profits = addAccount(wallet, "Profits", euro);
    Share* share = new Share(&wallet, alpha);
};

/// The first day before `end` on which the trend passes a limit, otherwise `end`.
Date soldByWalking(const HundredShares& p, Date day, const Date& end)
{
    const Wallet& w = p.wallet;
    const double price = p.share->getShareOperation(0)->getQuote();
    const auto limit = [&](double beginRate, double endRate) {
        return (endRate - (endRate - beginRate) * (end - day) / w.getInvestementPeriod()) * price;
    };
    for (int i = 0; i < 100000 && day < end; ++i, day + 1) {
        const float trend = p.alpha->getPrevisionQuote(day);
        if (limit(w.getBeginLoseSellRate(), w.getEndLoseSellRate()) > trend ||
            limit(w.getBeginProfitSellRate(), w.getEndProfitSellRate()) < trend)
            return day;
    }
    return end;
}

} // namespace

TEST(AutomaticSaleTest, TheTrendIsHeldAgainstTheLimitsOfEachDay)
{
    const struct {
        int day;
        float trend, slope;
        int soldOn;
        bool isProfit;
        const char* why;
    } cases[] = {{0, 7.9F, 0, 0, false, "below the loss limit of 8"},
                 {0, 8.1F, 0, kPeriod, false, "between the limits to the end"},
                 {0, 20.1F, 0, 0, true, "above the first day's profit limit of 20"},
                 {0, 19.95F, 0, 1, true, "above the second day's of 19.9"},
                 {kPeriod - 1, 11.2F, 0, kPeriod - 1, true, "above the last day's of 11.1"},
                 {kPeriod - 1, 11.05F, 0, kPeriod, false, "below the last day's"},
                 {0, 10, 0.25F, 29, true, "10 + x / 4 > 20 - x / 10 from the 29th day on"},
                 {0, 10, -0.1875F, 11, false, "10 - 3 x / 16 < 8 from the 11th day on"},
                 {kPeriod, 50, 0, kPeriod, false, "at the end: sold whatever the trend, without a transfer"},
                 {kPeriod + 30, 50, 0, kPeriod, false, "behind it: sold in the past"}};
    for (const auto& c : cases) {
        HundredShares p(c.trend, c.slope);
        const State* state = p.at(c.day);
        const ShareOperation* sale = p.share->getShareOperation(1);
        ASSERT_NE(sale, nullptr) << c.why;
        EXPECT_EQ(sale->getDate(), daysAfterStart(c.soldOn)) << c.why;
        EXPECT_FLOAT_EQ(sale->getQuote(), c.trend + c.slope * static_cast<float>(c.soldOn)) << c.why;
        EXPECT_EQ(sale->getOperationCost(), 29.95F);
        EXPECT_EQ(sale->getQuantity(), 100);
        EXPECT_TRUE(sale->isAutomatic() && !sale->isBuy());
        Account* account;
        EXPECT_EQ(sale->getAccount(&account), -1);
        EXPECT_EQ(state->getShareState(0)->getQuantity(), 100) << "the state that makes the sale keeps the holding";
        EXPECT_EQ(p.profits->getNbrTransferOperations(), c.isProfit ? 1U : 0U) << c.why;
    }
}

TEST(AutomaticSaleTest, TheSearchFindsTheDayThatAWalkFinds)
{
    constexpr float kOdd[] = {NAN, INFINITY, -INFINITY, 0, 1e30F, -1e30F};
    std::mt19937 random(5);
    const auto around = [&](float from, float to) {
        if (below(random, 25) == 0)
            return kOdd[below(random, std::size(kOdd))];
        return from + (to - from) * static_cast<float>(below(random, 1000)) / 1000;
    };
    int soldWithin = 0;
    for (int i = 0; i < 2000; ++i) {
        const int period = i % 20 == 0 ? 32767 : 1 + static_cast<int>(below(random, 200));
        HundredShares p(around(9, 11), around(-6, 9) / static_cast<float>(period));
        delete p.share->getShareOperation(0);
        trade(p.share, p.main, 0, 100, around(10, 10));
        p.wallet.setInvestementPeriod(static_cast<short>(period));
        p.wallet.setBeginLoseSellRate(around(0.25F, 0.875F));
        p.wallet.setEndLoseSellRate(around(0.25F, 0.875F));
        p.wallet.setBeginProfitSellRate(around(1.125F, 2));
        p.wallet.setEndProfitSellRate(around(1.125F, 2));
        Date day = kStart;
        if (i % 50 == 0)
            day.setDay(static_cast<short>(25 + i % 16)); // on some of these the calendar begins late
        new State(&p.wallet, day, true);
        const Date soldOn = p.share->getShareOperation(1)->getDate();
        ASSERT_EQ(soldOn, soldByWalking(p, day, daysAfterStart(period))) << "case " << i;
        soldWithin += soldOn != day && soldOn != daysAfterStart(period) ? 1 : 0;
    }
    EXPECT_GT(soldWithin, 500) << "the cases are no test of the search";
}

TEST(AutomaticSaleTest, ThePartOfTheGainThatIsNotReinvestedIsTransferred)
{
    // 20.1 * 100 * 0.9983 - 29.95 = 1976.633, less 10 * 100 * 1.0017 + 29.95 = 1031.65, makes a gain of 944.983.
    const float moved = 94.4983F;
    HundredShares p(20.1F);
    const State* state = p.at(0);
    const TransferAccountOperation* sent = p.profits->getTransferOperation(0);
    ASSERT_EQ(p.main->getOperation(1), sent);
    EXPECT_NEAR(sent->getAmount(), moved, 1e-4);
    EXPECT_TRUE(sent->isAutomatic());
    EXPECT_FLOAT_EQ(state->getAccountState(0)->getCash(), -1001.7F - moved) << "no cash from the sale";
    EXPECT_FLOAT_EQ(state->getAccountState(1)->getCash(), moved);

    HundredShares later(10, 0.25F); // sold on the 29th day
    EXPECT_EQ(later.at(0)->getAccountState(1)->getCash(), 0) << "still to come on the state's day";
    EXPECT_EQ(later.profits->getNbrTransferOperations(), 1U);
}

TEST(AutomaticSaleTest, NoTransferWithoutAGainAndTwoDifferentAccounts)
{
    const struct {
        const char* why;
        void (*arrange)(HundredShares&);
    } cases[] = {
        {"paid by the account for profits", [](HundredShares& p) { trade(p.share, p.profits, 0, 1, 10); }},
        {"paid by none", [](HundredShares& p) { trade(p.share, nullptr, 0, 1, 10); }},
        {"no gain", [](HundredShares& p) { p.wallet.setSellCost(5000); }},
        {"no account in the currency of the company", [](HundredShares& p) { p.paris->setCurrency(p.dollar); }}};
    for (const auto& c : cases) {
        HundredShares p(20.1F);
        c.arrange(p);
        p.at(0);
        EXPECT_TRUE(p.share->getShareOperation(p.share->getNbrShareOperations() - 1)->isAutomatic()) << c.why;
        EXPECT_EQ(p.profits->getNbrTransferOperations(), 0U) << c.why;
    }
}

TEST(AutomaticSaleTest, OnlyACompleteHoldingIsSoldAndOnlyOnDemand)
{
    const struct {
        const char* why;
        int day;
        bool automatic;
        int more; // bought on the fifth day
    } cases[] = {{"not asked for", 9, false, 1},
                 {"an operation is still to come", 4, true, 1},
                 {"nothing is held", 9, true, -100},
                 {"less than nothing is held", 9, true, -101}};
    for (const auto& c : cases) {
        HundredShares p(20.1F);
        trade(p.share, p.main, 5, c.more, 10);
        p.at(c.day, c.automatic);
        EXPECT_EQ(p.share->getNbrShareOperations(), 2U) << c.why;
    }
}

TEST(AutomaticSaleTest, TheNextStateRemovesTheTransferAndReplaysTheSaleWithoutCash)
{
    HundredShares p(10, 0.25F); // sold on the 29th day
    const float cash = p.at(0)->getAccountState(0)->getCash();
    ASSERT_EQ(p.main->getNbrOperations(), 2U);
    for (const auto& [day, quantity] : {std::pair(28, 100), {29, 0}, {60, 0}}) {
        const State* state = p.at(day);
        EXPECT_EQ(p.main->getNbrOperations(), 1U) << day;
        EXPECT_EQ(state->getShareState(0)->getQuantity(), quantity) << day;
        EXPECT_EQ(state->getAccountState(0)->getCash(), cash) << day;
        EXPECT_EQ(p.share->getNbrShareOperations(), 2U) << "neither removed nor made again, day " << day;
    }
}
