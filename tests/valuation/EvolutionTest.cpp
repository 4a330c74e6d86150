#include "valuation/Evolution.h"
#include "tests/support/Links.h"
#include "tests/support/StateText.h"
#include "valuation/Totals.h"

TEST(EvolutionTest, TheCurrentStateComesFirstThenEveryDayBeforeIt)
{
    SmallPortfolio p;
    deposit(addAccount(p.wallet, "Main", p.euro), 58, 100); // 28 February
    new CurrencyQuote(p.euro, kStart, 2);                   // values are divided by it, and deposits are not
    new State(&p.wallet, kStart, false);
    EvolutionOutcome outcome = EvolutionOutcome::kTooLong;
    const State* current = refreshStates(p.wallet, Date(2, 3, 1999), true, &outcome);
    EXPECT_EQ(outcome, EvolutionOutcome::kBuilt);
    EXPECT_EQ(all(p.wallet, &Wallet::getAllStates).front(), current);
    EXPECT_TRUE(current->isAutomatic());
    EXPECT_FALSE(all(p.wallet, &Wallet::getAllStates).back()->isAutomatic());

    const auto points = evolutionPoints(p.wallet, p.catalogue);
    ASSERT_EQ(points.size(), 3U);
    EXPECT_TRUE(points[0].date == Date(2, 3, 1999) && points[1].date == Date(28, 2, 1999) &&
                points[2].date == Date(1, 3, 1999));
    EXPECT_EQ(points[0].totalValue, Totals(*current, p.catalogue).totalValue);
    EXPECT_EQ(points[0].totalDeposit, Totals(*current, p.catalogue).totalDeposit);
    p.catalogue.setReferenceCurrency(nullptr);
    EXPECT_TRUE(evolutionPoints(p.wallet, p.catalogue).empty());

    EXPECT_EQ(refreshStates(p.wallet, Date(), true, &outcome), nullptr);
    EXPECT_EQ(p.wallet.getNbrStates(), 0U) << "the old states go all the same";
}

TEST(EvolutionTest, ARefusedOneLeavesNoAutomaticTransferForASaveToMakeReal)
{
    for (const bool isEvolutionAsked : {false, true}) {
        SmallPortfolio p;
        Account* from = addAccount(p.wallet, "Main", p.euro);
        addAccount(p.wallet, "Profits", p.euro)->setDefaultTransferAccount(true);
        setTrend(p.alpha, 30);
        trade(new Share(&p.wallet, p.alpha), from, 0, 100, 10); // the trend is above the profit limit
        deposit(from, -700000, 100);
        EvolutionOutcome outcome = EvolutionOutcome::kTooLong;
        refreshStates(p.wallet, daysAfterStart(1), true, isEvolutionAsked ? &outcome : nullptr);
        EXPECT_EQ(outcome, EvolutionOutcome::kTooLong);
        EXPECT_EQ(from->getNbrOperations(), isEvolutionAsked ? 2U : 3U);
    }
}

TEST(EvolutionTest, WithoutARealFirstDayOrWithTooManyThereAreNoDailyStates)
{
    constexpr auto Built = EvolutionOutcome::kBuilt, BadFirstDay = EvolutionOutcome::kBadFirstDay,
                   TooLong = EvolutionOutcome::kTooLong;
    const struct {
        const char* why;
        std::vector<Date> operations;
        int accounts;
        EvolutionOutcome outcome;
    } cases[] = {{"no operation", {}, 1, Built},
                 {"the first operation is still to come", {{2, 1, 2000}}, 1, Built},
                 {"the first operation is of the day itself", {{1, 1, 2000}}, 1, Built},
                 {"no such day", {{31, 6, 1999}}, 1, BadFirstDay},
                 {"an operation without a date", {{1, 6, 1999}, {}}, 1, BadFirstDay},
                 {"a two-digit year", {{1, 1, 99}}, 1, TooLong},
                 {"a century of very many accounts", {{1, 1, 1900}}, 600, TooLong},
                 {"a day beyond the numbers", {{1, 1, -2147483647 - 1}}, 1, TooLong}};
    for (const auto& c : cases) {
        SmallPortfolio p;
        for (int i = 0; i < c.accounts; ++i)
            addAccount(p.wallet, "Main", p.euro);
        for (const Date& date : c.operations)
            new DepositAccountOperation(date, p.wallet.getAccount(0), 100, false);
        EvolutionOutcome outcome;
        refreshStates(p.wallet, Date(1, 1, 2000), false, &outcome);
        EXPECT_EQ(outcome, c.outcome) << c.why;
        EXPECT_EQ(p.wallet.getNbrStates(), 1U) << c.why;
    }
}

