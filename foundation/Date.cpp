#include "foundation/Date.h"

#include "foundation/FieldIO.h"

#include <algorithm>
#include <climits>
#include <cstdlib>

namespace {

// Days in the periods of the Gregorian calendar.
constexpr std::int64_t kDaysIn400Years = 146097;
constexpr std::int64_t kDaysIn100Years = 36524;
constexpr std::int64_t kDaysIn4Years = 1461;
constexpr std::int64_t kDaysInYear = 365;
constexpr std::uint64_t kLengthOfBadMonth = 31;

bool isLeapYear(int year)
{
    return year % 4 == 0 && (year % 100 != 0 || year % 400 == 0);
}

std::int64_t floorDivide(std::int64_t a, std::int64_t b)
{
    return a / b - (a % b < 0 ? 1 : 0);
}

/// Days before the month in a year that begins in March (0 = March, 11 = February): 31, 30, 31, 30, 31 repeated.
std::int64_t daysBeforeMonth(std::int64_t monthFromMarch)
{
    return (153 * monthFromMarch + 2) / 5;
}

} // namespace

int Date::wrt(FILE* file) const
{
    unsigned char bytes[kFileSize];
    encode(bytes);
    std::fwrite(bytes, 1, sizeof bytes, file);
    return 0;
}

int Date::rd(FILE* file)
{
    unsigned char bytes[kFileSize];
    freadbytes(file, bytes, sizeof bytes);
    decode(bytes);
    return 0;
}

void Date::decode(const unsigned char* bytes)
{
    day_ = static_cast<short>(decodeShort(bytes));
    month_ = static_cast<short>(decodeShort(bytes + 2));
    year_ = static_cast<int>(decodeInt(bytes + 4));
}

void Date::encode(unsigned char* bytes) const
{
    encodeShort(bytes, static_cast<std::uint16_t>(day_));
    encodeShort(bytes + 2, static_cast<std::uint16_t>(month_));
    encodeInt(bytes + 4, static_cast<std::uint32_t>(year_));
}

bool Date::isValid() const
{
    return hasMonth() && day_ >= 1 && day_ <= lengthOfMonth();
}

short Date::getMonthLength() const
{
    if (!hasMonth())
        std::fputs("Bad month...", stderr);
    return lengthOfMonth();
}

short Date::lengthOfMonth() const
{
    constexpr short kLengths[] = {31, 28, 31, 30, 31, 30, 31, 31, 30, 31, 30, 31};
    if (!hasMonth())
        return kLengthOfBadMonth;
    return month_ == 2 && isLeapYear(year_) ? 29 : kLengths[month_ - 1];
}

Date Date::getNext() const
{
    Date next(*this);
    if (day_ < 28)
        ++next.day_;
    else {
        (void)getMonthLength(); // says "Bad month..." where it applies
        next.advance(1);
    }
    return next;
}

Date Date::getPrevious() const
{
    Date previous(*this);
    previous.goBack(1);
    if (day_ == 1 && month_ != 1)
        (void)previous.getMonthLength();
    return previous;
}

int Date::operator-(const Date& d) const
{
    if (!isValid() || !d.isValid())
        return -1;
    if (year_ == d.year_ && month_ == d.month_)
        return day_ - d.day_;
    return static_cast<int>(std::clamp<std::int64_t>(dayNumber() - d.dayNumber(), INT_MIN, INT_MAX));
}

Date& Date::operator+(unsigned n)
{
    return moveBy(n);
}

Date& Date::operator-(int n)
{
    return n > 0 ? moveBy(-static_cast<std::int64_t>(n)) : *this;
}

Date& Date::moveBy(std::int64_t n)
{
    if (n > 0)
        advance(static_cast<std::uint64_t>(n));
    else if (n < 0)
        goBack(0 - static_cast<std::uint64_t>(n));
    return *this;
}

// Both directions agree with that many single steps also from an impossible date: a day outside its month counts on
// through the range of a short until it meets the month's last (or first) day, and a month outside 1..12 counts as one
// of 31 days until a real month is met. Each such run is passed in one jump.

