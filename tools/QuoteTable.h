#pragma once

#include "tools/QuotePages.h"

#include <filesystem>
#include <string>

/// Adds to a table of one ticker's closing prices those that it does not have, as lines at its end, or makes the table.
///
/// All that stands in it stays byte by byte; the new lines have the columns, the separator and the decimal mark of the
/// others. Of two prices of a day the later line counts. The table is replaced at once and durably; with nothing to add
/// it is not touched. Throws std::runtime_error with one line for the user when it cannot be read as a table of text,
/// when another program changes it meanwhile, and when it cannot be written.
void addToQuoteTable(const std::filesystem::path& file, const std::string& ticker, const Closes& closes);
