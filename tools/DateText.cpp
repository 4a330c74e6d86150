#include "tools/DateText.h"

#include "foundation/Today.h"

#include <charconv>

namespace {

/// The number that `text` is, of `shortest` to `longest` digits; -1 for anything else.
int numberOf(std::string_view text, std::size_t shortest, std::size_t longest)
{
    if (text.size() < shortest || text.size() > longest || text.find_first_not_of("0123456789") != text.npos)
        return -1;
    int number = -1;
    std::from_chars(text.data(), text.data() + text.size(), number);
    return number;
}

} // namespace

std::optional<Date> parseDate(std::string_view text)
{
    const char mark = text.find('-') != text.npos ? '-' : '/';
    const std::size_t first = text.find(mark);
    const std::size_t second = first != text.npos ? text.find(mark, first + 1) : first;
    if (second == text.npos)
        return std::nullopt;
    std::string_view day = text.substr(0, first);
    std::string_view year = text.substr(second + 1);
    if (mark == '-')
        std::swap(day, year);
    const std::string_view month = text.substr(first + 1, second - first - 1);
    const Date date(static_cast<short>(numberOf(day, 1, 2)), static_cast<short>(numberOf(month, 1, 2)),
                    numberOf(year, 4, 4));
    return date.isValid() && date.getYear() >= 0 ? std::optional(date) : std::nullopt;
}

std::string checkDateArgument(const std::string& text)
{
    const bool isDate = text.find('/') != std::string::npos && parseDate(text);
    return isDate ? std::string() : "is not a date DD/MM/YYYY: " + text;
}

Date dateArgument(const std::string& text)
{
    return text.empty() ? today() : *parseDate(text);
}
