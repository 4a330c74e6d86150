#include "tools/StopSignals.h"

#include <cerrno>
#include <csignal>
#include <cstring>
#include <stdexcept>
#include <sys/signalfd.h>

Descriptor stopSignals()
{
    sigset_t stopping;
    sigemptyset(&stopping);
    sigaddset(&stopping, SIGINT);
    sigaddset(&stopping, SIGTERM);
    sigaddset(&stopping, SIGHUP); // of a terminal that is closed; programs that were started here do not get it
    // Blocked, a signal ends neither the program nor a read that is under way: it waits until somebody polls for it.
    sigprocmask(SIG_BLOCK, &stopping, nullptr);
    const int descriptor = signalfd(-1, &stopping, SFD_CLOEXEC);
    if (descriptor < 0)
        throw std::runtime_error(std::strerror(errno));
    return Descriptor(descriptor);
}
