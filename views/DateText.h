#pragma once

#include "foundation/Date.h"

#include <string>

/// "05/03/1999"; empty for the undefined date.
std::string dateText(const Date& date);

/// The date written as day, month and year with "/", "." or "-" between; blanks do not matter. The year is taken as
/// it stands, so 99 is a year of the first century.
/// @return the undefined date for any other text, and for a day that the calendar does not have.
Date readDate(const std::string& text);
