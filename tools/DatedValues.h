#pragma once

#include "foundation/Date.h"

#include <cstdint>
#include <vector>

/// Values by day, gathered in any order before they become quotes: 8 bytes each, where a quote takes 64.
class DatedValues {
public:
    struct Entry {
        std::int32_t day; // orders as the dates do; see `dateOf`
        float value;
    };

    /// The year is one of up to six digits, as every date that is read from a text.
    static std::int32_t dayOf(const Date& date);
    static Date dateOf(std::int32_t day);

    void add(std::int32_t day, float value);
    /// Puts the values in date order; of each day the one added last stays.
    /// @return how many others have gone.
    std::size_t settle();
    /// In date order after `settle`.
    const std::vector<Entry>& entries() const { return entries_; }
    void clear() { std::vector<Entry>().swap(entries_); }

private:
    std::vector<Entry> entries_;
    bool inOrder_ = true; // strictly ascending days
};
