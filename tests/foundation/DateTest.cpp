#include "foundation/Date.h"

#include <climits>
#include <gtest/gtest.h>
#include <vector>

namespace {

short lengthOf(short month, int year)
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
    const short month = plus(d.getMonth(), -1);
    return d.getMonth() == 1 ? Date(31, 12, d.getYear() - 1) : Date(lengthOf(month, d.getYear()), month, d.getYear());
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
    std::vector<Date> days{Date(1, 1, -403)};
    for (std::size_t n = 0; days[n].getYear() < 398; ++n) {
        const Date day = days[n], next = walkedOn(day);
        ASSERT_TRUE(day.isValid()) << text(day);
        ASSERT_EQ(day.getNext(), next) << text(day);
        ASSERT_EQ(next.getPrevious(), day) << text(day);
        // The distances at which years, leap years and centuries differ.
        for (const int distance : {0, 1, 59, 60, 364, 365, 366, 367, 1460, 1461, 36524, 36525, 146096, 146097}) {
            if (static_cast<std::size_t>(distance) > n)
                break;
            const Date& before = days[n - static_cast<std::size_t>(distance)];
            ASSERT_EQ(day - before, distance) << text(day) << " - " << text(before);
            ASSERT_EQ(before - day, -distance) << text(before) << " - " << text(day);
            ASSERT_EQ(moved(before, distance), day) << text(before) << " + " << distance;
            ASSERT_EQ(moved(day, -distance), before) << text(day) << " - " << distance;
        }
        days.push_back(next);
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
    for (const Date& start :
         {Date(31, 4, 1999), Date(30, 2, 2000), Date(), Date(32767, 2, 2000), Date(5, 13, 1999), Date(-32768, 12, 1900),
          Date(31, 0, 1999), Date(1, -1, -5), Date(40, 32767, 7), Date(-3, -32768, 7), Date(1, 0, 1999)}) {
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

TEST(DateTest, ShiftsChangeTheDateItselfHoweverFarTheyGo)
{
    Date day(28, 2, 2000);
    EXPECT_EQ(&(day + 1), &day);
    EXPECT_EQ(text(day), "29/02/2000");
    day - 59;
    for (const int n : {0, -5, INT_MIN})
        EXPECT_EQ(text(day - n), "01/01/2000") << "back by " << n << " leaves it alone";
    // 4,294,967,295 days are 29,398 cycles of 400 years, 21 years of which 6 are leap, and 18 days.
    EXPECT_EQ(text(day + UINT_MAX), "19/01/11761221");
    EXPECT_EQ(text(day - INT_MAX - INT_MAX - 1), "01/01/2000");

    EXPECT_EQ(Date(1, 1, INT_MAX) - Date(1, 1, INT_MIN), INT_MAX) << "more days than an int holds";
    EXPECT_EQ(Date(1, 1, 2000) - Date(1, 1, 6'000'000), INT_MIN);
    EXPECT_EQ(Date(31, 12, INT_MIN) - Date(1, 1, INT_MIN), 365);
}
