#include "valuation/SplitPlan.h"
#include "market/NoteCompanyEvent.h"
#include "market/SplitCompanyEvent.h"
#include "tests/support/SmallPortfolio.h"
#include "valuation/AccountState.h"
#include "valuation/ShareState.h"
#include "valuation/State.h"

#include <cmath>
#include <gmock/gmock.h>

using testing::HasSubstr;

namespace {

constexpr int kDay = 100; // of the split

struct SplitPortfolio : SmallPortfolio {
    const SplitCompanyEvent& split(short from, short to)
    {
        return *new SplitCompanyEvent(alpha, daysAfterStart(kDay), from, to); // the company owns it
    }
    /// Carries a plan without problem out. Afterwards two plans are not the same: there is the note.
    SplitPlan apply(short from, short to, bool splitsQuotes = true)
    {
        SplitPlan plan(split(from, to), splitsQuotes);
        EXPECT_EQ(plan.problem(), "");
        plan.apply();
        return plan;
    }
    float cash(int day, Account* account) { return state(day).accountStates()[place(account)]->getCash(); }
    int held(int day) { return state(day).shareStates()[0]->getQuantity(); }
    double value(int day)
    {
        const State all = state(day);
        const ShareState& shares = *all.shareStates()[0];
        double sum = static_cast<double>(shares.getQuantity()) * shares.getQuote();
        for (const AccountState* account : all.accountStates())
            sum += account->getCash();
        return sum;
    }

    Account* main = addAccount(wallet, "Main", euro);
    Account* other = addAccount(wallet, "Other", euro);
    Share* share = new Share(&wallet, alpha);

private:
    State state(int day) { return {&wallet, daysAfterStart(day), false}; }
    std::size_t place(const Account* account) const { return account == main ? 0 : 1; }
};

} // namespace

TEST(SplitPlanTest, EachTradeBecomesWhatTheHoldingChangesBy)
{
    const struct {
        short from, to;
        std::vector<std::pair<int, float>> trades, becomes;
        int whole;
        double fraction;
        const char* why;
    } cases[] = {
        {1, 2, {{100, 40}, {-50, 50}}, {{200, 20}, {-100, 25}}, 100, 0, "one becomes two"},
        {2, 3, {{3, 40}}, {{5, 24}}, 4, 0.5, "what was paid stays: 120"},
        {3,
         2,
         {{100, 40}, {-37, 50}},
         {{67, 4000 / 67.0F}, {-25, 74}},
         42,
         0,
         "the fraction of the first goes with the sale"},
        {10, 1, {{12, 40}, {-5, 60}}, {{2, 240}, {-1, 300}}, 0, 0.7, "all but a fraction is sold"},
        {10,
         1,
         {{3, 40}, {3, 50}, {3, 60}, {3, 70}},
         {{1, 120}, {0, 500}, {0, 600}, {1, 210}},
         1,
         0.2,
         "not a share each"},
        {2, 1, {{-5, 40}}, {{-2, 100}}, -3, 0.5, "owed: -2.5 are -3 and a half"},
    };
    for (const auto& c : cases) {
        SplitPortfolio p;
        p.wallet.setSellRateCost(0.01F);
        new CompanyQuote(p.alpha, daysAfterStart(kDay - 1), 60);
        std::vector<ShareOperation*> trades;
        for (const auto& [quantity, quote] : c.trades)
            trades.push_back(trade(p.share, p.main, static_cast<int>(trades.size()), quantity, quote));
        const auto* onTheDay = trade(p.share, p.main, kDay, 7, 9);
        const float before = p.cash(kDay - 1, p.main);
        const SplitPlan plan = p.apply(c.from, c.to);
        for (std::size_t i = 0; i < trades.size(); ++i) {
            EXPECT_EQ(trades[i]->getQuantity(), std::abs(c.becomes[i].first)) << c.why << ", trade " << i;
            EXPECT_FLOAT_EQ(trades[i]->getQuote(), c.becomes[i].second) << c.why << ", trade " << i;
        }
        const double price = 60.0 * c.from / c.to;
        EXPECT_NEAR(p.cash(kDay - 1, p.main), before, 1e-2) << c.why;
        EXPECT_EQ(p.held(kDay), c.whole + 7) << c.why;
        EXPECT_NEAR(p.cash(kDay, p.main) - before + 7 * 9 * 1.0017, c.fraction * price, 1e-2) << c.why;
        EXPECT_NEAR(plan.holdings()[0].valueAfter, plan.holdings()[0].valueBefore, 1e-3) << c.why;
        EXPECT_EQ(onTheDay->getQuantity(), 7);
        EXPECT_FLOAT_EQ(p.alpha->getQuote(0U)->getValue(), static_cast<float>(price)) << c.why;
    }
}

