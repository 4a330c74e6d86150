#pragma once

#include <optional>

class Catalogue;
class Currency;
class Date;
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

/// `amount` of `currency` in the reference currency, at the rates of `day`; nothing where there is no such rate, or no
/// reference currency.
std::optional<double> inReference(double amount, const Currency& currency, const Catalogue& catalogue, const Date& day);
