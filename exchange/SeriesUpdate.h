#pragma once

#include "foundation/FieldIO.h"
#include "foundation/PackedDate.h"

#include <algorithm>
#include <cstddef>
#include <string>
#include <utility>
#include <vector>

/// Values of days for a series of quotes, in the order in which they came: of two of a day the later one counts.
using DatedValues = std::vector<std::pair<PackedDate, float>>;

/// How the values of tables compare with those of a file, one a day.
struct ValueCounts {
    std::size_t added = 0;
    std::size_t changed = 0;
    std::size_t equal = 0;
};

/// Whether two values are the same to the bit, or both no number.
inline bool isSameValue(float a, float b)
{
    return a == b || (a != a && b != b);
}

/// Gives `series` the values of these days and leaves those of all others, in time that does not depend on their order.
template <class Quoted, class Series>
void updateSeries(Series& series, DatedValues values, ValueCounts* counts)
{
    std::ranges::stable_sort(values, {}, &DatedValues::value_type::first);
    std::string records;
    const auto put = [&records](const PackedDate& day, float value) {
        unsigned char bytes[Quoted::kFileSize];
        day.date().encode(bytes);
        encodeFloat(bytes + Date::kFileSize, value);
        records.append(reinterpret_cast<const char*>(bytes), sizeof bytes);
    };
    const auto present = series.quotes();
    auto next = present.begin();
    const auto passUpTo = [&](const PackedDate& day) {
        for (; next != present.end() && (*next)->getPackedDate() < day; ++next)
            put((*next)->getPackedDate(), (*next)->getValue());
    };
    for (std::size_t i = 0; i < values.size(); ++i) {
        const auto& [day, value] = values[i];
        if (i + 1 < values.size() && values[i + 1].first == day)
            continue;
        passUpTo(day);
        const bool isThere = next != present.end() && (*next)->getPackedDate() == day;
        if (!isThere)
            ++counts->added;
        else
            ++(isSameValue((*next)->getValue(), value) ? counts->equal : counts->changed);
        // From here on the day's former value, if there is one, is behind `next`.
        next += isThere ? 1 : 0;
        put(day, value);
    }
    for (; next != present.end(); ++next)
        put((*next)->getPackedDate(), (*next)->getValue());
    series.setQuoteRecords(records);
}
