#include "valuation/TimeWeightedReturn.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr double kDaysInYear = 365;

} // namespace

double TimeWeightedReturn::withoutRest(double value)
{
    constexpr double kRest = 1e-6;
    largest_ = std::max(largest_, value);
    return value < 0 && value > -kRest * largest_ ? 0 : value;
}

void TimeWeightedReturn::addDay(double value, double deposited, double withdrawn)
{
    const double dividend = withoutRest(value + withdrawn), divisor = withoutRest(value_ + deposited);
    value_ = value;
    if (dividend == 0 && divisor == 0)
        return;
    // Once a day has no growth, the range has none. What is no number is neither.
    if (!(divisor > 0) || !(dividend >= 0))
        isKnown_ = false;
    growth_ *= dividend / divisor;
}

AnnualReturn TimeWeightedReturn::result(int days) const
{
    if (days <= 0)
        return AnnualReturn(AnnualReturn::Kind::kNoDay);
    if (!isKnown_)
        return AnnualReturn(AnnualReturn::Kind::kNoRate);
    return AnnualReturn(std::pow(growth_, kDaysInYear / days) - 1);
}
