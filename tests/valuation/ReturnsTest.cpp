#include "valuation/Returns.h"

#include "tests/support/SmallPortfolio.h"
#include "valuation/MoneyWeightedReturn.h"
#include "valuation/State.h"
#include "valuation/TimeWeightedReturn.h"
#include "valuation/Totals.h"

#include <cmath>
#include <gtest/gtest.h>
#include <string>

using Kind = AnnualReturn::Kind;

namespace {

constexpr int kYear = 365;

/// The returns of the wallet from `from` to that day after the start.
Returns returnsOn(SmallPortfolio& p, int day, const Date& from = {})
{
    EvolutionOutcome outcome;
    const State* state = refreshStates(p.wallet, daysAfterStart(day), false, &outcome);
    return {p.wallet, p.catalogue, evolutionByDate(p.wallet, p.catalogue), state->getFirstOperationDate(), from};
}

void expectReturn(const AnnualReturn& found, Kind kind, double rate, double digits, const std::string& what)
{
    EXPECT_EQ(found.kind, kind) << what;
    EXPECT_NEAR(found.rate, rate, digits) << what;
}

} // namespace

// Published are:
//   XIRR       the documentation of XIRR in Microsoft Excel
//   IRR        Wikipedia, Internal rate of return
//   CFA 1      CFA Institute, Quantitative Methods: shares for 200 and 225, dividends of 5, both sold for 235
//   CFA 3      CFA Institute, Evaluating Portfolio Performance: 30 days at 0.0009536 a day
//   Oil pump   Lorie and Savage, Three Problems in Rationing Capital (1955): 25 % and 400 %
//   Two, none  Hirshleifer, On the Theory of Optimal Investment Decision (1958): 100 % and 200 %; no rate
TEST(ReturnsTest, MoneyWeightedOnesAreThoseOfPublishedExamples)
{
    using enum Kind;
    const struct {
        const char* what;
        std::vector<MoneyWeightedReturn::Payment> paid; // into it
        Kind kind;
        double rate = 0, digits = 0;
    } cases[] = {
        {"XIRR", {{0, 10000}, {60, -2750}, {303, -4250}, {411, -3250}, {456, -2750}}, kRate, 0.373362535, 5e-9},
        {"IRR", {{0, 123400}, {kYear, -36200}, {2 * kYear, -54800}, {3 * kYear, -48100}}, kRate, 0.0596, 5e-5},
        {"CFA 1", {{0, 200}, {kYear, 225}, {kYear, -5}, {2 * kYear, -480}}, kRate, 0.0939, 5e-5},
        {"CFA 3", {{0, 1e6}, {5, 30000}, {16, 20000}, {30, -1.08e6}}, kRate, std::pow(1.0009536, kYear) - 1, 5e-5},
        {"Oil pump", {{0, 1600}, {kYear, -10000}, {2 * kYear, 10000}}, kSeveralRates},
        {"Two", {{0, 1}, {kYear, -5}, {2 * kYear, 6}}, kSeveralRates},
        {"None", {{0, 1}, {kYear, -3}, {2 * kYear, 2.5}}, kNoRate},
        {"10 % twice over is one rate", {{0, 100}, {kYear, -220}, {2 * kYear, 121}}, kRate, 0.1, 1e-6},
        {"three rates", {{0, 1000}, {kYear, -3600}, {2 * kYear, 4310}, {3 * kYear, -1716}}, kSeveralRates},
        {"one, at three signs", {{0, 90}, {10, -20}, {20, 30}, {kYear, -110}}, kRate, 0.101159, 1e-6},
        {"nothing gained", {{0, 100}, {7, 50}, {30, -150}}, kRate, 0, 0},
        {"a loss", {{0, 100}, {2 * kYear, -25}}, kRate, -0.5, 1e-15},
        {"days, in any order", {{1, -120}, {0, 100}}, kRate, std::pow(1.2, kYear) - 1, 1e16},
        {"beyond all numbers", {{0, 1}, {1, -10}}, kNoRate},
        {"everything lost", {{0, 100}, {10, 20}}, kNoRate},
        {"nothing at all", {{0, 0}}, kNoRate}};
    for (const auto& c : cases)
        expectReturn(MoneyWeightedReturn(c.paid).result(), c.kind, c.rate, c.digits, c.what);
}

