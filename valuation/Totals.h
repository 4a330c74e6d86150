#pragma once

class Catalogue;
class Currency;
class State;

/// The four totals shown for a state, in the reference currency; all 0 without one.
///
/// A total that would be divided by zero is 0: value, profit and revenue when the reference currency's rate is 0, the
/// revenue when nothing was deposited.
struct Totals {
    bool isKnown = false; // false without a reference currency
    const Currency* reference = nullptr;
    float totalDeposit = 0;
    float totalValue = 0;
    float profit = 0;        // value - deposit
    float annualRevenue = 0; // 365.25 / days since the first operation * profit / deposit, a fraction per year

    Totals() = default;
    Totals(const State& state, const Catalogue& catalogue);
};
