#include "exchange/StatementText.h"

#include "exchange/StatementWords.h"
#include "exchange/TextForms.h"
#include "foundation/FoldedText.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <vector>

namespace {

constexpr std::size_t kGroup = 3; // digits between thousands separators

bool isDigit(char c)
{
    return c >= '0' && c <= '9';
}

bool isAllDigits(std::string_view text)
{
    return !text.empty() && std::ranges::all_of(text, isDigit);
}

/// The characters of a number: digits and marks as they are, blanks and apostrophes as ' ', minus signs as '-'; all
/// others as they are.
std::string plainForm(std::string_view text)
{
    std::string plain;
    while (!text.empty()) {
        const char* at = text.data();
        const char32_t c = takeCharacter(text);
        constexpr char32_t kApostrophe = 0x2019;
        constexpr char32_t kMinus = 0x2212;
        constexpr char32_t kDash = 0x2013;
        if (isBlank(c) || c == '\'' || c == kApostrophe)
            plain += ' ';
        else if (c == kMinus || c == kDash)
            plain += '-';
        else
            plain.append(at, text.data());
    }
    return plain;
}

/// Whether the letters beside a number belong to it: a currency's sign or code, or what shares are counted in.
bool isUnit(std::string_view text)
{
    constexpr std::string_view kCounted[] = {"st", "stk", "stuck", "shares", "units", "pcs", "titres", "parts"};
    constexpr std::size_t kCode = 3;
    constexpr std::size_t kLongestSign = 4; // bytes
    const auto isAscii = [](char c) { return static_cast<unsigned char>(c) < 0x80; };
    const bool isCode = text.size() == kCode && std::ranges::all_of(text, [](char c) { return c >= 'A' && c <= 'Z'; });
    return isCode || (text.size() <= kLongestSign && std::ranges::none_of(text, isAscii)) ||
           std::ranges::find(kCounted, wordKey(text)) != std::end(kCounted) || !currencyCodesOf(text).empty();
}

} // namespace

std::optional<WrittenNumber> WrittenNumber::read(std::string_view text)
{
    const std::string plain = plainForm(text);
    // From the first digit, or the mark in front of it, to the last digit; signs and units stand outside.
    std::size_t begin = std::min(plain.find_first_of("0123456789"), plain.size());
    const std::size_t end = plain.find_last_of("0123456789") + 1;
    if (begin == plain.size())
        return std::nullopt;
    if (begin > 0 && (plain[begin - 1] == '.' || plain[begin - 1] == ','))
        --begin;
    WrittenNumber number;
    number.core_ = plain.substr(begin, end - begin);
    if (number.core_.find_first_not_of("0123456789., ") != std::string::npos)
        return std::nullopt;
    if (!number.takeUnits(std::string_view(plain).substr(0, begin), std::string_view(plain).substr(end)))
        return std::nullopt;
    // Wrong whatever the decimal mark: "1,,2", "1 23".
    if (!number.value('.') && !number.value(','))
        return std::nullopt;
    return number;
}

bool WrittenNumber::isNone(std::string_view text)
{
    const std::string plain = plainForm(withoutBlanks(text));
    const std::string key = wordKey(plain);
    return plain.empty() || plain == "-" || key == "na";
}