void Date::advance(std::uint64_t n)
{
    if (!isValid()) {
        const std::uint64_t days = std::min<std::uint64_t>(n, static_cast<std::uint16_t>(lengthOfMonth() - day_));
        day_ = static_cast<short>(day_ + static_cast<int>(days));
        n -= days;
        if (n > 0 && !hasMonth())
            n = leaveBadMonth(n, 1, static_cast<std::uint16_t>(1 - month_));
    }
    if (n == 0)
        return;
    if (n <= static_cast<std::uint64_t>(lengthOfMonth() - day_))
        day_ = static_cast<short>(day_ + static_cast<int>(n));
    else
        setDayNumber(dayNumber() + static_cast<std::int64_t>(n));
}

void Date::goBack(std::uint64_t n)
{
    if (!isValid()) {
        const std::uint64_t days = std::min<std::uint64_t>(n, static_cast<std::uint16_t>(day_ - 1));
        day_ = static_cast<short>(day_ - static_cast<int>(days));
        n -= days;
        if (n > 0 && !hasMonth())
            n = leaveBadMonth(n, -1, static_cast<std::uint16_t>(month_ - 12));
    }
    if (n == 0)
        return;
    if (n < static_cast<std::uint64_t>(day_))
        day_ = static_cast<short>(day_ - static_cast<int>(n));
    else
        setDayNumber(dayNumber() - static_cast<std::int64_t>(n));
}

/// Moves on from the edge of a bad month, `monthsToReal` months of 31 days away from the next real one.
/// @return the days still to go, 0 when they ended before the real month's edge.
std::uint64_t Date::leaveBadMonth(std::uint64_t n, int direction, std::uint64_t monthsToReal)
{
    const std::uint64_t months = std::min((n + kLengthOfBadMonth - 1) / kLengthOfBadMonth, monthsToReal);
    month_ = static_cast<short>(month_ + direction * static_cast<int>(months));
    day_ = direction > 0 ? 1 : static_cast<short>(kLengthOfBadMonth); // December, too, ends on the 31st
    n -= (months - 1) * kLengthOfBadMonth + 1;
    if (months == monthsToReal)
        return n;
    day_ = static_cast<short>(day_ + direction * static_cast<int>(n));
    return 0;
}

/// Days since 1 March of year 0, for a valid date. Years are taken from March, so that the leap day comes last.
std::int64_t Date::dayNumber() const
{
    const std::int64_t monthFromMarch = month_ > 2 ? month_ - 3 : month_ + 9;
    const std::int64_t year = static_cast<std::int64_t>(year_) - (month_ > 2 ? 0 : 1);
    return year * kDaysInYear + floorDivide(year, 4) - floorDivide(year, 100) + floorDivide(year, 400) +
           daysBeforeMonth(monthFromMarch) + day_ - 1;
}

/// The inverse of `dayNumber`; years beyond the range of int wrap around.
void Date::setDayNumber(std::int64_t number)
{
    const std::int64_t cycle = floorDivide(number, kDaysIn400Years);
    std::int64_t days = number - cycle * kDaysIn400Years;
    // The last day of a 400-year or 4-year period is its leap day, which belongs to the last part of the period.
    const std::int64_t centuries = std::min<std::int64_t>(days / kDaysIn100Years, 3);
    days -= centuries * kDaysIn100Years;
    const std::int64_t fours = days / kDaysIn4Years;
    days -= fours * kDaysIn4Years;
    const std::int64_t years = std::min<std::int64_t>(days / kDaysInYear, 3);
    days -= years * kDaysInYear;
    const std::int64_t monthFromMarch = (5 * days + 2) / 153;
    day_ = static_cast<short>(days - daysBeforeMonth(monthFromMarch) + 1);
    month_ = static_cast<short>(monthFromMarch < 10 ? monthFromMarch + 3 : monthFromMarch - 9);
    year_ = static_cast<int>(cycle * 400 + centuries * 100 + fours * 4 + years + (month_ > 2 ? 0 : 1));
}

String Date::toString() const
{
    char text[40];
    std::snprintf(text, sizeof text, day_ <= 9 ? "0%d/" : "%d/", day_);
    String result(text);
    std::snprintf(text, sizeof text, month_ <= 9 ? "0%d/" : "%d/", month_);
    result += String(text);
    std::snprintf(text, sizeof text, "%d", year_);
    return result += String(text);
}
