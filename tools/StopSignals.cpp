#include "tools/StopSignals.h"

#include <cerrno>
#include <cstring>
#include <poll.h>
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
    action.sa_handler = requestStop; // without SA_RESTART: a signal also ends the wait for a client's request
    for (const int signal : {SIGINT, SIGTERM}) {
        sigaddset(&stopping_, signal);
        sigaction(signal, &action, nullptr);
    }
}

bool StopSignals::waitFor(int descriptor) const
{
    // They are let in only while the poll waits: one that came between the test and the poll would be overlooked.
    sigset_t usual;
    sigprocmask(SIG_BLOCK, &stopping_, &usual);
    pollfd waiting{descriptor, POLLIN, 0};
    int ready = 0;
    while (stopRequested == 0 && ready == 0) {
        ready = ppoll(&waiting, 1, nullptr, &usual);
        if (ready < 0 && errno == EINTR)
            ready = 0;
    }
    const int error = errno;
    sigprocmask(SIG_SETMASK, &usual, nullptr);
    if (ready < 0)
        throw std::runtime_error(std::strerror(error));
    return stopRequested == 0;
}
