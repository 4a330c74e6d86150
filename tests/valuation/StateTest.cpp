#include "valuation/State.h"
#include "portfolio/CashMove.h"
#include "portfolio/OperationKind.h"
#include "tests/support/SmallPortfolio.h"
#include "valuation/AccountState.h"
#include "valuation/ShareState.h"

#include <climits>
#include <gtest/gtest.h>

namespace {

/// A portfolio with one account in euro and one holding, of a euro company, without proportional costs.
struct OneHolding : SmallPortfolio {
    OneHolding()
    {
        wallet.setBuyRateCost(0);
        wallet.setSellRateCost(0);
    }
    State at(int day) { return {&wallet, daysAfterStart(day), false}; }
    float cash(int day, unsigned i = 0) { return at(day).getAccountState(i)->getCash(); }
    int quantity(int day) { return at(day).getShareState(0)->getQuantity(); }

    Account* account = addAccount(wallet, "Main", euro);
    Share* share = new Share(&wallet, alpha);
};

} // namespace

TEST(StateTest, ATransferTakesTheLargerOfAmountAndCostAndGivesWhatIsLeft)
{
    const struct {
        float amount, rateCost, cost, from, to, taken, received;
        bool automatic;
    } cases[] = {{10, 0, 15, 1, 1, 15, -5, false},
                 {100, 0, 15, 1, 1, 100, 85, false},
                 {15, 0, 15, 1, 1, 15, 0, false},
                 {100, 0.25F, 5, 3, 2, 100, 105, false},
                 {100, 0, 15, 1, 1, 0, 0, true}}; // destroyed before the state is built
    for (const auto& c : cases) {
        OneHolding p;
        Account* to = addAccount(p.wallet, "to", p.dollar);
        withTerms(transfer(p.account, to, 1, c.amount, c.automatic), c.rateCost, c.cost, c.from, c.to);
        EXPECT_EQ(p.cash(1, 0), -c.taken) << c.amount;
        EXPECT_EQ(p.cash(1, 1), c.received) << c.amount;
    }
}

TEST(StateTest, TradesMoveTheCashWithFixedAndProportionalCosts)
{
    OneHolding p;
    Account* other = addAccount(p.wallet, "Other", nullptr);
    Account foreign; // of no wallet
    foreign.setCurrency(p.euro);
    p.wallet.setBuyRateCost(0.0017F);
    p.wallet.setSellRateCost(0.0017F);
    setTrend(p.alpha, 12);
    deposit(p.account, 0, 5000);
    deposit(other, 0, 5000); // nothing is known of an account without currency...
    trade(p.share, p.account, 0, 100, 10, 29.95F);
    trade(p.share, p.account, 5, -100, 20, 29.95F);
    trade(p.share, other, 5, 3, 2, 1); // ...but what trades move
    trade(p.share, &foreign, 6, 10, 10);
    trade(p.share, nullptr, 6, -4, 10);
    EXPECT_FLOAT_EQ(p.cash(4), 5000 - 1031.65F);
    EXPECT_FLOAT_EQ(p.cash(6), 5000 - 1031.65F + 1966.65F) << "only the quantity follows trades of foreign accounts";
    EXPECT_EQ(p.cash(4, 1), 0);
    EXPECT_FLOAT_EQ(p.cash(6, 1), -7.0102F);
    const auto trades = p.share->shareOperations();
    EXPECT_FLOAT_EQ(static_cast<float>(cashMove(*trades[0], *p.account)), -1031.65F);
    EXPECT_FLOAT_EQ(static_cast<float>(cashMove(*trades[1], *p.account)), 1966.65F);
    EXPECT_EQ(cashMove(*trades[0], *other), 0);
    EXPECT_EQ(p.at(4).getShareState(0)->getQuote(), 12);
    EXPECT_EQ(p.quantity(5), 3) << "a sale of the state's day counts";
    EXPECT_EQ(p.quantity(6), 9);
    EXPECT_EQ(p.at(5).getTotalDeposit(), 5000);
}

