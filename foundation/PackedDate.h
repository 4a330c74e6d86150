#pragma once

#include "foundation/Date.h"
#include "foundation/FieldIO.h"

#include <compare>
#include <cstdint>

/// A date as one number that orders as dates do: what objects of which there are millions keep of a `Date`.
class PackedDate {
public:
    /// The undefined date.
    PackedDate() : PackedDate(Date()) {}
    PackedDate(const Date& date) : key_(date.key()) {}

    Date date() const
    {
        return {static_cast<short>(key_ ^ kSmallSign), static_cast<short>(key_ >> kMonth ^ kSmallSign),
                static_cast<int>(key_ >> kYear ^ kSign)};
    }

    auto operator<=>(const PackedDate&) const = default;

    /// From the bytes of the file form, in which the numbers stand as they do here, but for their signs.
    void decode(const unsigned char* bytes)
    {
        key_ = (static_cast<std::uint64_t>(decodeInt(bytes + 4)) << kYear | decodeInt(bytes)) ^ kSigns;
    }

private:
    // The year stands above the month, and that above the day. Flipping the sign of each puts negative ones first.
    static constexpr int kMonth = 16;
    static constexpr int kYear = 32;
    static constexpr std::uint32_t kSmallSign = 0x8000;
    static constexpr std::uint32_t kSign = 0x80000000;
    static constexpr std::uint64_t kSigns = 0x8000000080008000;

    std::uint64_t key_;
};