namespace {

/// A portfolio of all that a file or a user can bring about, sensible or not.
class RandomPortfolio : public SmallPortfolio {
public:
    explicit RandomPortfolio(unsigned seed) : random_(seed)
    {
        stray_.setCurrency(euro); // an account of no wallet
        for (Currency* currency : {euro, dollar, euro, dollar, static_cast<Currency*>(nullptr)})
            accounts_.push_back(addAccount(wallet, "Account", currency));
        for (Company* company : {alpha, beta, static_cast<Company*>(nullptr), alpha})
            shares_.push_back(new Share(&wallet, company));
        accounts_[2]->setDefaultTransferAccount(true);
        for (int i = 0; i < 12; ++i) {
            new CompanyQuote(below(2) == 0 ? alpha : beta, date(), amount());
            new CurrencyQuote(dollar, date(), amount());
        }
        for (unsigned i = 0; i + 1 < alpha->getNbrQuotes(); i += 3)
            alpha->getQuote(i)->setDate(alpha->getQuote(i + 1)->getDate());
        deposit(accounts_[0], -5, 1000); // a real first day
        accounts_.insert(accounts_.end(), {&stray_, nullptr});
        for (int i = 0; i < 60; ++i)
            operate();
    }

private:
    unsigned below(std::size_t n) { return ::below(random_, n); }
    template <class T>
    T* pick(const std::vector<T*>& objects)
    {
        return objects[below(objects.size())];
    }
    float amount() { return static_cast<float>(below(100000)) / 300 - 20; }
    /// One of few days; now and then one that no calendar has.
    Date date() { return {static_cast<short>(below(8) == 0 ? below(40) : 1 + below(28)), 1, 1999}; }

    void operate()
    {
        Account* account = pick(accounts_);
        if (below(2) == 0 || account == nullptr) {
            const int quantity = static_cast<int>(below(20) == 0 ? random_() : below(50));
            auto* traded =
                new ShareOperation(date(), pick(shares_), below(3) != 0, quantity, amount(), false, amount());
            traded->setAccount(account);
            traded->setAutomatic(below(8) == 0);
        } else if (below(2) == 0)
            new DepositAccountOperation(date(), account, amount(), below(4) == 0);
        else {
            auto* sent = new TransferAccountOperation(date(), account, pick(accounts_), amount(), below(4) == 0);
            sent->setCost(amount());
            sent->setRateCost(amount() / 1000);
            sent->setFromCurrencyQuote(amount());
            sent->setToCurrencyQuote(amount());
        }
    }

    std::mt19937 random_;
    Account stray_;
    std::vector<Account*> accounts_;
    std::vector<Share*> shares_;
};

} // namespace

TEST(EvolutionTest, EveryDailyStateIsBitForBitTheFullReplayOfItsDay)
{
    int evolutions = 0;
    for (unsigned seed = 1; seed <= 60; ++seed) {
        RandomPortfolio p(seed);
        refreshStates(p.wallet, daysAfterStart(20), true, nullptr); // leaves automatic sales behind
        EvolutionOutcome outcome;
        refreshStates(p.wallet, daysAfterStart(45), seed % 2 == 0, &outcome);
        if (outcome != EvolutionOutcome::kBuilt) // of a short sale, an automatic sale without a real date has remained
            continue;
        ++evolutions;
        const std::vector<State*> states = all(p.wallet, &Wallet::getAllStates);
        ASSERT_EQ(states.size(), 51U);
        Links({p.euro, p.dollar}, {&p.wallet}).expectConsistent();
        for (int day = 1; day < 51; ++day) {
            const State& built = *states[static_cast<unsigned>(day)];
            const State replay(&p.wallet, daysAfterStart(day - 6), false);
            ASSERT_EQ(textOf(built), textOf(replay)) << "seed " << seed;
        }
    }
    EXPECT_GT(evolutions, 40);
}