/// Takes what stands around the digits. @return false when that belongs to no number.
bool WrittenNumber::takeUnits(std::string_view front, std::string_view back)
{
    int signs = 0;
    int open = 0;      // parentheses mean minus
    std::string words; // with blanks between
    for (const std::string_view part : {front, back}) {
        for (const char c : part)
            if (c == '-' || c == '+') {
                ++signs;
                isNegative_ = c == '-';
            } else if (c == '(' || c == ')') {
                open += c == '(' ? 1 : -1;
                isNegative_ = true;
                signs += c == '(' ? 1 : 0;
            } else if (c == '%') {
                isPercent_ = true;
            } else if (isDigit(c) || c == ',' || c == '/') {
                return false;
            } else if (c != '.') {
                words += c;
            }
        words += ' ';
    }
    for (const std::string_view word : splitAtBlanks(words)) {
        // Banks of the continent set "S" (Soll) and "H" (Haben) behind, others "DR" and "CR".
        const std::string key = foldedText(word);
        const bool isDebit = key == "s" || key == "dr";
        isNegative_ = isNegative_ || isDebit;
        if (isDebit || key == "h" || key == "cr")
            continue;
        // "$5 USD" is one unit, of which the code tells more.
        if (!isUnit(word) || (!unit_.empty() && unit_ != "$" && word != "$"))
            return false;
        if (unit_.empty() || unit_ == "$")
            unit_ = word;
    }
    return signs <= 1 && open == 0;
}

char WrittenNumber::decimalMark() const
{
    const std::size_t place = core_.find_last_of(".,");
    if (place == core_.npos || needsDecimalMark())
        return '\0';
    const char mark = core_[place];
    // The same mark twice can only part thousands, and so the other one is for decimals.
    const bool isTwice = std::ranges::count(core_, mark) > 1;
    return isTwice ? (mark == '.' ? ',' : '.') : mark;
}

bool WrittenNumber::needsDecimalMark() const
{
    // Of "0.125" and "1234.567" the group in front is no group of thousands.
    const std::size_t place = core_.find_first_of(".,");
    return place != core_.npos && core_.find_first_of("., ", place + 1) == core_.npos && place > 0 && place <= kGroup &&
           core_.size() - place - 1 == kGroup && core_[0] != '0' && core_.find(' ') == core_.npos;
}

std::optional<double> WrittenNumber::value(char mark) const
{
    if (mark == '\0')
        mark = needsDecimalMark() ? '\0' : decimalMark() != '\0' ? decimalMark() : '.';
    if (mark == '\0')
        return std::nullopt;
    const std::size_t place = std::min(core_.find(mark), core_.size());
    const std::string_view whole = std::string_view(core_).substr(0, place);
    const std::string_view decimals = std::string_view(core_).substr(std::min(place + 1, core_.size()));
    if ((place < core_.size() && !isAllDigits(decimals)) || (place == 0 && decimals.empty()))
        return std::nullopt;
    if (!whole.empty() && !isAllDigits(whole) && !isGrouped(whole, ' ') && !isGrouped(whole, mark == '.' ? ',' : '.'))
        return std::nullopt;
    std::string digits;
    std::ranges::copy_if(whole, std::back_inserter(digits), isDigit);
    digits += '.';
    digits += decimals;
    double value = 0;
    const auto result = std::from_chars(digits.data(), digits.data() + digits.size(), value);
    if (result.ec != std::errc())
        return std::nullopt;
    if (isPercent_)
        value /= 100;
    return isNegative_ ? -value : value;
}

/// Whether `whole` is made of groups of three digits, the first one perhaps shorter.
bool WrittenNumber::isGrouped(std::string_view whole, char separator) const
{
    for (std::size_t group = whole.find(separator), first = 1;; first = 0) {
        const std::string_view digits = whole.substr(0, group);
        if (!isAllDigits(digits) || digits.size() > kGroup || (first == 0 && digits.size() != kGroup))
            return false;
        if (group == whole.npos)
            return true;
        whole.remove_prefix(group + 1);
        group = whole.find(separator);
    }
}

