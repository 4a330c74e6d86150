#pragma once

#include "foundation/Serializable.h"
#include "foundation/String.h"

#include <cstdint>

/// A calendar date: day, month and full year in the Gregorian calendar, without time of day or time zone.
///
/// Any field values can be held; `isValid` tells whether they form a real date. 0/0/0 is the undefined date.
/// No operation takes time in proportion to its operand.
class Date final : public Serializable {
public:
    Date() = default;
    Date(short day, short month, int year) : day_(day), month_(month), year_(year) {}

    /// File: day (u16), month (u16), year (i32). Both always return 0; `reachedEnd` tells whether the date is whole.
    int wrt(FILE* file) const override;
    int rd(FILE* file) override;
    /// The 8 bytes of the file form, for records that are read in one piece.
    void decode(const unsigned char* bytes);
    void encode(unsigned char* bytes) const;
    static constexpr int kFileSize = 8;

    short getDay() const { return day_; }
    short getMonth() const { return month_; }
    int getYear() const { return year_; }
    void setDay(short day) { day_ = day; }
    void setMonth(short month) { month_ = month; }
    void setYear(int year) { year_ = year; }

    bool isValid() const;
    bool isUndefined() const { return day_ == 0 && month_ == 0 && year_ == 0; }

    /// Days in this date's month; a month outside 1..12 prints "Bad month..." on standard error and has 31.
    short getMonthLength() const;

    /// The following day. An impossible day or month just counts on until it forms a real date again.
    Date getNext() const;
    /// The preceding day.
    Date getPrevious() const;

    /// Signed number of days from `d` to this date; -1 when either is invalid, which is also the answer for the day
    /// before: callers check validity first where it matters. Clamped to the range of int.
    int operator-(const Date& d) const;

    /// Advances THIS date by `n` days and returns it. Intended: callers advance a variable by adding 1 to it, and copy
    /// first where they want a new date.
    Date& operator+(unsigned n);
    /// Moves THIS date back by `n` days and returns it; n <= 0 leaves it unchanged.
    Date& operator-(int n);
    /// Moves this date by `n` days forth, or back when `n` is negative.
    Date& moveBy(std::int64_t n);

    bool operator==(const Date& d) const { return key() == d.key(); }
    bool operator!=(const Date& d) const { return key() != d.key(); }
    bool operator<(const Date& d) const { return key() < d.key(); }
    bool operator<=(const Date& d) const { return key() <= d.key(); }
    bool operator>(const Date& d) const { return key() > d.key(); }
    bool operator>=(const Date& d) const { return key() >= d.key(); }

    /// "05/03/1999": day and month with two digits, the year as it is.
    String toString() const;

private:
    friend class PackedDate;

    /// Orders by year, month, day, each signed.
    std::uint64_t key() const
    {
        return static_cast<std::uint64_t>(static_cast<std::uint32_t>(year_) ^ 0x80000000U) << 32 |
               static_cast<std::uint64_t>(static_cast<std::uint16_t>(month_ ^ 0x8000)) << 16 |
               static_cast<std::uint16_t>(day_ ^ 0x8000);
    }
    bool hasMonth() const { return month_ >= 1 && month_ <= 12; }
    short lengthOfMonth() const;
    std::int64_t dayNumber() const;
    void setDayNumber(std::int64_t number);
    void advance(std::uint64_t n);
    void goBack(std::uint64_t n);
    std::uint64_t leaveBadMonth(std::uint64_t n, int direction, std::uint64_t monthsToReal);

    short day_ = 0;
    short month_ = 0;
    int year_ = 0;
};