// Published are, besides those above:
//   Adds, withdraws   Investopedia, Time-Weighted Rate of Return: 9.79 % for both investors
//   CFA 1             15 % and 6.67 %, 10.76 % a year
//   CFA 3             2.92 % in 30 days
TEST(ReturnsTest, TimeWeightedOnesAreThoseOfPublishedExamples)
{
    struct Day {
        double value, deposited, withdrawn;
    };
    using enum Kind;
    const struct {
        const char* what;
        std::vector<Day> days;
        int length;
        Kind kind;
        double growth = 0, digits = 0; // within the range, and not within a year
    } cases[] = {
        {"Adds", {{1e6, 1e6, 0}, {1162484, 0, 0}, {1262484, 1e5, 0}, {1192328, 0, 0}}, kYear, kRate, 0.0979, 5e-5},
        {"Withdraws", {{1e6, 1e6, 0}, {1162484, 0, 0}, {1062484, 0, 1e5}, {1003440, 0, 0}}, kYear, kRate, 0.0979, 5e-5},
        {"CFA 1", {{200, 200, 0}, {225, 0, 5}, {450, 225, 0}, {0, 0, 480}}, 2 * kYear, kRate, 0.22678, 1.2e-4},
        {"CFA 3",
         {{1e6, 1e6, 0}, {1.015e6, 0, 0}, {1.045e6, 3e4, 0}, {1.04e6, 0, 0}, {1.08e6, 2e4, 0}},
         30,
         kRate,
         0.0292,
         5e-5},
        {"both on one day, 0.9 is left", {{100, 100, 0}, {60, 50, 75}}, kYear, kRate, -0.1, 1e-15},
        {"days without anything", {{0, 0, 0}, {100, 100, 0}, {0, 0, 110}, {0, 0, 0}}, kYear, kRate, 0.1, 1e-15},
        {"only rounding left", {{100, 100, 0}, {-0.00005, 0, 110}, {0, 0, 0}}, kYear, kRate, 0.1, 1e-6},
        {"everything lost", {{100, 100, 0}, {0, 0, 0}, {0, 0, 0}}, kYear, kRate, -1, 0},
        {"something out of nothing", {{1, 0, 0}}, kYear, kNoRate},
        {"debts", {{100, 100, 0}, {-1, 0, 0}}, kYear, kNoRate},
        {"debts, and out of them", {{-1, 0, 1}, {100, 0, 0}}, kYear, kNoRate},
        {"no day", {{110, 100, 0}}, 0, kNoDay}};
    for (const auto& c : cases) {
        TimeWeightedReturn growth;
        for (const Day& day : c.days)
            growth.addDay(day.value, day.deposited, day.withdrawn);
        AnnualReturn result = growth.result(c.length);
        if (result.isKnown())
            result.rate = std::pow(1 + result.rate, static_cast<double>(c.length) / kYear) - 1;
        expectReturn(result, c.kind, c.growth, c.digits, c.what);
    }
}

// 100 dollars at a rate of 2 are 200 euros, of which 20 come as income and 5 go as a charge. 215 on the day before the
// second deposit are 7.5 %; then 430, of which 43 more are made.
TEST(ReturnsTest, TheRangeBeginsWithTheFirstOperationOrLater)
{
    SmallPortfolio p;
    Account* dollars = addAccount(p.wallet, "Dollars", p.dollar);
    Account* euros = addAccount(p.wallet, "Euros", p.euro);
    deposit(dollars, 0, 100);
    transfer(dollars, dollars, 10, 0)->setCost(-10);
    transfer(dollars, dollars, 11, 2.5F)->setRateCost(1);
    deposit(euros, kYear, 315);
    deposit(euros, kYear, -100);
    transfer(euros, euros, kYear + 5, 0)->setCost(-43);
    deposit(addAccount(p.wallet, "Nowhere", nullptr), 1, 1000);
    const double yearly = std::pow(1.075 * (430 + 100.0) / (215 + 315) * 473 / 430, 0.5) - 1;
    const struct {
        const char* why;
        int day;
        Date from;
        Kind kind;
        double moneyWeighted, timeWeighted;
    } cases[] = {
        {"all", 2 * kYear, {}, Kind::kRate, 0.09158, yearly},
        {"before all", 2 * kYear, daysAfterStart(-1), Kind::kRate, 0.09158, yearly},
        {"what is there on the day counts, with its deposits", 2 * kYear, daysAfterStart(kYear), Kind::kRate, 0.1, 0.1},
        {"a year, to the day before the deposits", kYear - 1, {}, Kind::kRate, 0.0752, 0.0752},
        {"the first day alone", 0, {}, Kind::kNoDay, 0, 0},
        {"a range that ends before it begins", kYear, daysAfterStart(kYear + 1), Kind::kNoDay, 0, 0}};
    for (const auto& c : cases) {
        const Returns returns = returnsOn(p, c.day, c.from);
        expectReturn(returns.moneyWeighted, c.kind, c.moneyWeighted, 5e-5, c.why);
        expectReturn(returns.timeWeighted, c.kind, c.timeWeighted, 5e-5, c.why);
    }
}

