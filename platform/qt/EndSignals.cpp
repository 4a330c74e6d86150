#include "platform/qt/EndSignals.h"

#include <cerrno>
#include <csignal>
#include <fcntl.h>
#include <unistd.h>
#include <utility>

namespace {

int pipeEnds[2] = {-1, -1}; // to read from, to write to; open as long as the process

void noteSignal(int)
{
    const int reason = errno;
    const char signal = 0;
    (void)!write(pipeEnds[1], &signal, 1); // A full pipe has said it already.
    errno = reason;
}

int openPipe()
{
    if (pipeEnds[0] < 0)
        (void)!pipe2(pipeEnds, O_CLOEXEC | O_NONBLOCK);
    return pipeEnds[0];
}

} // namespace

EndSignals::EndSignals(std::function<void()> end) : notifier_(openPipe(), QSocketNotifier::Read)
{
    QObject::connect(&notifier_, &QSocketNotifier::activated, [end = std::move(end)] {
        char bytes[64];
        while (read(pipeEnds[0], bytes, sizeof bytes) > 0) {
        }
        end();
    });
    for (const int signal : {SIGTERM, SIGHUP, SIGINT}) {
        struct sigaction action {};
        sigaction(signal, nullptr, &action);
        if (action.sa_handler == SIG_IGN)
            continue;
        action = {};
        action.sa_handler = noteSignal;
        action.sa_flags = SA_RESTART;
        sigaction(signal, &action, nullptr);
    }
}
