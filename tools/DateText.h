#pragma once

#include "foundation/Date.h"

#include <optional>
#include <string>
#include <string_view>

/// Reads a date written as DD/MM/YYYY or, after ISO 8601, as YYYY-MM-DD. Day and month may lack their leading zero.
/// @return nothing for any other text, and for a day that the calendar does not have.
std::optional<Date> parseDate(std::string_view text);

/// The dates of a command line are DD/MM/YYYY, the form that the program shows and takes everywhere else; not the ISO
/// form that tables may have.
/// @return what is wrong with `text`; empty when it is a date.
std::string checkDateArgument(const std::string& text);

/// The date of a text that `checkDateArgument` has passed; today, local time, for an empty one.
Date dateArgument(const std::string& text);
