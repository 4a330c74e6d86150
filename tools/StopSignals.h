#pragma once

#include <csignal>

/// Turns SIGINT and SIGTERM into a request to stop. One object for a process; the handlers stay when it is gone.
class StopSignals {
public:
    StopSignals();

    /// Waits until `descriptor` has something to read. @return false when it is time to stop.
    bool waitFor(int descriptor) const;

private:
    sigset_t stopping_;
};
