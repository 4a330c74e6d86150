#pragma once

#include <chrono>
#include <csignal>
#include <optional>
#include <poll.h>
#include <span>

/// Turns SIGINT and SIGTERM into a request to stop. One object for a process; the handlers stay when it is gone.
class StopSignals {
public:
    StopSignals();

    /// Waits until one of the descriptors is ready, as `poll` does, or for `limit`, if any; another signal also ends
    /// the wait, with none ready.
    /// @return false when it is time to stop.
    bool waitFor(std::span<pollfd> waiting, std::optional<std::chrono::milliseconds> limit) const;

private:
    sigset_t stopping_;
};
