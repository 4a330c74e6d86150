#pragma once

#include "storage/Descriptor.h"

/// Turns SIGINT, SIGTERM and SIGHUP, for the rest of the program's life, into a request to stop that can be waited for:
/// from the first one on there is something to read at the descriptor, for `poll` to tell. It is for one caller.
Descriptor stopSignals();
