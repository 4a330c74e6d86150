#include "exchange/JournalText.h"

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <limits>

namespace {

/// Without the zeros at its end, but for two decimals.
std::string shortened(std::string text)
{
    constexpr std::size_t kDecimals = 2;
    const std::size_t least = text.find('.') + 1 + kDecimals;
    while (text.size() > least && text.back() == '0')
        text.pop_back();
    return text;
}

} // namespace

std::string moneyText(long long units)
{
    char text[32];
    const long long size = std::llabs(units);
    std::snprintf(text, sizeof text, "%s%lld.%04lld", units < 0 ? "-" : "", size / kUnitsInOne, size % kUnitsInOne);
    return shortened(text);
}

std::string fixedText(double value, int decimals)
{
    char text[400]; // the largest double has 309 digits before the point
    std::snprintf(text, sizeof text, "%.*f", decimals, value);
    if (std::strtod(text, nullptr) == 0)
        std::snprintf(text, sizeof text, "%.*f", decimals, 0.0);
    return text;
}

std::string journalNumber(double value)
{
    constexpr int kFloatDigits = 9; // tell every float from all others
    constexpr int kProductDigits = 13;
    const bool isFloat = std::abs(value) <= std::numeric_limits<float>::max() && static_cast<float>(value) == value;
    const int digits = isFloat ? kFloatDigits : kProductDigits;
    constexpr int kMostDecimals = 60;
    const int magnitude = value != 0 ? static_cast<int>(std::floor(std::log10(std::abs(value)))) : 0;
    return shortened(fixedText(value, std::clamp(digits - 1 - magnitude, 2, kMostDecimals)));
}
