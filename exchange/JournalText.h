#pragma once

#include <string>

/// Numbers of journals: without exponents, with a point, and with two decimals at least, by which programs round what
/// they show.

/// Of a sum of money; see `moneyText`.
constexpr int kUnitsInOne = 10000;

/// "1234.50" for 12345000 ten-thousandths.
std::string moneyText(long long units);
/// `value`, a finite one: with nine significant digits when it is a float, "45.50" or "0.00123456789", else with 13.
std::string journalNumber(double value);
/// With so many decimals, and without a sign where all are 0.
std::string fixedText(double value, int decimals);
