#pragma once

#include "foundation/Date.h"

#include <charconv>
#include <map>
#include <string>

/// Closing prices by day.
using Closes = std::map<Date, float>;

// The pages that the fetches of net/ cut prices out of. What they read is the very float that was written.

/// A price as whole number and fraction; the latter in halves to sixty-fourths, in hundredths, or as fine as it takes.
/// A price below 2^-104, for which there is no such fraction, is a decimal number.
std::string latestQuotePage(float close);

/// A table of the three months up to the last day, oldest first; `closes` is not empty.
std::string historyPage(const Closes& closes);

/// Says that there is no such ticker; has none of the places where the fetches look for prices.
std::string noQuotesPage();

/// The shortest text that reads back to `price`.
std::string shortestText(float price, std::chars_format format);
