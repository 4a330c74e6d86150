#pragma once

#include "foundation/Date.h"

#include <vector>

class Catalogue;
class State;
class Wallet;

/// What came of an evolution.
enum class EvolutionOutcome {
    kBuilt,       ///< a state for every day from the first operation up to the current state's day
    kBadFirstDay, ///< the first operation, or the day to end at, has no real date: no daily states
    kTooLong,     ///< too many days for that many holdings: no daily states
};

/// Recomputes the states of `wallet`: destroys all of them, builds the current one for `date`, with automatic sales
/// when `previsions` is set, and, when `outcome` is given, the daily ones of the evolution behind it. The daily states
/// remove the automatic operations of the accounts again, as every state does; an evolution that is refused does so,
/// too.
/// @return the current state, owned by the wallet; null when `date` is undefined.
State* refreshStates(Wallet& wallet, const Date& date, bool previsions, EvolutionOutcome* outcome);

/// Gives back the memory that removed states have left for those of the next valuation. To be called when a portfolio
/// goes; as long as any state is there, nothing happens.
void releaseStateMemory();

/// One point of the evolution chart.
struct EvolutionPoint {
    Date date;
    float totalValue;   // in the reference currency
    float totalDeposit; // as the state has it: each deposit at the rate of its own day
};

/// The totals of every state of the wallet, in the order of its list: the current state first, then the daily
/// ones. Empty without a reference currency.
std::vector<EvolutionPoint> evolutionPoints(const Wallet& wallet, const Catalogue& catalogue);
/// The same by ascending date; of two of a day the current state first.
std::vector<EvolutionPoint> evolutionByDate(const Wallet& wallet, const Catalogue& catalogue);
