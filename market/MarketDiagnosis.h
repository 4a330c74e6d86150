#pragma once

#include <cstdio>
#include <string>
#include <string_view>

/// Makes a name of a file fit for the line that it is shown in: a damaged file has names of any length and bytes.
using NameText = std::string (*)(std::string_view name);

/// Whether the file begins like a market data file; a portfolio file never does. Rewinds it before.
bool looksLikeMarketFile(FILE* file);

/// Why `Catalogue::rd` has failed for this file: "the file ends in the middle of company 3 of the market NYSE". Goes
/// over the records from the beginning once more.
std::string faultOfMarketFile(FILE* file, NameText shown);

/// What every file is told of that ends within `place`, or could not be read on there.
std::string faultAtEnd(FILE* file, const std::string& place);
