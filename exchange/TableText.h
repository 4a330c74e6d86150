#pragma once

#include "foundation/Date.h"

#include <optional>
#include <string>
#include <string_view>

/// What values look like in the tables that Pelorin writes: so that they read back to the very bits.

/// Nine significant digits, which tell every float from all others: "45.5", "29.9500008", "1e+10". What is no number is
/// "nan", "inf" or "-inf".
std::string numberText(float value);
/// The float that `numberText` gave; nothing for any other text.
std::optional<float> readNumberText(std::string_view text);
std::optional<int> readCountText(std::string_view text);

/// "2025-07-20". Days that no calendar has are told as well, "1999-02-31": files may have them, and values depend on
/// them. "0000-00-00" is the undefined date.
std::string tableDate(const Date& date);
/// @return nothing for what `tableDate` never gives.
std::optional<Date> readTableDate(std::string_view text);

/// `bytes` as a cell of one line of UTF-8: a backslash becomes "\\", a line end "\n", and any other byte that is no
/// text "\x" with two digits.
std::string escaped(std::string_view bytes);
/// What `escaped` was made of; what begins like no such sign stands for itself.
std::string unescaped(std::string_view text);
