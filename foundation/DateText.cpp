#include "foundation/DateText.h"

#include <charconv>
#include <utility>

namespace {

std::string_view trimmed(std::string_view text)
{
    const std::size_t begin = text.find_first_not_of(" \t");
    if (begin == text.npos)
        return {};
    return text.substr(begin, text.find_last_not_of(" \t") - begin + 1);
}

/// The number that `text` is, of `shortest` to `longest` digits; -1 for anything else, and for one above 32767.
short numberOf(std::string_view text, std::size_t shortest, std::size_t longest)
{
    if (text.size() < shortest || text.size() > longest || text.find_first_not_of("0123456789") != text.npos)
        return -1;
    short number = -1; // as it stays for one that is too large
    std::from_chars(text.data(), text.data() + text.size(), number);
    return number;
}

/// The three parts of `text` between the first two of `marks`; the last part is empty where there are fewer marks.
struct Parts {
    std::string_view first, second, third;

    Parts(std::string_view text, std::string_view marks)
    {
        const std::size_t one = text.find_first_of(marks);
        const std::size_t two = one != text.npos ? text.find_first_of(marks, one + 1) : one;
        if (two == text.npos)
            return;
        first = text.substr(0, one);
        second = text.substr(one + 1, two - one - 1);
        third = text.substr(two + 1);
    }
};

/// Day, month and year of what a person typed, without the blanks around them.
Parts typedParts(std::string_view text)
{
    constexpr std::size_t kFullYear = 4;
    Parts parts(text, "/.-");
    for (std::string_view* part : {&parts.first, &parts.second, &parts.third})
        *part = trimmed(*part);
    // No day has four digits, unless they are zeros in front.
    if (parts.first.size() == kFullYear && text.find_first_of("/.") == text.npos)
        std::swap(parts.first, parts.third);
    return parts;
}

} // namespace

std::string dateText(const Date& date)
{
    return date.isUndefined() ? std::string() : date.toString().getCharacterArray();
}

Date readDate(std::string_view text)
{
    const Parts parts = typedParts(text);
    const auto number = [](std::string_view part) { return numberOf(part, 1, part.npos); };
    const Date date(number(parts.first), number(parts.second), number(parts.third));
    return date.isValid() && date.getYear() > 0 ? date : Date();
}

Date readShortDate(std::string_view text, const Date& today)
{
    const Parts parts = typedParts(text);
    const short year = numberOf(parts.third, 2, 2);
    if (year < 0)
        return readDate(text);
    // The first of the hundred years that are thought of, and from there on to the one with these two digits.
    const int first = today.getYear() - 50;
    const int completed = first + ((year - first) % 100 + 100) % 100;
    // Completed before it is looked at: a leap day may be none in the first century, and there is no year 0.
    const Date date(numberOf(parts.first, 1, 2), numberOf(parts.second, 1, 2), completed);
    return date.isValid() && completed > 0 ? date : Date();
}

std::optional<Date> parseDate(std::string_view text)
{
    const bool isIso = text.find('-') != text.npos;
    Parts parts(text, isIso ? "-" : "/");
    if (isIso)
        std::swap(parts.first, parts.third);
    const Date date(numberOf(parts.first, 1, 2), numberOf(parts.second, 1, 2), numberOf(parts.third, 4, 4));
    return date.isValid() && date.getYear() >= 0 ? std::optional(date) : std::nullopt;
}
