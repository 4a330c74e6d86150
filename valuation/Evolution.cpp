#include "valuation/Evolution.h"

#include "portfolio/Wallet.h"
#include "valuation/Appraisal.h"
#include "valuation/DailyStates.h"
#include "valuation/State.h"

#include <algorithm>
#include <cstdint>

namespace {

// A mistyped year, 99 for 1999, would ask for the states of two thousand years. Two centuries of days, and half a
// century of a thousand holdings (about 1.1 gigabytes), are more than a person's portfolio has.
constexpr std::int64_t kMostDays = 100000;
constexpr std::int64_t kMostHoldingDays = 20000000;

EvolutionOutcome buildDailyStates(Wallet& wallet, const Date& first, const Date& end)
{
    if (first >= end)
        return EvolutionOutcome::kBuilt;
    if (!first.isValid() || !end.isValid())
        return EvolutionOutcome::kBadFirstDay;
    // Refused before anything is built: the current state stands alone then.
    const std::int64_t days = end - first;
    if (days > kMostDays || days * (wallet.getNbrShares() + wallet.getNbrAccounts()) > kMostHoldingDays)
        return EvolutionOutcome::kTooLong;
    DailyStates(wallet, first, end).build();
    return EvolutionOutcome::kBuilt;
}

} // namespace

State* refreshStates(Wallet& wallet, const Date& date, bool previsions, EvolutionOutcome* outcome)
{
    // Rows and pages must not refer to a state from here on.
    wallet.removeAllStates();
    if (date.isUndefined())
        return nullptr;
    // The current state comes first in the wallet's list; the days of the evolution stand behind it.
    auto* current = new State(&wallet, date, previsions); // owned by the wallet
    if (outcome == nullptr)
        return current;
    *outcome = buildDailyStates(wallet, current->getFirstOperationDate(), date);
    // Daily states would have removed them. A save must not make transfers real that nobody has ordered.
    if (*outcome != EvolutionOutcome::kBuilt)
        wallet.removeAutomaticOperations();
    return current;
}

void releaseStateMemory()
{
    ShareState::releaseKept();
    AccountState::releaseKept();
}

std::vector<EvolutionPoint> evolutionPoints(const Wallet& wallet, const Catalogue& catalogue)
{
    std::vector<EvolutionPoint> points;
    Appraisal appraisal(catalogue);
    if (!appraisal.hasReference())
        return points;
    points.reserve(wallet.getNbrStates());
    for (const State* state : wallet.states())
        points.push_back({state->getDate(), appraisal.totalValue(*state), state->getTotalDeposit()});
    return points;
}

std::vector<EvolutionPoint> evolutionByDate(const Wallet& wallet, const Catalogue& catalogue)
{
    // The current state comes first in the wallet's list, before the days that lead to it.
    std::vector<EvolutionPoint> points = evolutionPoints(wallet, catalogue);
    std::ranges::stable_sort(points, {}, &EvolutionPoint::date);
    return points;
}
