#include "foundation/NumberText.h"

#include <algorithm>
#include <cctype>
#include <charconv>
#include <cmath>
#include <iterator>
#include <string_view>

namespace {

constexpr std::size_t kGroup = 3; // digits between thousands separators

bool isDigit(char c)
{
    return c >= '0' && c <= '9';
}

std::string withSeparators(std::string digits, std::size_t end)
{
    const std::size_t begin = digits.front() == '-' ? 1 : 0;
    for (std::size_t i = end; i > begin + kGroup; i -= kGroup)
        digits.insert(i - kGroup, 1, ',');
    return digits;
}

/// `value` with so many decimals and `unit` behind it, or "?".
std::string fixedText(double value, int decimals, const char* unit = "")
{
    if (!std::isfinite(value))
        return "?";
    char text[400]; // the largest double has 309 digits before the point
    char* end = std::to_chars(text, text + sizeof text, value, std::chars_format::fixed, decimals).ptr;
    const bool isZero = std::all_of(text, end, [](char c) { return c == '-' || c == '0' || c == '.'; });
    char* begin = isZero && text[0] == '-' ? text + 1 : text;
    return std::string(begin, end) + unit;
}

/// What a text says as a number, and whether it says nothing else.
struct Parsed {
    double value = 0;
    bool isWhole = false;
};

Parsed parsed(const std::string& text)
{
    // The last mark is the decimal one; those before it part thousands: "1,234.5", "1.234,5".
    std::string plain = text;
    const std::size_t decimal = plain.find_last_of(".,");
    if (decimal != plain.npos) {
        plain[decimal] = '.';
        const auto marks = std::remove_if(plain.begin(), plain.begin() + static_cast<std::ptrdiff_t>(decimal),
                                          [](char c) { return c == '.' || c == ','; });
        plain.erase(marks, plain.begin() + static_cast<std::ptrdiff_t>(decimal));
    }
    const std::size_t begin = plain.find_first_not_of(" \t");
    if (begin == plain.npos)
        return {};
    const char* first = plain.data() + begin + (plain[begin] == '+' ? 1 : 0);
    const char* end = plain.data() + plain.size();
    double value = 0;
    const auto result = std::from_chars(first, end, value);
    if (result.ec != std::errc() || !std::isfinite(value))
        return {};
    return {value, std::all_of(result.ptr, end, [](char c) { return c == ' ' || c == '\t'; })};
}

/// How many groups of three digits stand behind one of one to three, with the same mark between all of them, and
/// nothing else; 0 for any other text.
std::size_t thousandsIn(std::string_view text)
{
    const std::size_t begin = text.find_first_not_of(" \t+-");
    if (begin == text.npos || text[begin] == '0')
        return 0;
    text = text.substr(begin, text.find_last_not_of(" \t") + 1 - begin);
    const std::size_t first = std::min(text.find_first_not_of("0123456789"), text.size());
    const std::size_t rest = text.size() - first;
    if (first < 1 || first > kGroup || rest % (kGroup + 1) != 0)
        return 0;
    for (std::size_t i = first; i < text.size(); ++i) {
        const bool isMark = (i - first) % (kGroup + 1) == 0;
        if (isMark ? (text[i] != text[first] || (text[i] != '.' && text[i] != ',')) : !isDigit(text[i]))
            return 0;
    }
    return rest / (kGroup + 1);
}

} // namespace

std::string amountText(double amount)
{
    constexpr double kLongest = 1e15;
    if (std::isfinite(amount) && std::abs(amount) >= kLongest) {
        char text[32];
        return {text, std::to_chars(text, text + sizeof text, amount, std::chars_format::scientific, 5).ptr};
    }
    const std::string text = fixedText(amount, 2);
    return std::isfinite(amount) ? withSeparators(text, text.find('.')) : text;
}

std::string countText(int count)
{
    const std::string digits = std::to_string(count);
    return withSeparators(digits, digits.size());
}

std::string percentText(double fraction)
{
    return fixedText(fraction * 100, 2, " %");
}

std::string finePercentText(double fraction)
{
    return fixedText(fraction * 100, 4, " %");
}

std::string changeText(double fraction)
{
    const std::string text = fixedText(fraction * 100, 1, "%");
    return std::isdigit(static_cast<unsigned char>(text.front())) != 0 ? '+' + text : text;
}

std::string exactText(float value)
{
    if (!std::isfinite(value))
        return "?";
    char digits[100];
    const auto end = std::to_chars(std::begin(digits), std::end(digits), value, std::chars_format::fixed).ptr;
    std::string text(digits, end);
    constexpr std::size_t kDecimals = 2;
    if (text.find('.') == text.npos)
        text += '.';
    const std::size_t decimals = text.size() - text.find('.') - 1;
    if (decimals < kDecimals)
        text.append(kDecimals - decimals, '0');
    return text;
}

double readNumber(const std::string& text)
{
    return parsed(text).value;
}

double readCount(const std::string& text)
{
    const std::size_t mark = text.find_last_of(".,");
    const std::size_t end = text.find_last_not_of(" \t") + 1;
    const bool isThousands =
        mark != text.npos && end - mark - 1 == kGroup && text.find_first_not_of("0123456789", mark + 1) >= end;
    // With a decimal mark behind it the last group is read as the others.
    return readNumber(isThousands ? text.substr(0, end) + ".0" : text);
}

bool isNumber(const std::string& text)
{
    return parsed(text).isWhole;
}

bool isCount(const std::string& text)
{
    const double count = readCount(text);
    if (!isNumber(text) || count != std::floor(count))
        return false;
    // Where a mark was taken for one between thousands, the digits must stand so.
    return count == readNumber(text) || thousandsIn(text) > 0;
}

bool mayMeanThousands(const std::string& text)
{
    return thousandsIn(text) == 1;
}
