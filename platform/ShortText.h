#pragma once

#include <cstddef>
#include <string>
#include <string_view>

/// Stands where a text was cut.
constexpr const char* kEllipsis = "\u2026";

/// The end of the last whole character of UTF-8 within the first `length` bytes of `text`.
std::size_t wholeCharacters(std::string_view text, std::size_t length);

/// `text`, or when it is longer than `longest` bytes, its beginning of about that length with an ellipsis behind it.
std::string shortened(std::string_view text, std::size_t longest);
