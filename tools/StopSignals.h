#pragma once

#include "storage/Descriptor.h"

/// Turns SIGINT and SIGTERM into a request to stop that can be waited for. One object for a process; the signals stay
/// blocked when it is gone.
class StopSignals {
public:
    StopSignals();

    /// From the first signal on there is something to read here, for `poll` to tell.
    int descriptor() const { return descriptor_.number; }

private:
    Descriptor descriptor_;
};
