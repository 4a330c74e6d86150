#pragma once

#include "foundation/Date.h"

// A calendar axis counts days: 0 is 1 January 2000, a Saturday.

/// The number of a valid date; of any other, and of one millions of years away, not a number.
double dayNumber(const Date& date);
/// The date of a number, whose fraction does not count. Numbers beyond those of dates are cut.
Date dateOfDay(double day);
