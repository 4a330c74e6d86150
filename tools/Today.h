#pragma once

#include "foundation/Date.h"

/// Today's date, local time.
Date today();
