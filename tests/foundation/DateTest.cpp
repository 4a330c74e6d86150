#include "foundation/Date.h"
#include "tests/support/Bytes.h"

#include <climits>
#include <gtest/gtest.h>
#include <random>
#include <vector>

namespace {

int lengthOf(short month, int year)
{
    if (month == 2)
        return year % 400 == 0 || (year % 4 == 0 && year % 100 != 0) ? 29 : 28;
    return month == 4 || month == 6 || month == 9 || month == 11 ? 30 : 31;
}

short plus(short value, int step)
{
    return static_cast<short>(value + step); // wraps around
}

/// One day on, by the calendar; what is not a day of it only counts.
Date walkedOn(const Date& d)
{
    if (d.getDay() != lengthOf(d.getMonth(), d.getYear()))
        return {plus(d.getDay(), 1), d.getMonth(), d.getYear()};
    return d.getMonth() == 12 ? Date(1, 1, d.getYear() + 1) : Date(1, plus(d.getMonth(), 1), d.getYear());
}

Date walkedBack(const Date& d)
{
    if (d.getDay() != 1)
        return {plus(d.getDay(), -1), d.getMonth(), d.getYear()};
    if (d.getMonth() == 1)
        return {31, 12, d.getYear() - 1};
    const short month = plus(d.getMonth(), -1);
    return {static_cast<short>(lengthOf(month, d.getYear())), month, d.getYear()};
}

Date moved(Date d, std::int64_t days)
{
    return d.moveBy(days);
}

std::string text(const Date& d)
{
    return d.toString().getCharacterArray();
}

} // namespace

TEST(DateTest, EveryDayOfEightCenturiesAgreesWithAWalk)
{
    const Date start(1, 1, -403);
    Date day = start;
    for (int n = 0; day.getYear() < 404; ++n) {
        ASSERT_TRUE(day.isValid()) << text(day);
        ASSERT_EQ(day - start, n) << text(day);
        ASSERT_EQ(start - day, -n) << text(day);
        ASSERT_EQ(moved(start, n), day) << text(day);
        ASSERT_EQ(moved(day, -n), start) << text(day);
        const Date next = walkedOn(day);
        ASSERT_EQ(day.getNext(), next) << text(day);
        ASSERT_EQ(next.getPrevious(), day) << text(day);
        day = next;
    }
}

TEST(DateTest, DifferencesNearYearAndLeapBoundariesAgreeWithAWalk)
{
    std::vector<std::pair<Date, int>> days; // with the number of steps from the first
    Date day(1, 1, 1893);
    for (int n = 0; day.getYear() < 2009; ++n, day = walkedOn(day)) {
        const int year = day.getYear();
        const bool nearCentury = year < 1906 || year > 1997;
        if (nearCentury && (day.getMonth() * 100 + day.getDay() < 103 || day.getMonth() * 100 + day.getDay() > 1229 ||
                            (day > Date(26, 2, year) && day < Date(3, 3, year))))
            days.emplace_back(day, n);
    }
    for (const auto& [a, atA] : days)
        for (const auto& [b, atB] : days) {
            ASSERT_EQ(a - b, atA - atB) << text(a) << " - " << text(b);
            ASSERT_EQ(moved(b, atA - atB), a) << text(b) << " -> " << text(a);
            ASSERT_EQ(a < b, atA < atB) << text(a) << " < " << text(b);
        }
}

TEST(DateTest, DifferencesInvolvingAnImpossibleDateAreMinusOne)
{
    const Date real(1, 3, 2000);
    for (const Date& d : {Date(31, 4, 1999), Date(), Date(1, 13, 1999), Date(29, 2, 1900), Date(0, 1, 1999),
                          Date(1, -1, 1999), Date(-1, 1, 1999)}) {
        EXPECT_FALSE(d.isValid()) << text(d);
        EXPECT_EQ(d - real, -1) << text(d);
        EXPECT_EQ(real - d, -1) << text(d);
        EXPECT_EQ(d - d, -1) << text(d);
    }
    EXPECT_TRUE(Date().isUndefined());
    EXPECT_FALSE(Date(0, 0, 1999).isUndefined());
}

