#pragma once

#include "foundation/Date.h"

#include <optional>
#include <string>
#include <string_view>

/// "05/03/1999"; empty for the undefined date.
std::string dateText(const Date& date);

/// The date that a person typed as day, month and year with "/", "." or "-" between, or as year, month and day with "-"
/// between when the year has four digits; blanks do not matter. The year is taken as it stands, so 99 is a year of the
/// first century.
/// @return the undefined date for any other text, and for a day that the calendar does not have.
Date readDate(std::string_view text);
/// The same, but a year of two digits stands for the one that ends so from 50 years before `today` to 49 behind it.
Date readShortDate(std::string_view text, const Date& today);

/// Reads a date that a program wrote, as DD/MM/YYYY or, after ISO 8601, as YYYY-MM-DD. Day and month may lack their
/// leading zero.
/// @return nothing for any other text, and for a day that the calendar does not have.
std::optional<Date> parseDate(std::string_view text);
