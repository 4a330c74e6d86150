#include "valuation/Totals.h"

#include "market/Catalogue.h"
#include "market/Currency.h"
#include "valuation/Appraisal.h"
#include "valuation/State.h"

#include <cmath>

namespace {

constexpr double kDaysInYear = 365.25;

float annualRevenueOf(const State& state, double profit)
{
    // No time has passed, or nothing was put in: there is no revenue per year.
    if (state.getDate() <= state.getFirstOperationDate() || state.getTotalDeposit() == 0)
        return 0;
    const int days = state.getDate() - state.getFirstOperationDate();
    return static_cast<float>(kDaysInYear / days * profit / state.getTotalDeposit());
}

} // namespace

Totals::Totals(const State& state, const Catalogue& catalogue)
{
    Appraisal appraisal(catalogue);
    if (!appraisal.hasReference())
        return;
    // From here on the deposit is known; the others stay 0 where they would be divided by a rate of 0.
    isKnown = true;
    reference = catalogue.getReferenceCurrency();
    totalDeposit = state.getTotalDeposit();
    if (reference->getRealQuote(state.getDate()) == 0)
        return;
    totalValue = appraisal.totalValue(state);
    profit = totalValue - totalDeposit;
    annualRevenue = annualRevenueOf(state, profit);
}

std::optional<double> inReference(double amount, const Currency& currency, const Catalogue& catalogue, const Date& day)
{
    const Currency* reference = catalogue.getReferenceCurrency();
    if (reference == nullptr || currency.getNbrQuotes() == 0)
        return std::nullopt;
    const double value = amount * currency.getRealQuote(day) / reference->getRealQuote(day);
    return std::isfinite(value) ? std::optional(value) : std::nullopt;
}
