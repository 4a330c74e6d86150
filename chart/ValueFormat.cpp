#include "chart/ValueFormat.h"

#include <algorithm>
#include <cmath>
#include <cstdio>

namespace {

constexpr int kMostDecimals = 6;       // smaller steps are written as powers of ten,
constexpr double kSmallest = 1e-3;     // and so are all values where they are
constexpr double kGreatest = 1e9;      // below or above these
constexpr int kMostFactorDecimals = 9; // more than a float has

/// The exponent of the power of ten that is `x` or just below it; the margin lets 0.001 count as 10^-3.
int exponent(double x)
{
    return static_cast<int>(std::floor(std::log10(x) + 1e-9));
}

/// Decimals for a value of that size, between a price in cents and the worth of a portfolio.
int usualDecimals(double magnitude)
{
    constexpr double kLimits[] = {1e4, 1e3, 10};
    int decimals = 0;
    for (const double limit : kLimits)
        if (magnitude < limit)
            ++decimals;
    return decimals;
}

} // namespace

ValueFormat ValueFormat::forStep(double step, double magnitude)
{
    // As many decimals as the step itself has.
    const int decimals = std::max(0, -exponent(step));
    if (decimals <= kMostDecimals && magnitude >= kSmallest && magnitude < kGreatest)
        return {decimals, false};
    // As many digits as tell the largest value from its neighbour.
    return {std::clamp(exponent(std::max(magnitude, step)) - exponent(step), 0, kMostFactorDecimals), true};
}

ValueFormat ValueFormat::forValues(const ChartRange& range)
{
    constexpr double kPartsOfRange = 50;
    constexpr double kPartsOfValue = 100;
    const double magnitude = std::max(std::abs(range.min), std::abs(range.max));
    if (magnitude == 0)
        return {0, false};
    // Fine enough for the value itself and, where the values lie close together, for what they differ by.
    double step = magnitude / kPartsOfValue;
    if (range.length() > 0)
        step = std::min(step, range.length() / kPartsOfRange);
    ValueFormat format = forStep(step, magnitude);
    if (!format.isScientific)
        format.decimals = std::max(format.decimals, usualDecimals(magnitude));
    return format;
}

std::string ValueFormat::operator()(double value) const
{
    char text[64];
    // 0 has no power of ten.
    if (isScientific && value != 0)
        std::snprintf(text, sizeof text, "%.*e", decimals, value);
    else
        std::snprintf(text, sizeof text, "%.*f", isScientific ? 0 : decimals, value);
    return text;
}