TEST(DateTest, ShiftsOfImpossibleDatesAgreeWithAWalk)
{
    const Date starts[] = {{31, 4, 1999},      {30, 2, 2000},   {0, 0, 0},      {32767, 2, 2000},
                           {-32768, 12, 1900}, {5, 13, 1999},   {31, 0, 1999},  {1, -1, -5},
                           {40, 32767, 7},     {-3, -32768, 7}, {28, 13, 1999}, {1, 0, 1999}};
    for (const Date& start : starts) {
        Date on = start, back = start;
        // A bad month is 65,524 months of 31 days away from a real one at most.
        for (int n = 0; n < 2'200'000; ++n, on = walkedOn(on), back = walkedBack(back)) {
            if (n > 100 && n % 997 != 0)
                continue;
            ASSERT_EQ(text(moved(start, n)), text(on)) << text(start) << " + " << n;
            ASSERT_EQ(text(moved(start, -n)), text(back)) << text(start) << " - " << n;
        }
        EXPECT_TRUE(on.isValid() && back.isValid()) << text(start) << " never became a real date";
    }
}

TEST(DateTest, TheCalendarRepeatsEvery400Years)
{
    std::vector<Date> cycle;
    for (Date day(1, 1, 1600); day.getYear() < 2000; day = walkedOn(day))
        cycle.push_back(day);
    ASSERT_EQ(cycle.size(), 146'097U);
    std::mt19937 random(11);
    std::uniform_int_distribution<int> place(0, 146'096), cycles(-14'000, 14'000);
    for (int i = 0; i < 100'000; ++i) {
        const int from = place(random), to = place(random), later = cycles(random);
        const Date& a = cycle[static_cast<std::size_t>(from)];
        Date b = cycle[static_cast<std::size_t>(to)];
        b.setYear(b.getYear() + 400 * later);
        const int days = to - from + 146'097 * later;
        ASSERT_EQ(b - a, days) << text(b) << " - " << text(a);
        ASSERT_EQ(text(moved(a, days)), text(b)) << text(a) << " moved by " << days;
    }
}

TEST(DateTest, LargeShiftsAndDifferencesHaveTheirEdges)
{
    // 4,294,967,295 days are 29,398 cycles of 400 years, 21 years of which 6 are leap, and 18 days.
    Date day(1, 1, 2000);
    EXPECT_EQ(text(day + UINT_MAX), "19/01/11761221");
    EXPECT_EQ(text(day - INT_MAX - INT_MAX - 1), "01/01/2000");

    EXPECT_EQ(Date(1, 1, INT_MAX) - Date(1, 1, INT_MIN), INT_MAX) << "more days than an int holds";
    EXPECT_EQ(Date(1, 1, 2000) - Date(1, 1, 6'000'000), INT_MIN);
    EXPECT_EQ(Date(31, 12, INT_MIN) - Date(1, 1, INT_MIN), 365);
    EXPECT_EQ(Date(31, 12, INT_MAX) - Date(1, 3, INT_MAX), 305);
}

TEST(DateTest, ShiftingChangesTheDateItselfAndReturnsIt)
{
    Date day(28, 2, 2000);
    EXPECT_EQ(&(day + 1U), &day);
    EXPECT_EQ(text(day), "29/02/2000");
    EXPECT_EQ(&(day - 2), &day);
    EXPECT_EQ(text(day), "27/02/2000");
    for (const int n : {0, -5, INT_MIN})
        EXPECT_EQ(text(day - n), "27/02/2000") << "back by " << n << " leaves it alone";
}

TEST(DateTest, ABadMonthIsNamedOnceWhereItsLengthCounts)
{
    const struct {
        Date date;
        const char *next, *previous, *nextSays, *previousSays;
    } cases[] = {{{27, 13, 1999}, "28/13/1999", "26/13/1999", "", ""},
                 {{28, 13, 1999}, "29/13/1999", "27/13/1999", "Bad month...", ""},
                 {{31, 13, 1999}, "01/14/1999", "30/13/1999", "Bad month...", ""},
                 {{1, 13, 1999}, "02/13/1999", "31/12/1999", "", ""},
                 {{1, 14, 1999}, "02/14/1999", "31/13/1999", "", "Bad month..."},
                 {{1, 0, 1999}, "02/00/1999", "31/0-1/1999", "", "Bad month..."},
                 {{31, 0, 1999}, "01/01/1999", "30/00/1999", "Bad month...", ""},
                 {{31, 4, 1999}, "32/04/1999", "30/04/1999", "", ""}};
    for (const auto& c : cases) {
        testing::internal::CaptureStderr();
        EXPECT_EQ(text(c.date.getNext()), c.next);
        EXPECT_EQ(testing::internal::GetCapturedStderr(), c.nextSays) << "after " << text(c.date);
        testing::internal::CaptureStderr();
        EXPECT_EQ(text(c.date.getPrevious()), c.previous);
        EXPECT_EQ(testing::internal::GetCapturedStderr(), c.previousSays) << "before " << text(c.date);
    }
    testing::internal::CaptureStderr();
    EXPECT_FALSE(Date(1, 13, 1999).isValid());
    EXPECT_EQ(testing::internal::GetCapturedStderr(), "");
}

TEST(DateTest, DatesAreOrderedByYearMonthAndDayWithTheirSigns)
{
    const Date ascending[] = {{31, 12, INT_MIN}, {1, -1, -5}, {31, -1, -5}, {-1, 2, -5}, {0, 2, -5}, {1, 2, -5},
                              {0, 0, 0},         {1, 0, 0},   {1, 1, 5},    {31, 1, 5},  {1, 2, 5},  {1, 1, INT_MAX}};
    for (const Date& a : ascending)
        for (const Date& b : ascending) {
            EXPECT_EQ(a < b, &a < &b) << text(a) << " < " << text(b);
            EXPECT_EQ(a > b, &a > &b);
            EXPECT_EQ(a <= b, &a <= &b);
            EXPECT_EQ(a >= b, &a >= &b);
            EXPECT_EQ(a == b, &a == &b);
        }
}

TEST(DateTest, TextPadsDayAndMonthOnly)
{
    const struct {
        Date date;
        const char* text;
    } cases[] = {{{5, 3, 1999}, "05/03/1999"}, {{12, 11, 2003}, "12/11/2003"},
                 {{1, 1, 5}, "01/01/5"},       {{9, 10, -44}, "09/10/-44"},
                 {{-1, -12, 0}, "0-1/0-12/0"}, {{-32768, -32768, INT_MIN}, "0-32768/0-32768/-2147483648"}};
    for (const auto& c : cases)
        EXPECT_EQ(text(c.date), c.text);
}

TEST(DateTest, FileHoldsDayMonthAndYearInEightBytes)
{
    const struct {
        Date date;
        const char* bytes;
    } cases[] = {
        {{3, 5, 1999}, "0300 0500 CF070000"}, {{}, "0000 0000 00000000"}, {{-1, -2, -3}, "FFFF FEFF FDFFFFFF"}};
    for (const auto& c : cases) {
        EXPECT_EQ(bytesWritten(c.date), bytesOf(c.bytes)) << text(c.date);
        Date read(9, 9, 9);
        EXPECT_EQ(read.rd(BytesFile(bytesOf(c.bytes))), 0);
        EXPECT_EQ(read, c.date);
    }
    Date cut;
    EXPECT_EQ(cut.rd(BytesFile(bytesOf("0300 05"))), 0);
    EXPECT_EQ(cut, Date(3, -251, -1)) << "bytes that are missing read as 0xFF, without a complaint";
}
