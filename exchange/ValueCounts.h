#pragma once

#include <cstddef>

/// How values of tables compare with those of a file, one a day and series.
struct ValueCounts {
    std::size_t added = 0;
    std::size_t changed = 0;
    std::size_t equal = 0; // to what is there

    ValueCounts& operator+=(const ValueCounts& other)
    {
        added += other.added;
        changed += other.changed;
        equal += other.equal;
        return *this;
    }
};
