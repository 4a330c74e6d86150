#pragma once

#include "foundation/String.h"

/// Ends the process after a fatal internal error: prints `message` and a newline on standard error, exit status -1.
[[noreturn]] void xError(const String& message);
