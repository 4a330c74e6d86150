#include "chart/DateTicks.h"

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <cstdio>
#include <limits>

namespace {

/// What a calendar axis goes by: every so many days, weeks, months or years.
enum class Unit { kDay, kWeek, kMonth, kYear };
struct DateStep {
    Unit unit;
    int count;
};

constexpr int kMonths = 12;

const Date& firstDay()
{
    static const Date day(1, 1, 2000);
    return day;
}

double daysOf(DateStep step)
{
    // On average: it tells only which steps are worth trying.
    constexpr double kDays[] = {1, 7, 30.44, 365.25};
    return kDays[static_cast<int>(step.unit)] * step.count;
}

std::string label(const Date& date, Unit unit)
{
    char text[40];
    if (unit == Unit::kYear)
        std::snprintf(text, sizeof text, "%d", date.getYear());
    else if (unit == Unit::kMonth)
        std::snprintf(text, sizeof text, "%d/%d", date.getMonth(), date.getYear());
    else
        std::snprintf(text, sizeof text, "%d/%d/%d", date.getDay(), date.getMonth(), date.getYear());
    return text;
}

/// Begins with the smallest multiple of `step` from `value` up.
std::int64_t roundUp(std::int64_t value, std::int64_t step)
{
    const std::int64_t rest = (value % step + step) % step;
    return rest == 0 ? value : value + step - rest;
}

std::vector<AxisTick> ticksByDays(const ChartRange& range, DateStep step)
{
    // Weeks are counted from 3 January 2000, so that the same Mondays are labelled in every chart.
    constexpr std::int64_t kFirstMonday = 2;
    const bool isWeek = step.unit == Unit::kWeek;
    const std::int64_t days = isWeek ? 7 * step.count : step.count;
    const std::int64_t shift = isWeek ? kFirstMonday : 0;
    std::vector<AxisTick> ticks;
    for (auto day = roundUp(static_cast<std::int64_t>(std::ceil(range.min)) - shift, days) + shift;
         static_cast<double>(day) <= range.max; day += days)
        ticks.push_back({static_cast<double>(day), label(dateOfDay(static_cast<double>(day)), step.unit)});
    return ticks;
}

std::vector<AxisTick> ticksByMonths(const ChartRange& range, DateStep step)
{
    const std::int64_t months = step.unit == Unit::kYear ? std::int64_t{kMonths} * step.count : step.count;
    // Months are counted from year 0, so that multiples of a step are the same in every chart.
    const Date first = dateOfDay(range.min);
    std::vector<AxisTick> ticks;
    for (auto month = roundUp(std::int64_t{first.getYear()} * kMonths + first.getMonth() - 1, months);;
         month += months) {
        const std::int64_t inYear = (month % kMonths + kMonths) % kMonths;
        const Date date(1, static_cast<short>(inYear + 1), static_cast<int>((month - inYear) / kMonths));
        const double day = dayNumber(date);
        if (!(day <= range.max)) // or it is not a number: too far away
            return ticks;
        // The month that the range begins in has its first day before, as a rule.
        if (day >= range.min)
            ticks.push_back({day, label(date, step.unit)});
    }
}

/// The steps from the finest on, by number: some that divide weeks, months and years well, then 2, 5 and 10 times a
/// power of ten years.
DateStep stepAt(std::size_t i)
{
    constexpr DateStep kSteps[] = {{Unit::kDay, 1},   {Unit::kDay, 2},   {Unit::kWeek, 1},
                                   {Unit::kWeek, 2},  {Unit::kMonth, 1}, {Unit::kMonth, 2},
                                   {Unit::kMonth, 3}, {Unit::kMonth, 6}, {Unit::kYear, 1}};
    constexpr int kYears[] = {2, 5, 10};
    if (i < std::size(kSteps))
        return kSteps[i];
    i -= std::size(kSteps);
    return {Unit::kYear, kYears[i % 3] * static_cast<int>(std::pow(10, i / 3))};
}

/// The ends of the range, or only the first day when there is no room for both.
std::vector<AxisTick> endTicks(const ChartRange& range, double pixelsPerDay, const TextWidth& width, float gap)
{
    std::vector<AxisTick> ticks;
    for (const double day : {std::ceil(range.min), std::floor(range.max)})
        if (day >= range.min && day <= range.max && (ticks.empty() || day > ticks.back().value))
            ticks.push_back({day, label(dateOfDay(day), Unit::kDay)});
    if (!areLabelsApart(ticks, pixelsPerDay, width, gap))
        ticks.pop_back();
    return ticks;
}

} // namespace

double dayNumber(const Date& date)
{
    constexpr int kLimit = std::numeric_limits<int>::max(); // where `Date` cuts differences
    // A difference that `Date` has cut is no number of days any more, so it counts as none.
    const int days = date.isValid() ? date - firstDay() : kLimit;
    return days > -kLimit && days < kLimit ? days : std::numeric_limits<double>::quiet_NaN();
}

Date dateOfDay(double day)
{
    constexpr double kLimit = std::numeric_limits<int>::max();
    Date date = firstDay();
    return date.moveBy(static_cast<std::int64_t>(std::floor(std::clamp(day, -kLimit, kLimit))));
}

std::vector<AxisTick> levelDateTicks(const ChartRange& range, double pixelsPerDay, const TextWidth& width, float gap)
{
    // No label is narrower than one digit.
    const double narrowest = static_cast<double>(width("0") + gap);
    std::vector<AxisTick> ticks;
    for (std::size_t i = 0;; ++i) {
        const DateStep step = stepAt(i);
        // Labels of that step would overlap whatever they are: no ticks are made for it.
        if (daysOf(step) * pixelsPerDay < narrowest)
            continue;
        ticks = step.unit < Unit::kMonth ? ticksByDays(range, step) : ticksByMonths(range, step);
        if (areLabelsApart(ticks, pixelsPerDay, width, gap))
            break;
    }
    // A single tick would tell the day and not the length of what is shown.
    return ticks.size() > 1 ? ticks : endTicks(range, pixelsPerDay, width, gap);
}