namespace {

/// The number at the front of `text`, of at most four digits, which it is cut off of; -1 without one.
int takeNumber(std::string_view& text, std::size_t* digits)
{
    *digits = std::min(text.find_first_not_of("0123456789"), text.size());
    int number = -1;
    if (*digits > 0 && *digits <= 4)
        std::from_chars(text.data(), text.data() + *digits, number);
    text.remove_prefix(*digits);
    return number;
}

/// Two digits stand for the years from 1969 on, as POSIX has it.
int fullYear(int year, std::size_t digits)
{
    if (digits > 2)
        return year;
    return year + (year < 69 ? 2000 : 1900);
}

bool isTime(std::string_view text)
{
    return text.empty() || ((text.front() == ' ' || text.front() == 'T') && text.find(':') != text.npos);
}

/// 1 to 12 for the name of a month in English, German or French, or its abbreviation; otherwise 0.
int monthNamed(const std::string& key)
{
    constexpr std::string_view kBegins[] = {"jan",      "feb fev", "mar mrz", "apr avr", "mai may", "jun juin",
                                            "jul juil", "aug aou", "sep",     "oct okt", "nov",     "dec dez"};
    constexpr std::size_t kLongest = 9; // "september"
    for (std::size_t month = 0; month < std::size(kBegins) && key.size() <= kLongest; ++month)
        for (const std::string_view begin : splitAtBlanks(kBegins[month]))
            if (key.starts_with(begin))
                return static_cast<int>(month) + 1;
    return 0;
}

/// "5 Jan 2026", "5. Januar 2026", "05-janv.-26", "Jan 5, 2026".
std::optional<WrittenDate> readNamed(std::string_view text)
{
    std::string plain(text);
    std::ranges::replace_if(
        plain, [](char c) { return std::string_view(".,-/").find(c) != std::string_view::npos; }, ' ');
    const std::vector<std::string_view> words = splitAtBlanks(plain);
    if (words.size() != 3)
        return std::nullopt;
    const std::size_t name = isAllDigits(words[0]) ? 1 : 0;
    const std::string_view day = words[1 - name];
    const std::string_view year = words[2];
    const int month = monthNamed(wordKey(words[name]));
    const bool isDate = month > 0 && isAllDigits(day) && day.size() <= 2 && isAllDigits(year);
    if (!isDate || (year.size() != 2 && year.size() != 4))
        return std::nullopt;
    return WrittenDate{true, month, std::stoi(std::string(day)), fullYear(std::stoi(std::string(year)), year.size())};
}

} // namespace

std::optional<WrittenDate> WrittenDate::read(std::string_view text)
{
    text = withoutBlanks(text);
    if (const auto named = readNamed(text))
        return named;
    constexpr std::size_t kCompact = 8;
    if (isAllDigits(text) && text.size() == kCompact) {
        const std::string apart = std::string(text.substr(0, 4)) + '-' + std::string(text.substr(4, 2)) + '-';
        return read(apart + std::string(text.substr(6)));
    }
    std::array<int, 3> numbers{};
    std::array<std::size_t, 3> digits{};
    char mark = '\0';
    for (std::size_t i = 0; i < numbers.size(); ++i) {
        // In front of the second and third number the same mark.
        if (i > 0) {
            if (text.empty() ||
                (i == 1 ? std::string_view("/.-").find(text.front()) == text.npos : text.front() != mark))
                return std::nullopt;
            mark = text.front();
            text.remove_prefix(1);
        }
        numbers[i] = takeNumber(text, &digits[i]);
        if (numbers[i] < 0)
            return std::nullopt;
    }
    const bool isOrderKnown = digits[0] == 4;
    const std::size_t yearDigits = isOrderKnown ? 4 : digits[2];
    const bool hasShortNumbers = digits[1] <= 2 && (isOrderKnown ? digits[2] : digits[0]) <= 2;
    if (!isTime(text) || !hasShortNumbers || (yearDigits != 2 && yearDigits != 4))
        return std::nullopt;
    if (isOrderKnown)
        return WrittenDate{true, numbers[1], numbers[2], numbers[0]};
    return WrittenDate{false, numbers[0], numbers[1], fullYear(numbers[2], yearDigits)};
}

Date WrittenDate::date(bool isMonthFirst) const
{
    const bool swap = isMonthFirst || isOrderKnown;
    const Date date(static_cast<short>(swap ? second : first), static_cast<short>(swap ? first : second), year);
    return date.isValid() && year > 0 ? date : Date();
}
