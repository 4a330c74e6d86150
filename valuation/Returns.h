#pragma once

#include "valuation/AnnualReturn.h"
#include "valuation/Evolution.h"

#include <span>

/// The returns of a wallet over a range of days, by an evolution that leads up to its last day.
///
/// The range begins on the first operation date, all deposits counted, or on a later day `from`: then the value at that
/// day's end counts as put in, and deposits count from the next day on. Deposits are the operations of that kind:
/// transfers, income and charges are none. Each counts at the rate of its day.
struct Returns {
    AnnualReturn moneyWeighted;
    AnnualReturn timeWeighted;

    /// Of no range.
    Returns() = default;
    /// `evolution` is by date, from the first operation to the last day, as `evolutionByDate` gives it. Where there are
    /// no daily values, only the last one, the money-weighted return is known unless the range begins later. `from` may
    /// be undefined.
    Returns(const Wallet& wallet, const Catalogue& catalogue, std::span<const EvolutionPoint> evolution,
            const Date& firstOperation, const Date& from);
};
