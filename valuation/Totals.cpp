#include "valuation/Totals.h"

#include "market/Catalogue.h"
#include "market/Currency.h"
#include "valuation/Appraisal.h"
#include "valuation/State.h"

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
