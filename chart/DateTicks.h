#pragma once

#include "chart/AxisTicks.h"
#include "foundation/Date.h"

// A calendar axis counts days: 0 is 1 January 2000, a Saturday.

/// The number of a valid date; of any other, and of one millions of years away, not a number.
double dayNumber(const Date& date);
/// The date of a number, whose fraction does not count. Numbers beyond those of dates are cut.
Date dateOfDay(double day);

/// The days of `range` that begin a step of so many days, weeks (Mondays), months or years: of the finest step whose
/// labels, centred below, keep `gap` pixels between them. Labels are day/month/year, month/year or the year. Where no
/// round day lies in the range, its ends are labelled, as far as there is room.
std::vector<AxisTick> levelDateTicks(const ChartRange& range, double pixelsPerDay, const TextWidth& width, float gap);
