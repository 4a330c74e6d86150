#pragma once

#include <cmath>
#include <limits>

/// A return per year of 365 days, or why there is none.
struct AnnualReturn {
    enum class Kind {
        kRate,         ///< `rate` is it
        kNoDay,        ///< the range has no day
        kNoRate,       ///< none above -100 % says how the values came about, or none that a number can hold
        kSeveralRates, ///< several do
        kTooManyDays,  ///< it goes by the values of all days, and there are too many
    };

    Kind kind = Kind::kNoDay;
    double rate = 0; ///< a fraction: 0.05 for 5 %

    AnnualReturn() = default;
    explicit AnnualReturn(Kind why) : kind(why) {}
    /// A gain of a few days can be beyond all numbers within a year. What reports write is a float.
    explicit AnnualReturn(double fraction)
    {
        if (std::abs(fraction) <= std::numeric_limits<float>::max()) {
            kind = Kind::kRate;
            rate = fraction;
        } else
            kind = Kind::kNoRate;
    }

    bool isKnown() const { return kind == Kind::kRate; }
    /// Why there is none, in a few words; empty for a rate.
    const char* reason() const
    {
        constexpr const char* kReasons[] = {"", "no day", "no rate", "several rates", "too many days"}; // by kind
        return kReasons[static_cast<int>(kind)];
    }
};
