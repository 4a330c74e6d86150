#pragma once

#include <string>

/// Numbers as a person reads them. A number that is not finite is "?", and one that is too small to show has no sign.

/// "1,234.50"; from 1e15 on "1.23457e+15".
std::string amountText(double amount);
/// "1,234"
std::string countText(int count);
/// "12.34 %" for 0.1234.
std::string percentText(double fraction);
/// "0.0123 %" for 0.000123: what happens in a day, in four decimals.
std::string finePercentText(double fraction);
/// "+12.3%" for 0.123: a change, in one digit.
std::string changeText(double fraction);
/// The shortest text that reads back to the same value, with two decimals at least: "12.50", "0.00123".
std::string exactText(float value);

/// The number at the beginning of `text`, behind blanks, with "." or "," as decimal mark, and the
/// other one between thousands; 0 for a text without one.
double readNumber(const std::string& text);
/// The same for a count, which has no decimals: there a mark in front of the last three digits parts thousands, too.
double readCount(const std::string& text);
/// Whether all of `text` but the blanks around it is what `readNumber` reads.
bool isNumber(const std::string& text);
/// Whether it is what `readCount` reads, and that is a whole number: "1,234" and "5.00", but neither "1,5" nor "0,125".
bool isCount(const std::string& text);
/// Whether a person may mean thousands by the decimal mark that `readNumber` takes: "1,234", but not "0.125".
bool mayMeanThousands(const std::string& text);
