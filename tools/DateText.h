#pragma once

#include "foundation/Date.h"

#include <optional>
#include <string_view>

/// Reads a date written as DD/MM/YYYY or, after ISO 8601, as YYYY-MM-DD. Day and month may lack their leading zero.
/// @return nothing for any other text, and for a day that the calendar does not have.
std::optional<Date> parseDate(std::string_view text);
