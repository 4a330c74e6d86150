#include "tools/StopSignals.h"

#include <cerrno>
#include <cstring>
#include <stdexcept>

namespace {

volatile std::sig_atomic_t stopRequested = 0;

void requestStop(int)
{
    stopRequested = 1;
}

} // namespace

StopSignals::StopSignals()
{
    sigemptyset(&stopping_);
    struct sigaction action {};
    action.sa_handler = requestStop; // without SA_RESTART: a signal ends the wait
    for (const int signal : {SIGINT, SIGTERM}) {
        sigaddset(&stopping_, signal);
        sigaction(signal, &action, nullptr);
    }
}

bool StopSignals::waitFor(std::span<pollfd> waiting, std::optional<std::chrono::milliseconds> limit) const
{
    constexpr int kThousand = 1000, kMillion = 1000000; // milliseconds a second, nanoseconds a millisecond
    const auto left = limit.value_or(std::chrono::milliseconds(0)).count();
    const timespec time{left / kThousand, left % kThousand * kMillion};
    // They are let in only while the poll waits: one that came between the test and the poll would be overlooked.
    sigset_t usual;
    sigprocmask(SIG_BLOCK, &stopping_, &usual);
    int ready = 0;
    if (stopRequested == 0)
        ready = ppoll(waiting.data(), waiting.size(), limit ? &time : nullptr, &usual);
    const int error = errno;
    sigprocmask(SIG_SETMASK, &usual, nullptr);
    if (ready < 0 && error != EINTR)
        throw std::runtime_error(std::strerror(error));
    return stopRequested == 0;
}
