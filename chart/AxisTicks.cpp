#include "chart/AxisTicks.h"

#include "chart/ValueFormat.h"

#include <cmath>

namespace {

/// The smallest of 1, 2 and 5 times a power of ten from `minStep` up.
double roundStep(double minStep)
{
    constexpr double kMargin = 1 + 1e-9; // 0.2 is not less than two tenths
    const double power = std::pow(10, std::floor(std::log10(minStep)));
    for (const double factor : {1.0, 2.0, 5.0})
        if (factor * power * kMargin >= minStep)
            return factor * power;
    return 10 * power;
}

} // namespace

std::vector<AxisTick> numberTicks(const ChartRange& range, double minStep)
{
    const double step = roundStep(minStep);
    // A bound that is a multiple of the step but for rounding counts as one.
    const double first = std::ceil(range.min / step - 1e-9);
    const double last = std::floor(range.max / step + 1e-9);
    const ValueFormat format = ValueFormat::forStep(step, std::max(std::abs(range.min), std::abs(range.max)));
    std::vector<AxisTick> ticks;
    for (double i = first; i <= last; ++i) {
        const double value = (i + 0.0) * step; // 0 for -0, which would be written with its sign
        ticks.push_back({value, format(value)});
    }
    return ticks;
}

std::vector<AxisTick> levelNumberTicks(const ChartRange& range, double pixelsPerUnit, const TextWidth& width, float gap)
{
    constexpr double kStepGrowth = 1.5; // less than from any step to the next
    double minStep = static_cast<double>(width("0") + gap) / pixelsPerUnit;
    for (;;) {
        std::vector<AxisTick> ticks = numberTicks(range, minStep);
        if (areLabelsApart(ticks, pixelsPerUnit, width, gap))
            return ticks;
        // The labels overlap: the next larger step is tried. In the end a single label, or none, is left.
        minStep *= kStepGrowth;
    }
}

bool areLabelsApart(const std::vector<AxisTick>& ticks, double pixelsPerUnit, const TextWidth& width, float gap)
{
    // Where the label before ends, with the gap.
    double end = -std::numeric_limits<double>::infinity();
    for (const AxisTick& tick : ticks) {
        const double middle = tick.value * pixelsPerUnit;
        const double half = static_cast<double>(width(tick.label)) / 2;
        if (middle - half < end)
            return false;
        end = middle + half + static_cast<double>(gap);
    }
    return true;
}
