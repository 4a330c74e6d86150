#include "chart/ChartZoom.h"

#include "chart/DateTicks.h"

namespace {

/// The day so many months before `day`; in a shorter month its last one. Before the first year there is none.
double monthsBefore(double day, int months)
{
    constexpr int kInYear = 12;
    const Date date = dateOfDay(day);
    const int month = date.getYear() * kInYear + date.getMonth() - 1 - months;
    if (month < kInYear)
        return -std::numeric_limits<double>::infinity();
    Date first(1, static_cast<short>(month % kInYear + 1), month / kInYear);
    first.setDay(std::min(date.getDay(), first.getMonthLength()));
    return dayNumber(first);
}

} // namespace

void ChartZoom::setBounds(const ChartRange& bounds, double least)
{
    bounds_ = bounds;
    least_ = least;
}

ChartRange ChartZoom::wished() const
{
    if (wish_.months == 0)
        return {wish_.min, wish_.max};
    return {monthsBefore(bounds_.max, wish_.months), kEnd};
}

ChartRange ChartZoom::shown() const
{
    const ChartRange range = wished();
    const ChartRange cut{std::max(range.min, bounds_.min), std::min(range.max, bounds_.max)};
    return cut.length() >= least_ ? cut : bounds_;
}

void ChartZoom::show(double min, double max)
{
    // A range that is too short grows to both sides, but not over the bounds.
    const double missing = std::max(least_ - (max - min), 0.0);
    min = std::max(min - missing / 2, bounds_.min);
    max = std::min(std::max(max + missing / 2, min + least_), bounds_.max);
    min = std::min(min, max - least_);
    wish_ = {min > bounds_.min ? min : -kEnd, max < bounds_.max ? max : kEnd, 0};
}

void ChartZoom::zoom(double x, double factor)
{
    const ChartRange range = shown();
    if (!(range.length() > 0))
        return;
    x = std::clamp(x, range.min, range.max);
    // Not shorter than the least: x would leave its place.
    factor = std::max(factor, std::min(least_ / range.length(), 1.0));
    show(x - (x - range.min) * factor, x + (range.max - x) * factor);
}

void ChartZoom::pan(double by)
{
    const ChartRange range = shown();
    by = std::clamp(by, bounds_.min - range.min, bounds_.max - range.max);
    if (by != 0)
        show(range.min + by, range.max + by);
}
