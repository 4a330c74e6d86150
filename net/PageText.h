#pragma once

#include <cstddef>
#include <string_view>

/// What the parsers of both pages need.

/// The place behind the first occurrence of `marker`; `npos` when there is none.
///
/// A character that breaks a match is not taken for the start of the next: "<td>" is not found in "<<td>". Intended:
/// the servers' pages are cut where they always were.
std::size_t endOfMarker(std::string_view page, std::string_view marker);

/// The number in front of `text`, after the rules of `strtod` and `strtol`; 0 when there is none. The decimal mark is
/// '.' whatever the user's language.
double leadingNumber(std::string_view text);
long leadingInteger(std::string_view text);

/// Prices are finite and not negative, which "-0" counts as: it would keep its sign.
bool isPrice(float number);
