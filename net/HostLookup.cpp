#include "net/HostLookup.h"

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <future>
#include <netdb.h>
#include <string>
#include <string_view>
#include <system_error>
#include <thread>
#include <vector>

namespace {

struct Answer {
    bool isHost = false;
    std::optional<in_addr> first;
};

Answer search(const std::string& host)
{
    hostent entry{};
    hostent* found = nullptr;
    int error = 0;
    constexpr std::size_t kUsual = 1024;
    std::vector<char> room(kUsual);
    while (gethostbyname_r(host.c_str(), &entry, room.data(), room.size(), &found, &error) == ERANGE)
        room.resize(2 * room.size());
    if (found == nullptr || found->h_length < 1)
        return {};
    Answer answer{true, std::nullopt};
    if (const char* address = found->h_addr_list[0])
        std::memcpy(&answer.first.emplace(), address,
                    std::min(sizeof(in_addr), static_cast<std::size_t>(found->h_length)));
    return answer;
}

/// A name server that is silent holds a search for many seconds, and nothing interrupts it. So a thread searches, which
/// is left to itself when the wait is over; it owns all that it touches.
/// @return 0, `kTimedOut` or `kStopped`.
int searchUntil(std::chrono::steady_clock::time_point deadline, const StopCheck& stop, const char* host, Answer* answer)
{
    std::packaged_task<Answer()> task([name = std::string(host)] { return search(name); });
    std::future<Answer> found = task.get_future();
    try {
        std::thread(std::move(task)).detach();
    } catch (const std::system_error&) {
        return 0; // no thread can be had, and without one nothing would keep the deadline
    }
    constexpr int kFound = 1;
    const int result = waitInSlices(deadline, stop, [&](std::chrono::steady_clock::time_point until) {
        return found.wait_until(until) == std::future_status::ready ? kFound : 0;
    });
    if (result != kFound)
        return result;
    *answer = found.get();
    return 0;
}

/// A dotted address is never asked for elsewhere.
bool isNumeric(std::string_view host)
{
    return host.find_first_not_of("0123456789.") == host.npos && !host.ends_with('.');
}

} // namespace

int lookUpHost(const char* host, std::optional<std::chrono::steady_clock::time_point> deadline, const StopCheck& stop,
               in_addr* address)
{
    Answer answer;
    if (!deadline || isNumeric(host))
        answer = search(host);
    else if (const int result = searchUntil(*deadline, stop, host, &answer))
        return result;
    if (!answer.isHost)
        return -1;
    *address = answer.first.value_or(*address);
    return 0;
}