namespace {

float tenths(std::mt19937& random)
{
    return static_cast<float>(below(random, 100)) / 10;
}

/// A portfolio that trades, and whose dollars rise and fall.
void fill(SmallPortfolio& p, std::mt19937& random, int days)
{
    Account* accounts[] = {addAccount(p.wallet, "Euros", p.euro), addAccount(p.wallet, "Dollars", p.dollar)};
    Share* shares[] = {new Share(&p.wallet, p.alpha), new Share(&p.wallet, p.beta)};
    for (int day = 0; day <= days; day += 3) {
        new CurrencyQuote(p.dollar, daysAfterStart(day), 1 + tenths(random) / 10);
        new CompanyQuote(p.alpha, daysAfterStart(day), 20 + tenths(random));
        new CompanyQuote(p.beta, daysAfterStart(day), 30 + tenths(random));
    }
    for (Account* account : accounts)
        deposit(account, 0, 10000);
    for (int i = 0; i < 40; ++i) {
        const unsigned which = below(random, 2);
        const int day = static_cast<int>(below(random, static_cast<unsigned>(days) + 1));
        deposit(accounts[which], day, static_cast<float>(below(random, 4000)) - 1500);
        trade(shares[which], accounts[which], day, static_cast<int>(below(random, 30)) + 1, 25, 5);
        if (i % 4 == 0)
            transfer(accounts[0], accounts[1], day, 100)->setFromCurrencyQuote(0.5F);
    }
}

/// What the deposits of a day put in and the withdrawals take out.
std::pair<double, double> movedOn(const SmallPortfolio& p, const Date& day)
{
    double in = 0, out = 0;
    for (const Account* account : p.wallet.accounts())
        for (const Operation* operation : account->operations())
            if (const auto* moved = dynamic_cast<const DepositAccountOperation*>(operation);
                moved && moved->getDate() == day)
                (moved->getAmount() > 0 ? in : out) +=
                    std::abs(static_cast<double>(moved->getAmount()) * account->currency()->getRealQuote(day));
    return {in, out};
}

} // namespace

TEST(ReturnsTest, RandomPortfoliosHaveTheReturnsOfAnIndependentComputation)
{
    constexpr int kDays = 200;
    for (unsigned seed = 1; seed <= 24; ++seed) {
        std::mt19937 random(seed);
        SmallPortfolio p;
        fill(p, random, kDays);
        const int begin = seed % 3 == 0 ? static_cast<int>(below(random, kDays - 50)) : 0;
        const Returns returns = returnsOn(p, kDays, daysAfterStart(begin));
        long double sum = 0; // of the logarithms
        std::vector<double> payments;
        double value = 0;
        for (int day = begin; day <= kDays; ++day) {
            const Date date = daysAfterStart(day);
            const State state(&p.wallet, date, false); // replayed by itself
            const double after = Totals(state, p.catalogue).totalValue;
            const auto [in, out] = movedOn(p, date);
            if (day > begin || begin == 0)
                sum += std::log((after + out) / (value + in));
            payments.push_back(day == begin && begin > 0 ? after : in - out);
            value = after;
        }
        ASSERT_EQ(returns.moneyWeighted.kind, Kind::kRate) << seed;
        long double account = 0; // that is paid into at the end of each day, and grows at the rate that was found
        for (const double payment : payments)
            account =
                account * std::pow(1 + static_cast<long double>(returns.moneyWeighted.rate), 1.0L / kYear) + payment;
        EXPECT_NEAR(static_cast<double>(account), value, 1e-6) << seed;
        const double timeWeighted = std::exp(static_cast<double>(sum) * kYear / (kDays - begin)) - 1;
        expectReturn(returns.timeWeighted, Kind::kRate, timeWeighted, 1e-10, std::to_string(seed));
    }
}
