#include "chart/ChartDays.h"

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <limits>

namespace {

const Date& firstDay()
{
    static const Date day(1, 1, 2000);
    return day;
}

} // namespace

double dayNumber(const Date& date)
{
    constexpr int kLimit = std::numeric_limits<int>::max(); // where `Date` cuts differences
    const int days = date.isValid() ? date - firstDay() : kLimit;
    return days > -kLimit && days < kLimit ? days : std::numeric_limits<double>::quiet_NaN();
}

Date dateOfDay(double day)
{
    constexpr double kLimit = std::numeric_limits<int>::max();
    Date date = firstDay();
    return date.moveBy(static_cast<std::int64_t>(std::floor(std::clamp(day, -kLimit, kLimit))));
}
