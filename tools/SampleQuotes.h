#pragma once

#include "foundation/Date.h"

#include <filesystem>

class Catalogue;

/// Writes a table TICKER.csv, as `pelorin-quotes` serves it, for each of the sample's companies that `catalogue` has:
/// the last 100 days up to `last`. It replaces tables that are there.
///
/// Days are weekdays, and `last` whatever it is. The prices are the company's own quotes. Where one is missing, and on
/// `last` always, the price moves on from the day before by chance, so that there is news to fetch; the same quotes
/// give the same prices. What cannot be written throws std::runtime_error.
void writeSampleQuotes(const std::filesystem::path& folder, const Catalogue& catalogue, const Date& last);