TEST(SplitPlanTest, ARandomPastIsWorthAfterwardsWhatItWasWorthBefore)
{
    constexpr double kRounding = 0.1; // of floats of up to 50,000, from twenty trades
    std::mt19937 random(7);
    for (int round = 0; round < 300; ++round) {
        SplitPortfolio p;
        std::vector<std::int64_t> holding;
        for (int day = 0; day < 20; ++day) {
            const std::int64_t held = holding.empty() ? 0 : holding.back();
            const bool sells = held > 0 && below(random, 3) == 0;
            const int quantity = 1 + static_cast<int>(below(random, sells ? static_cast<std::size_t>(held) : 500));
            trade(p.share, below(random, 2) > 0 ? p.main : p.other, day, sells ? -quantity : quantity,
                  static_cast<float>(below(random, 9000) + 1) / 1000, 3);
            holding.push_back(sells ? held - quantity : held + quantity);
        }
        const auto from = static_cast<short>(below(random, 20) + 1);
        const auto to =
            static_cast<short>(from + 1 + static_cast<int>(below(random, 20)) - (from > 1 && round % 2 > 0 ? from : 0));
        if (from == to)
            continue;
        new CompanyQuote(p.alpha, daysAfterStart(kDay - 1), 47);
        new CompanyQuote(p.alpha, daysAfterStart(kDay), 47.0F * from / to);
        std::vector<float> cash;
        for (int day = 0; day < 20; ++day)
            cash.push_back(p.cash(day, p.main));
        const double value = p.value(kDay - 1);
        p.apply(from, to);
        for (int day = 0; day < 20; ++day) {
            const double exact = static_cast<double>(holding[static_cast<std::size_t>(day)]) * to / from;
            EXPECT_EQ(p.held(day), std::ceil(exact - 1e-9)) << from << " to " << to;
            EXPECT_NEAR(p.cash(day, p.main), cash[static_cast<std::size_t>(day)], kRounding) << from << " to " << to;
        }
        EXPECT_EQ(p.held(kDay), std::floor(static_cast<double>(holding.back()) * to / from + 1e-9));
        EXPECT_NEAR(p.value(kDay), value, kRounding) << from << " to " << to;
    }
}

TEST(SplitPlanTest, WhatCannotBeSplitIsRefusedWithAReason)
{
    const struct {
        short from, to;
        int quantity;
        float quote;
        const char* problem;
    } cases[] = {
        {0, 2, 1, 1, "above 0"},
        {1, 0, 1, 1, "above 0"},
        {-1, -2, 1, 1, "above 0"},
        {3, 3, 1, 1, "changes nothing"},
        {1, 32767, 70000, 1, "purchase of 01/01/1999 would be too large"},
        {32767, 1, 1, 3e38F, "quote of 02/01/1999"},
        {1, 32767, 1, 1e-42F, "quote of 02/01/1999"},
    };
    for (const auto& c : cases) {
        SplitPortfolio p;
        trade(p.share, p.main, 0, c.quantity, 1);
        new CompanyQuote(p.alpha, daysAfterStart(1), c.quote);
        EXPECT_THAT(SplitPlan(p.split(c.from, c.to), true).problem(), HasSubstr(c.problem)) << c.from << " to " << c.to;
    }
}

TEST(SplitPlanTest, ItIsSeenWhenItWasDoneBefore)
{
    SplitPortfolio p;
    auto* early = new CompanyQuote(p.alpha, daysAfterStart(kDay - 9), 36);
    new CompanyQuote(p.alpha, daysAfterStart(kDay - 3), 40);
    trade(p.share, p.main, 0, 10, 40);
    const SplitPlan first(p.split(1, 2), true);
    EXPECT_FALSE(first.looksSplit()) << "nothing to compare with";
    EXPECT_EQ(first, SplitPlan(p.split(1, 2), true));
    early->setValue(40);
    EXPECT_NE(first, SplitPlan(p.split(1, 2), true)) << "what was shown is not what is there";
    new CompanyQuote(p.alpha, daysAfterStart(kDay + 1), 21);
    const SplitPlan second(p.split(1, 2), true);
    EXPECT_TRUE(!second.looksSplit() && second.appliedNote() == nullptr);
    second.apply();

    // Files keep the note as any other.
    FILE* file = std::tmpfile();
    ASSERT_EQ(p.alpha->wrt(file), 0);
    std::rewind(file);
    auto* read = new Company(p.york, "", "");
    ASSERT_EQ(read->rd(file), 0);
    std::fclose(file);
    const SplitPlan third(static_cast<const SplitCompanyEvent&>(*read->events().front()), true);
    ASSERT_TRUE(third.looksSplit() && third.appliedNote() != nullptr);
    EXPECT_EQ(third.appliedNote()->getText(), "1 to 2");
    EXPECT_TRUE(third.holdings().empty() && !third.isEmpty());

    // For a portfolio that was not open then, quotes stay, and so does the value of what was bought.
    SplitPlan(p.split(1, 2), true).apply(); // once too often
    EXPECT_FLOAT_EQ(p.alpha->getQuote(0U)->getValue(), 10);
    const SplitPlan kept = p.apply(1, 2, false);
    EXPECT_FLOAT_EQ(p.alpha->getQuote(0U)->getValue(), 10);
    EXPECT_EQ(kept.priceBefore(), 20);
}
