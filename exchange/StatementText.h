#pragma once

#include "foundation/Date.h"

#include <optional>
#include <string>
#include <string_view>

/// A number as statements write it: "1.234,50", "($2,251.95)", "2 500,00", "12,50-", "EUR 7.5", "31,00 S".
///
/// Thousands may stand apart by a blank, an apostrophe, or whichever of point and comma is not the decimal mark. Which
/// one that is cannot be told of "1,234" alone, and a reader that guesses is wrong by a factor of 1000: so a number is
/// read in two steps.
class WrittenNumber {
public:
    /// Nothing for a text that is no number.
    static std::optional<WrittenNumber> read(std::string_view text);
    /// Whether a cell has no number: it is blank, or "-", "N/A" or "NA".
    static bool isNone(std::string_view text);

    /// '.' or ',' when this number shows what its decimal mark is; 0 when it shows nothing.
    char decimalMark() const;
    /// Whether its value depends on the decimal mark.
    bool needsDecimalMark() const;
    /// @param mark '.' or ','; 0 when it is not known, which is enough for a number that does not need it.
    /// @return nothing when the number cannot be one with that mark. A percentage is given as a fraction.
    std::optional<double> value(char mark) const;
    /// The letters beside the number, such as "EUR"; often none.
    const std::string& unit() const { return unit_; }

private:
    bool takeUnits(std::string_view front, std::string_view back);
    bool isGrouped(std::string_view whole, char separator) const;

    std::string core_; // digits, '.', ',', and ' ' for every kind of blank and apostrophe between digits
    std::string unit_;
    bool isNegative_ = false;
    bool isPercent_ = false;
};

/// A date as statements write it: three numbers with '/', '.' or '-' between, the year in front or at the end, perhaps
/// with a time behind; eight digits, with the year in front; or with the name of the month, "5 Jan 2026".
struct WrittenDate {
    /// Nothing for a text that does not look like a date.
    static std::optional<WrittenDate> read(std::string_view text);

    /// Undefined for a day that the calendar does not have.
    /// @param isMonthFirst makes no difference when the order is known.
    Date date(bool isMonthFirst) const;

    bool isOrderKnown; // `first` is the month: the year stands in front, or the month is a name
    int first, second; // day and month, in the order in which they stand
    int year;
};
