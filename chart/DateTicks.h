#pragma once

#include "chart/AxisTicks.h"
#include "foundation/Date.h"

// A calendar axis counts days: 0 is 1 January 2000, a Saturday.

/// The number of a valid date; of any other, and of one millions of years away, not a number.
double dayNumber(const Date& date);
/// The date of a number, whose fraction does not count. Numbers beyond those of dates are cut.
Date dateOfDay(double day);

/// What a calendar axis goes by: every so many days, weeks, months or years.
struct DateStep {
    enum class Unit { kDay, kWeek, kMonth, kYear };

    Unit unit;
    int count;
};

/// The days of `range` (numbers of days) that begin such a step, Mondays for weeks. Labels are day/month/year,
/// month/year or the year.
std::vector<AxisTick> dateTicks(const ChartRange& range, DateStep step);

/// The ticks of the finest step whose labels, centred below, keep `gap` pixels between them. Where no round day lies in
/// the range, its ends are labelled, as far as there is room.
std::vector<AxisTick> levelDateTicks(const ChartRange& range, double pixelsPerDay, const TextWidth& width, float gap);