TEST(StateTest, ATransferWithinAnAccountIsIncomeOrChargeWhenItsValuesSaySo)
{
    constexpr auto kTransfer = OperationKind::kTransfer;
    const struct {
        float amount, rateCost, cost, from, to;
        OperationKind kind;
        float move;
    } cases[] = {{0, 0, -37.5F, 1, 1, OperationKind::kIncome, 37.5F},
                 {12.25F, 1, 0, 1, 1, OperationKind::kCharge, -12.25F},
                 {0, 0, 0, 1, 1, kTransfer, 0},
                 {0, 0, 5, 1, 1, kTransfer, -10},
                 {0, 0, -5, 2, 1, kTransfer, 10},
                 {0, 0.5F, -5, 1, 1, kTransfer, 5},
                 {-5, 1, 0, 1, 1, kTransfer, 0},
                 {5, 1, 1, 1, 1, kTransfer, -6},
                 {5, 0.5F, 0, 1, 1, kTransfer, -2.5F},
                 {5, 1, 0, 1, 2, kTransfer, -5}};
    for (const auto& c : cases)
        for (const bool isWithin : {true, false}) {
            OneHolding p;
            Account* other = addAccount(p.wallet, "Other", p.dollar);
            const auto* sent = withTerms(transfer(p.account, isWithin ? p.account : other, 1, c.amount), c.rateCost,
                                         c.cost, c.from, c.to);
            EXPECT_EQ(kindOf(*sent), isWithin ? c.kind : kTransfer) << c.amount << ' ' << c.cost;
            if (isWithin) {
                EXPECT_EQ(cashMove(*sent, *p.account), c.move) << c.amount << ' ' << c.cost;
            }
            EXPECT_EQ(cashMove(*sent, *p.account), p.cash(1, 0)) << "as the replay has it";
            EXPECT_EQ(cashMove(*sent, *other), p.cash(1, 1)) << "as the replay has it";
            EXPECT_EQ(p.at(1).getTotalDeposit(), 0);
        }
}

TEST(StateTest, BalancesAreRoundedAfterEveryMove)
{
    OneHolding p;
    constexpr float kLastWholeNumber = 16777216; // from here on a float has no odd numbers
    for (const float amount : {kLastWholeNumber, 1.0F, 1.0F, 1.0F})
        deposit(p.account, 0, amount);
    trade(p.share, p.account, 0, -1, 1);
    EXPECT_EQ(p.at(0).getTotalDeposit(), kLastWholeNumber);
    EXPECT_EQ(p.cash(0), kLastWholeNumber);
}

TEST(StateTest, AHoldingIsReplayedTradeByTrade)
{
    const struct {
        std::vector<std::array<int, 3>> trades; // day, quantity (a sale's is below zero), quote
        int quantity;
        float buyQuote;
        Date endDate;
        const char* why;
    } cases[] = {
        {{{0, 100, 10}, {10, 100, 20}}, 200, 15, daysAfterStart(90), "a second purchase leaves the end date"},
        {{{0, 10, 10}, {5, -10, 99}}, 0, 10, daysAfterStart(90), "a sale leaves price and end date"},
        {{{0, 10, 10}, {5, -10, 99}, {10, 5, 20}}, 5, 20, daysAfterStart(100), "the horizon starts again"},
        {{{0, 10, 10}, {5, -20, 99}, {10, 30, 12}}, 20, 13, daysAfterStart(100), "-10 held: 30 / 20 = 1 way on"},
        {{{0, 10, 10}, {5, -20, 99}, {10, 15, 12}}, 5, 16, daysAfterStart(120), "15 / 5 = 3 ways on"},
        {{{0, 10, 10}, {5, -20, 99}, {10, 5, 12}}, -5, 8, daysAfterStart(80), "5 / -5 = 1 way back"},
        {{{0, 10, 10}, {5, -20, 99}, {10, 10, 12}}, 0, 10, daysAfterStart(90), "-10 + 10: there is no average"},
        {{{0, -10, 10}, {5, 30, 10}}, 20, 15, Date(-1, 0, 0), "an undefined date is one day away from any other"},
        {{{0, INT_MAX, 2}, {0, INT_MAX, 4}}, -2, 3, daysAfterStart(90), "quantities wrap around"},
        {{{0, 1, 2}, {0, -INT_MAX, 2}, {10, INT_MAX, 2}}, 1, 2, daysAfterStart(90 + 10LL * INT_MAX), "ages ahead"},
    };
    for (const auto& c : cases) {
        OneHolding p;
        for (const auto& [day, quantity, quote] : c.trades)
            trade(p.share, p.account, day, quantity, static_cast<float>(quote));
        const State state = p.at(60);
        EXPECT_EQ(state.getShareState(0)->getQuantity(), c.quantity) << c.why;
        EXPECT_EQ(state.getShareState(0)->getBuyQuote(), c.buyQuote) << c.why;
        EXPECT_EQ(state.getShareState(0)->getEndDate(), c.endDate) << c.why;
    }
}

TEST(StateTest, TheFirstOperationCountsEvenWhenItIsStillToCome)
{
    OneHolding p;
    EXPECT_EQ(p.at(0).getFirstOperationDate(), Date(31, 12, 32767)) << "no operation";
    deposit(p.account, 9, 100);
    EXPECT_EQ(p.at(0).getFirstOperationDate(), daysAfterStart(9));
    new TransferAccountOperation(daysAfterStart(7), nullptr, p.account, 50, false);
    EXPECT_EQ(p.at(0).getFirstOperationDate(), daysAfterStart(7)) << "a transfer received";
    trade(p.share, p.account, 5, 10, 10);
    trade(p.share, p.account, 6, 10, 10);
    for (const int day : {0, 5, 30})
        EXPECT_EQ(p.at(day).getFirstOperationDate(), daysAfterStart(5)) << day;
    EXPECT_EQ(p.cash(4), 0);
    EXPECT_EQ(p.quantity(4), 0);
}
