#include "views/DateText.h"

#include <charconv>
#include <limits>
#include <string_view>

namespace {

std::string_view trimmed(std::string_view text)
{
    const std::size_t begin = text.find_first_not_of(" \t");
    if (begin == text.npos)
        return {};
    return text.substr(begin, text.find_last_not_of(" \t") - begin + 1);
}

/// The whole of `text` as a number from 1 to `highest`; 0 for anything else.
int numberOf(std::string_view text, int highest)
{
    text = trimmed(text);
    int number = 0;
    const auto result = std::from_chars(text.data(), text.data() + text.size(), number);
    const bool isWhole = result.ec == std::errc() && result.ptr == text.data() + text.size();
    return isWhole && number >= 1 && number <= highest ? number : 0;
}

} // namespace

std::string dateText(const Date& date)
{
    return date.isUndefined() ? std::string() : date.toString().getCharacterArray();
}

Date readDate(const std::string& text)
{
    constexpr const char* kMarks = "/.-";
    constexpr int kLastYear = std::numeric_limits<short>::max();
    const std::size_t first = text.find_first_of(kMarks);
    const std::size_t second = first != text.npos ? text.find_first_of(kMarks, first + 1) : text.npos;
    if (second == text.npos)
        return {};
    const std::string_view all = text;
    const Date date(static_cast<short>(numberOf(all.substr(0, first), 31)),
                    static_cast<short>(numberOf(all.substr(first + 1, second - first - 1), 12)),
                    numberOf(all.substr(second + 1), kLastYear));
    return date.isValid() && date.getYear() > 0 ? date : Date();
}
