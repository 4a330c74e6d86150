#include "tools/DatedValues.h"

#include <algorithm>

namespace {

constexpr int kDaysFactor = 32;
constexpr int kMonthsFactor = 16;

} // namespace

std::int32_t DatedValues::dayOf(const Date& date)
{
    return (date.getYear() * kMonthsFactor + date.getMonth()) * kDaysFactor + date.getDay();
}

Date DatedValues::dateOf(std::int32_t day)
{
    const int months = day / kDaysFactor;
    return Date(static_cast<short>(day % kDaysFactor), static_cast<short>(months % kMonthsFactor),
                months / kMonthsFactor);
}

void DatedValues::add(std::int32_t day, float value)
{
    inOrder_ = inOrder_ && (entries_.empty() || entries_.back().day < day);
    entries_.push_back({day, value});
}

std::size_t DatedValues::settle()
{
    if (inOrder_)
        return 0;
    // The last one of a day is found as the first one from behind.
    std::reverse(entries_.begin(), entries_.end());
    std::stable_sort(entries_.begin(), entries_.end(), [](const Entry& a, const Entry& b) { return a.day < b.day; });
    const auto sameDay = [](const Entry& a, const Entry& b) { return a.day == b.day; };
    const auto end = std::unique(entries_.begin(), entries_.end(), sameDay);
    const auto gone = static_cast<std::size_t>(entries_.end() - end);
    entries_.erase(end, entries_.end());
    inOrder_ = true;
    return gone;
}
