#include "tools/QuotePages.h"

#include <cmath>
#include <cstdio>
#include <limits>

namespace {

struct Fraction {
    float numerator;
    float denominator;
};

/// A fraction that makes `close` when it is added to `whole`, in single precision.
Fraction fractionOf(float close, float whole)
{
    const float rest = close - whole; // exact
    for (const float denominator : {2.F, 4.F, 8.F, 16.F, 32.F, 64.F, 100.F, 1000.F, 10000.F}) {
        const float numerator = std::round(rest * denominator);
        if (whole + numerator / denominator == close)
            return {numerator, denominator};
    }
    // As a last resort the digits of the float themselves over a power of two: exact, if hard to read.
    int exponent = 0;
    constexpr int kBits = std::numeric_limits<float>::digits;
    const float mantissa = std::frexp(rest, &exponent);
    return {std::ldexp(mantissa, kBits), std::ldexp(1.F, kBits - exponent)};
}

/// A number of the page's fractions, which is whole.
std::string integerText(float number)
{
    return shortestText(number, std::chars_format::fixed);
}

std::string priceText(float price)
{
    constexpr float kSmallest = 1e-4F, kLargest = 1e9F; // outside, the power of ten is shorter than zeros
    const bool plain = price >= kSmallest && price < kLargest;
    return shortestText(price, plain ? std::chars_format::fixed : std::chars_format::general);
}

std::string cellText(float close)
{
    const float whole = std::floor(close);
    if (close == whole)
        return integerText(whole);
    const auto [numerator, denominator] = fractionOf(close, whole);
    if (std::isinf(denominator)) // no fraction is that small; a decimal number is understood as well
        return priceText(close);
    return integerText(whole) + " <sup>" + integerText(numerator) + "</sup>/<sub>" + integerText(denominator) +
           "</sub>";
}

/// The day three months before; it may be one that the month does not have, which serves for a comparison.
Date threeMonthsBefore(const Date& day)
{
    constexpr short kMonths = 3, kMonthsOfYear = 12;
    const bool sameYear = day.getMonth() > kMonths;
    const int month = day.getMonth() - kMonths + (sameYear ? 0 : kMonthsOfYear);
    return {day.getDay(), static_cast<short>(month), day.getYear() - (sameYear ? 0 : 1)};
}

/// Behind the price stand the columns that the table's header names and that are not known here.
std::string rowOf(const Date& day, float close)
{
    char date[32];
    std::snprintf(date, sizeof date, "%02d/%02d/%04d", day.getMonth(), day.getDay(), day.getYear());
    return std::string(date) + ' ' + priceText(close) + " - - - -\n";
}

} // namespace

std::string latestQuotePage(float close)
{
    return "<html><body><table><tr><td nowrap><b>" + cellText(close) + "</b></td></tr></table></body></html>\n";
}

std::string historyPage(const Closes& closes)
{
    std::string page = "<html><body><pre>\n<b>Date Close Open High Low Volume (00s)</b>\n";
    // Strictly behind that day, which may be one that its month does not have.
    for (auto close = closes.upper_bound(threeMonthsBefore(closes.rbegin()->first)); close != closes.end(); ++close)
        page += rowOf(close->first, close->second);
    return page + "</pre></body></html>\n";
}

std::string noQuotesPage()
{
    return "<html><body>There are no quotes of this ticker.</body></html>\n";
}

std::string shortestText(float price, std::chars_format format)
{
    char text[64]; // as long as any float without an exponent
    return {text, std::to_chars(text, text + sizeof text, price, format).ptr};
}
