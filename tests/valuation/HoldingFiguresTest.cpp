#include "valuation/HoldingFigures.h"

#include "market/NoteCompanyEvent.h"
#include "tests/support/SmallPortfolio.h"
#include "valuation/ShareState.h"
#include "valuation/State.h"

#include <cmath>
#include <gtest/gtest.h>
#include <string>

namespace {

std::string textOf(const HoldingSums& s)
{
    std::string text;
    for (const double sum : {s.bought, s.sold, s.costs, s.income, s.realisedGain, s.unrealisedGain.value_or(-1)})
        text += std::to_string(std::lround(sum * 100)) + ' ';
    return text;
}

} // namespace

// In dollars, at 2 euros on the first day, 3 from day 5 on and 4 from day 20 on: 10 at 100, 10 more at 130, so at 115;
// 5 sold at 125 gain 50, 15 are left. In euros these are 2000 and 3900, so 295 each; 5 sold for 1875 gain 400, and 15
// at 140, for 8400, gain 3975.
TEST(HoldingFiguresTest, AreTheSumsByHandInBothCurrencies)
{
    SmallPortfolio p;
    p.wallet.setBuyRateCost(0);
    p.wallet.setSellRateCost(0.01F);
    Account* cash = addAccount(p.wallet, "Cash", p.dollar);
    Account* euros = addAccount(p.wallet, "Euros", p.euro);
    auto* share = new Share(&p.wallet, p.beta);
    new CurrencyQuote(p.dollar, daysAfterStart(5), 3);
    new CurrencyQuote(p.dollar, daysAfterStart(20), 4);
    new CompanyQuote(p.beta, kStart, 140);
    trade(share, cash, 0, 10, 100, 4);
    trade(share, cash, 5, 10, 130, 4);
    trade(share, cash, 10, -5, 125, 2);
    const auto income = [&p](Account* account, int day, float amount, const char* text) {
        transfer(account, account, day, 0)->setCost(-amount);
        new NoteCompanyEvent(p.beta, daysAfterStart(day), "Dividend", text);
    };
    income(cash, 6, 30, "30.00 USD to Cash");
    income(euros, 7, 60, "60.00 EUR to Euros");
    income(euros, 8, 77, "70.00 EUR to Euros"); // of another amount
    new NoteCompanyEvent(p.alpha, daysAfterStart(7), "Split", "60.00 EUR to Euros");
    transfer(cash, cash, 9, 0)->setCost(-50); // interest
    const struct {
        const char* why;
        Date from;
        int day;
        const char *own, *inReference;
    } cases[] = {{"all", {}, 20, "230000 62500 1625 5000 5000 37500 ", "590000 187500 4475 15000 40000 397500 "},
                 {"behind the first purchase", kStart, 20, "130000 62500 1225 5000 5000 37500 ",
                  "390000 187500 3675 15000 40000 397500 "},
                 {"behind all", daysAfterStart(10), 20, "0 0 0 0 0 37500 ", "0 0 0 0 0 397500 "},
                 {"before the second purchase", {}, 4, "100000 0 400 0 0 40000 ", "200000 0 800 0 0 80000 "}};
    for (const auto& c : cases) {
        const State state(&p.wallet, daysAfterStart(c.day), false);
        const auto figures = holdingFigures(state, p.catalogue, c.from);
        ASSERT_EQ(figures.size(), 1U);
        EXPECT_EQ(textOf(figures[0].own), c.own) << c.why;
        EXPECT_EQ(textOf(figures[0].inReference.value()), c.inReference) << c.why;
    }
    // Of two notes that look alike, for one income, nobody knows which is right.
    new NoteCompanyEvent(p.alpha, daysAfterStart(6), "Dividend", "30.00 USD to Cash");
    const State state(&p.wallet, daysAfterStart(20), false);
    EXPECT_EQ(holdingFigures(state, p.catalogue, {})[0].own.income, 20);
    p.catalogue.setReferenceCurrency(nullptr);
    EXPECT_FALSE(holdingFigures(state, p.catalogue, {})[0].inReference);
}

// Below zero, through it, and up to it again.
TEST(HoldingFiguresTest, GainsGoByTheBuyQuoteOfTheHolding)
{
    std::mt19937 random(3);
    SmallPortfolio p;
    Account* cash = addAccount(p.wallet, "Cash", p.euro);
    auto* share = new Share(&p.wallet, p.alpha);
    new CompanyQuote(p.alpha, kStart, 17);
    double received = 0; // by sales, less what purchases took
    for (int day = 0; day < 60; ++day) {
        const int quantity = static_cast<int>(below(random, 7)) - (day < 20 ? 4 : 2);
        const float quote = 10 + static_cast<float>(below(random, 20));
        if (quantity != 0)
            trade(share, cash, day, quantity, quote);
        received -= static_cast<double>(quantity) * quote;
        const State state(&p.wallet, daysAfterStart(day), false);
        const ShareState& holding = *state.getShareState(0);
        const double unrealised = holding.worth() - static_cast<double>(holding.getBuyQuote()) * holding.getQuantity();
        const HoldingSums sums = holdingFigures(state, p.catalogue, {})[0].own;
        EXPECT_NEAR(sums.unrealisedGain.value_or(0), unrealised, 1e-3);
        EXPECT_NEAR(sums.realisedGain, received + holding.worth() - unrealised, 1e-3);
    }
}
