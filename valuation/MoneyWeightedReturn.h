#pragma once

#include "valuation/AnnualReturn.h"

#include <vector>

/// The rate at which everything that was put in, and taken out again, would have come to the same: with r for it, the
/// sum of amount / (1 + r)^(days / 365) is 0.
///
/// Written with u = ln(1 + r), the sum is one of amount * exp(-u * years), and every real u is a rate above -100 %.
/// Where payments change sign more than once, several u or none may solve it.
class MoneyWeightedReturn {
public:
    /// What was put in on a day, negative for what was taken out; what is there in the end counts as taken out then.
    struct Payment {
        double days; ///< from any day on, a whole number
        double amount;
    };

    /// In any order. Payments of one day count together.
    explicit MoneyWeightedReturn(std::vector<Payment> payments);

    /// Nothing paid at all is solved by every rate, and has none.
    AnnualReturn result() const;

private:
    enum class Side { kAbove, kBelow };
    struct Term {
        double years; // from the first one on
        double amount;
    };
    /// The least and the most that a sum is on a span of u.
    struct Bounds {
        double low = 0;
        double high = 0;

        void add(double factor, double least, double most);
        bool haveSign() const { return low > 0 || high < 0; }
    };

    double weight(double u, double years) const;
    double valueAt(double u) const;
    bool hasNone(Side side, double u) const;
    double rootBetween(double low, double high) const;
    void boundsBetween(double low, double high, Bounds* value, Bounds* slope) const;
    bool touchesZero(double u) const;
    bool collectRoots(double low, double high, std::vector<double>* roots, unsigned* effort) const;

    std::vector<Term> terms_; // by time, none of 0
};
