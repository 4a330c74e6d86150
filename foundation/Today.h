#pragma once

#include "foundation/Date.h"

/// The current day in local time, from the system clock unless `setToday` has said otherwise.
Date today();

/// Makes `today` give this day from now on, for tests; the undefined date goes back to the clock.
void setToday(const Date& day);
