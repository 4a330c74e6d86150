#pragma once

#include "exchange/ValueCounts.h"
#include "market/Quote.h"

#include <algorithm>
#include <cmath>
#include <vector>

/// Gives `series` the values of these days, of two of a day the later one, and leaves those of all others.
template <class Series>
void updateSeries(Series& series, std::vector<DatedValue> values, ValueCounts* counts)
{
    std::ranges::stable_sort(values, {}, &DatedValue::day);
    std::vector<DatedValue> news;
    const auto present = series.quotes();
    auto next = present.begin();
    for (std::size_t i = 0; i < values.size(); ++i) {
        const DatedValue& value = values[i];
        if (i + 1 < values.size() && values[i + 1].day == value.day)
            continue;
        while (next != present.end() && (*next)->getPackedDate() < value.day)
            ++next;
        const bool isThere = next != present.end() && (*next)->getPackedDate() == value.day;
        const float former = isThere ? (*next)->getValue() : NAN;
        const bool isEqual = former == value.value || (std::isnan(former) && std::isnan(value.value));
        ++(!isThere ? counts->added : isEqual ? counts->equal : counts->changed);
        if (!isThere || !isEqual)
            news.push_back(value);
    }
    // The series changes here only, and with it what `next` stands in.
    series.addQuotes(news);
}
