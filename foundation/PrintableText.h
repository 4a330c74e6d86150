#pragma once

#include <string>
#include <string_view>

/// `bytes` as one line of UTF-8 for a terminal: what is no printable character of UTF-8 becomes '?', and what would
/// take more than 60 columns is cut with "...". Needs a UTF-8 locale for what lies outside ASCII.
std::string printable(std::string_view bytes);

/// Columns that `text` takes on a terminal; it is printable.
int displayWidth(std::string_view text);
