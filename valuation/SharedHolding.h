#pragma once

#include "valuation/Holding.h"

#include <cstdint>
#include <utility>
#include <vector>

/// A holding that the states of many days have in common, for four bytes in each: from one day to the next most stay as
/// they are, and states stand in the millions. It never changes, and lasts as long as anybody has it.
class SharedHolding {
public:
    explicit SharedHolding(const Holding& holding = {});
    SharedHolding(const SharedHolding& other) : place_(other.place_) { ++entry().users; }
    SharedHolding& operator=(SharedHolding other)
    {
        std::swap(place_, other.place_);
        return *this;
    }
    ~SharedHolding()
    {
        if (--entry().users == 0)
            free_.push_back(place_);
    }

    const Holding* operator->() const { return &entry().holding; }
    /// Valid until the next one is made.
    const Holding& operator*() const { return entry().holding; }

    /// Forgets all of them at once. Nobody who has one uses it from here on, or destroys it.
    static void forgetAll();

private:
    struct Entry {
        Holding holding;
        std::uint32_t users; // none at a free place
    };

    Entry& entry() const { return entries_[place_]; }

    static inline std::vector<Entry> entries_;
    static inline std::vector<std::uint32_t> free_; // places in `entries_`

    std::uint32_t place_;
};
