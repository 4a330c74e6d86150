#include "valuation/MoneyWeightedReturn.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr double kDaysInYear = 365;

// Of u times the years of all payments: nearer to each other, two roots count as one.
constexpr double kApart = 1e-6;
// Likewise: where the sign of a sum has not been told on a span of this size, it touches zero there, or does not.
constexpr double kNarrowest = 1e-9;
// Less of a sum than this fraction of its terms is rounding.
constexpr double kRounding = 1e-13;
// Spans looked at. A person's payments need one to some hundreds of them.
constexpr unsigned kMostEffort = 5000;

bool haveOppositeSigns(double a, double b)
{
    return (a < 0 && b > 0) || (a > 0 && b < 0);
}

} // namespace

MoneyWeightedReturn::MoneyWeightedReturn(std::vector<Payment> payments)
{
    std::ranges::stable_sort(payments, {}, &Payment::days);
    for (std::size_t i = 0; i < payments.size();) {
        const double day = payments[i].days;
        double amount = 0;
        for (; i < payments.size() && payments[i].days == day; ++i)
            amount += payments[i].amount;
        if (amount != 0)
            terms_.push_back({terms_.empty() ? day : (day - terms_.front().years) / kDaysInYear, amount});
    }
    // The first day was needed until here.
    if (!terms_.empty())
        terms_.front().years = 0;
}

AnnualReturn MoneyWeightedReturn::result() const
{
    const auto isNumber = [](const Term& term) { return std::isfinite(term.amount); };
    const auto isIn = [](const Term& term) { return term.amount > 0; };
    const auto in = std::ranges::count_if(terms_, isIn);
    if (in == 0 || in == std::ssize(terms_) || !std::ranges::all_of(terms_, isNumber))
        return AnnualReturn(AnnualReturn::Kind::kNoRate);
    // Far enough up, the first payment outweighs all others together, far enough down the last one does.
    double low = -1, high = 1;
    while (!hasNone(Side::kAbove, high))
        high *= 2;
    while (!hasNone(Side::kBelow, low))
        low *= 2;
    // All roots are between the two from here on, and neither is one.
    std::vector<double> roots;
    unsigned effort = 0;
    const bool isTold = collectRoots(low, high, &roots, &effort);
    if (!isTold || roots.size() > 1)
        return AnnualReturn(AnnualReturn::Kind::kSeveralRates);
    return roots.empty() ? AnnualReturn(AnnualReturn::Kind::kNoRate) : AnnualReturn(std::expm1(roots.front()));
}

/// What an amount of that time counts at u. All weights of one u have a common factor, such that none is above 1.
double MoneyWeightedReturn::weight(double u, double years) const
{
    return std::exp(-u * (u >= 0 ? years : years - terms_.back().years));
}

double MoneyWeightedReturn::valueAt(double u) const
{
    double sum = 0;
    for (const Term& term : terms_)
        sum += term.amount * weight(u, term.years);
    return sum;
}

/// True only when u is no root and none lies on that side of it: not when the weighted sums of the first payments, for
/// what is above, or of the last ones, for what is below, all have one sign (Laguerre). With payments of a person they
/// do: the sums are what an account at that rate would hold.
bool MoneyWeightedReturn::hasNone(Side side, double u) const
{
    double sum = 0, least = 0, most = 0;
    const std::size_t n = terms_.size();
    for (std::size_t i = 0; i < n; ++i) {
        const Term& term = terms_[side == Side::kAbove ? i : n - 1 - i];
        const double factor = weight(u, term.years);
        if (factor == 0 && (u > 0) != (side == Side::kAbove))
            return false; // too small for a number, among the first that count here
        sum += term.amount * factor;
        least = std::min(least, sum);
        most = std::max(most, sum);
    }
    return sum != 0 && (least == 0 || most == 0);
}

/// A root between two places of opposite signs, as exactly as numbers say it.
double MoneyWeightedReturn::rootBetween(double low, double high) const
{
    constexpr double kExact = 1e-17; // the rate is of no more digits
    if (low < 0 && high > 0 && valueAt(0) == 0)
        return 0;
    const bool isLowPositive = valueAt(low) > 0;
    while (high - low > kExact) {
        const double middle = low + (high - low) / 2;
        if (middle == low || middle == high)
            break;
        (valueAt(middle) > 0) == isLowPositive ? low = middle : high = middle;
    }
    return high;
}

void MoneyWeightedReturn::Bounds::add(double factor, double least, double most)
{
    low += factor * (factor > 0 ? least : most);
    high += factor * (factor > 0 ? most : least);
}

/// Of the sum and of its slope, each multiplied by one positive function of u, which leaves the roots where they are:
/// times are counted from the middle, so that the weights of a span differ less.
void MoneyWeightedReturn::boundsBetween(double low, double high, Bounds* value, Bounds* slope) const
{
    const double middle = terms_.back().years / 2;
    const double largest = std::max(std::abs(low), std::abs(high)) * middle; // no weight is above 1
    for (const Term& term : terms_) {
        const double years = term.years - middle;
        const double atLow = std::exp(-low * years - largest), atHigh = std::exp(-high * years - largest);
        const auto [least, most] = std::minmax(atLow, atHigh);
        value->add(term.amount, least, most);
        slope->add(-term.amount * years, least, most);
    }
}

/// Whether the sum is 0 at u, but for rounding.
bool MoneyWeightedReturn::touchesZero(double u) const
{
    double sum = 0, size = 0;
    for (const Term& term : terms_) {
        const double part = term.amount * weight(u, term.years);
        sum += part;
        size += std::abs(part);
    }
    return std::abs(sum) <= kRounding * size;
}

/// Adds the roots from `low` to `high` behind those below, and stops at the second one. A span is halved until the sum
/// has one sign on it, or only rises or only falls.
/// @return false when that has taken too much effort: whether there are more is not known.
bool MoneyWeightedReturn::collectRoots(double low, double high, std::vector<double>* roots, unsigned* effort) const
{
    if (roots->size() > 1)
        return true;
    if (++*effort > kMostEffort)
        return false;
    Bounds value, slope;
    boundsBetween(low, high, &value, &slope);
    if (value.haveSign())
        return true;
    const bool isNarrow = (high - low) * terms_.back().years <= kNarrowest;
    if (!slope.haveSign() && !isNarrow) {
        const double middle = low + (high - low) / 2;
        return collectRoots(low, middle, roots, effort) && collectRoots(middle, high, roots, effort);
    }
    const double atLow = valueAt(low), atHigh = valueAt(high);
    double root = low;
    if (haveOppositeSigns(atLow, atHigh))
        root = rootBetween(low, high);
    else if (isNarrow && !slope.haveSign() ? !touchesZero(low) : atLow != 0)
        return true; // a root at the upper end is found as the next span's
    if (roots->empty() || (root - roots->back()) * terms_.back().years > kApart)
        roots->push_back(root);
    return true;
}
