#include "net/Wait.h"

#include <algorithm>
#include <cerrno>
#include <poll.h>

using Clock = std::chrono::steady_clock;

int waitInSlices(Clock::time_point deadline, const StopCheck& stop,
                 const std::function<int(Clock::time_point until)>& waitUntil)
{
    constexpr std::chrono::milliseconds kSlice(100);
    for (;;) {
        const Clock::time_point until = stop ? std::min(deadline, Clock::now() + kSlice) : deadline;
        if (const int result = waitUntil(until))
            return result;
        if (Clock::now() >= deadline)
            return kTimedOut;
        if (stop && stop())
            return kStopped;
    }
}

int pollUntil(int descriptor, short events, Clock::time_point until)
{
    const auto left = std::chrono::ceil<std::chrono::milliseconds>(until - Clock::now());
    if (left.count() <= 0)
        return 0;
    pollfd waiting{descriptor, events, 0};
    return poll(&waiting, 1, static_cast<int>(left.count()));
}

int waitFor(int descriptor, short events, Clock::time_point deadline, const StopCheck& stop)
{
    const int result = waitInSlices(deadline, stop, [&](Clock::time_point until) {
        const int ready = pollUntil(descriptor, events, until);
        return ready < 0 && errno == EINTR ? 0 : ready;
    });
    return result == 1 ? 0 : result;
}
