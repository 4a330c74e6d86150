#pragma once

#include "tests/support/SmallPortfolio.h"

/// The market data that fuzzed portfolios refer to: three currencies, one of them without rates, three markets and five
/// companies, among them some with few quotes or none; and the portfolio.
struct FuzzedPortfolio : SmallPortfolio {
    FuzzedPortfolio()
    {
        auto* withoutRates = new Currency("None", "N", euro);
        catalogue.addCurrency(withoutRates);
        auto* zurich = new Market("Zurich");
        zurich->setCurrency(withoutRates);
        for (int day = 0; day < 360; day += 30)
            new CurrencyQuote(dollar, daysAfterStart(day), 1 + static_cast<float>(day) / 240);
        addHill(alpha, 50);
        addHill(beta, 3);
        addHill(new Company(zurich, "Epsilon", "F"), 20);
        new CompanyQuote(new Company(paris, "Gamma", "B"), daysAfterStart(122), 7.5F);
        new Company(york, "Delta", "B"); // the ticker of another market's company
        wallet.setCatalogue(catalogue);
    }

private:
    /// Sixteen quotes, one every ninth day: up to a top and down again.
    static void addHill(Company* company, float height)
    {
        for (int i = 0; i < 16; ++i)
            new CompanyQuote(company, daysAfterStart(9 * i), height + static_cast<float>(i < 10 ? i : 24 - 2 * i));
    }
};
