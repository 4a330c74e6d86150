#pragma once

#include "valuation/AnnualReturn.h"

/// The growth of a portfolio from day to day, whatever is put in and taken out: day by day
///     (value at the day's end + withdrawals of the day) / (value of the day before + deposits of the day)
/// all multiplied, to the power 365 / days, less 1. A day on which nothing is there, 0 / 0, counts 1.
///
/// There is none when a divisor is 0 or less, or a dividend below 0. Values are sums of floats: of what was emptied,
/// less than a millionth of the largest value so far can be left below zero, and is nothing.
class TimeWeightedReturn {
public:
    /// `value` is that of the end of the day before the first one.
    explicit TimeWeightedReturn(double value = 0) : value_(value), largest_(value) {}

    /// The next day; both sums are 0 or more.
    void addDay(double value, double deposited, double withdrawn);
    /// For a range of so many days.
    AnnualReturn result(int days) const;

private:
    double withoutRest(double value);

    double value_; // of the day before
    double largest_;
    double growth_ = 1;
    bool isKnown_ = true;
};
