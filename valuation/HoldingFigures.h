#pragma once

#include "foundation/Date.h"

#include <optional>
#include <vector>

class Catalogue;
class State;

/// What a holding came to within a range of days, in one currency. Without the costs, which stand apart,
///     realised gain + unrealised gain = sold - bought + worth
/// where the range begins with the first operation. The gain of a sale is over the average purchase price, as the buy
/// quote of a holding has it.
struct HoldingSums {
    double bought = 0; ///< quantity times quote of the purchases
    double sold = 0;   ///< the same of the sales
    double costs = 0;  ///< of both: by the wallet's present rates, and fixed ones
    double income = 0; ///< what the company has paid
    double realisedGain = 0;
    /// At the end of the range, of what is held then; nothing where the company has no quote.
    std::optional<double> unrealisedGain;
};

/// The sums of one holding.
struct HoldingFigures {
    HoldingSums own; ///< in the currency of the company's market
    /// Each operation at the rate of its day, and the worth at that of the last one: what a currency has won or lost is
    /// part of the gains. Nothing without a reference currency, and without rates.
    std::optional<HoldingSums> inReference;

    bool isEmpty() const { return own.bought == 0 && own.sold == 0 && own.income == 0 && !own.unrealisedGain; }
};

/// The figures of each holding of `state`, in its order, for the days after `from` up to that of the state; for all
/// days when `from` is undefined. Sales that a simulation has left in a holding count as sales, as in the states built
/// since: what is to be without them is asked for before the simulation.
std::vector<HoldingFigures> holdingFigures(const State& state, const Catalogue& catalogue, const Date& from);
