#include "tools/DateText.h"

namespace {

constexpr std::size_t kYearDigits = 4;
constexpr std::size_t kDayDigits = 2; // at most, as for the month

/// Takes a number of `shortest` to `longest` digits off the front of `text`; -1 when there is none.
int takeNumber(std::string_view& text, std::size_t shortest, std::size_t longest)
{
    int number = 0;
    std::size_t digits = 0;
    for (; digits < text.size() && text[digits] >= '0' && text[digits] <= '9'; ++digits) {
        if (digits == longest)
            return -1;
        number = 10 * number + (text[digits] - '0');
    }
    text.remove_prefix(digits);
    return digits >= shortest ? number : -1;
}

int takeYear(std::string_view& text)
{
    return takeNumber(text, kYearDigits, kYearDigits);
}

int takeDayOrMonth(std::string_view& text)
{
    return takeNumber(text, 1, kDayDigits);
}

bool takeMark(std::string_view& text, char mark)
{
    if (text.empty() || text.front() != mark)
        return false;
    text.remove_prefix(1);
    return true;
}

} // namespace

std::optional<Date> parseDate(std::string_view text)
{
    const bool yearFirst = text.find('-') != text.npos;
    const char mark = yearFirst ? '-' : '/';
    const int first = yearFirst ? takeYear(text) : takeDayOrMonth(text);
    if (!takeMark(text, mark))
        return std::nullopt;
    const int month = takeDayOrMonth(text);
    if (!takeMark(text, mark))
        return std::nullopt;
    const int last = yearFirst ? takeDayOrMonth(text) : takeYear(text);
    if (first < 0 || month < 0 || last < 0 || !text.empty())
        return std::nullopt;
    const int day = yearFirst ? last : first;
    const Date date(static_cast<short>(day), static_cast<short>(month), yearFirst ? first : last);
    return date.isValid() ? std::optional(date) : std::nullopt;
}
