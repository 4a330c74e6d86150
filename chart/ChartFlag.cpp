#include "chart/ChartFlag.h"

#include "chart/ChartSeries.h"
#include "chart/DateTicks.h"

#include <algorithm>

std::vector<PlacedFlag> placeFlags(std::span<const ChartFlag> flags, const ChartSeries& series)
{
    constexpr double kMonth = 31;
    constexpr double kTenth = 0.1;
    const ChartPoint& first = series.points.front();
    const ChartPoint& last = series.points.back();
    const double reach = std::max(kMonth, (last.x - first.x) * kTenth);
    std::vector<PlacedFlag> placed;
    for (const ChartFlag& flag : flags) {
        const double x = dayNumber(flag.date);
        // A date that is not real is no number of days, and in no range.
        if (!(x >= first.x - reach && x <= last.x + reach))
            continue;
        const double y = valueAt(series, std::clamp(x, first.x, last.x)).value_or(first.y);
        placed.push_back({flag.shape, {x, y}, flag.text});
    }
    // Of one day they stay in their order.
    std::ranges::stable_sort(placed, {}, [](const PlacedFlag& flag) { return flag.where.x; });
    return placed;
}
