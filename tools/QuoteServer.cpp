#include "tools/QuoteServer.h"

#include "tools/QuoteFetches.h"

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <stdexcept>

namespace {

/// Where what is waited for stands in the list.
enum Place : std::size_t { kListener, kStop, kClients };

} // namespace

QuoteServer::QuoteServer(Socket& listener, const QuoteShelf& shelf) : listener_(listener), shelf_(shelf)
{
    // A client may be gone again before it is accepted; that must not become a wait for the next one.
    const int descriptor = listener.descriptor();
    fcntl(descriptor, F_SETFL, fcntl(descriptor, F_GETFL) | O_NONBLOCK);
    // The few that a socket lets stand in line fill up when many come at once; one more would try again in a second.
    listen(descriptor, kMostClients);
}

void QuoteServer::serve(const Descriptor& stop)
{
    for (;;) {
        std::vector<pollfd> all = waiting(stop);
        if (poll(all.data(), all.size(), timeLeft()) < 0 && errno != EINTR)
            throw std::runtime_error(std::strerror(errno));
        if (all[kStop].revents != 0)
            return;
        // Before the clients, of whom some wait for what has come.
        if (shelf_.fetches != nullptr)
            shelf_.fetches->proceed();
        // The clients that are there first: those who come now would shift the places that `all` was made for.
        proceed(all);
        if (all[kListener].revents != 0)
            acceptClients();
    }
}

/// The listener and `stop`, behind them the clients in their order, and then what the source is asked with.
std::vector<pollfd> QuoteServer::waiting(const Descriptor& stop) const
{
    std::vector<pollfd> all = {{listener_.descriptor(), POLLIN, 0}, {stop.number, POLLIN, 0}};
    for (const QuoteClient& client : clients_)
        all.push_back(client.waiting());
    if (shelf_.fetches != nullptr)
        shelf_.fetches->addWaiting(all);
    return all;
}

/// The milliseconds until the first time is over; -1, which `poll` takes for ever, when there is none.
int QuoteServer::timeLeft() const
{
    auto next = shelf_.fetches != nullptr ? shelf_.fetches->nextLook() : Socket::Clock::time_point::max();
    for (const QuoteClient& client : clients_)
        next = std::min(next, client.deadline());
    if (next == Socket::Clock::time_point::max())
        return -1;
    const auto left = next - Socket::Clock::now();
    return std::max(static_cast<int>(std::chrono::ceil<std::chrono::milliseconds>(left).count()), 0);
}

void QuoteServer::proceed(const std::vector<pollfd>& ready)
{
    std::vector<QuoteClient> staying;
    for (std::size_t i = 0; i < clients_.size(); ++i) {
        QuoteClient& client = clients_[i];
        // Whom nothing has come from is only asked for the time; one that is ready may have come to its end.
        const short events = ready[kClients + i].revents;
        const bool stays = (events == 0 && !client.isWaitingForSource()) || client.proceed(shelf_, events);
        if (stays && Socket::Clock::now() < client.deadline())
            staying.push_back(std::move(client));
    }
    clients_ = std::move(staying); // which closes the connections of the others
}

void QuoteServer::acceptClients()
{
    // No more than half of those there is room for, so that each has had its turn before it can be one too many.
    int left = kMostClients / 2;
    while (left > 0 && acceptClient())
        --left;
}

/// @return false when nobody stands in line.
bool QuoteServer::acceptClient()
{
    // Without a free descriptor nobody can be accepted, and the listener would stay ready for ever. So the oldest
    // client goes, and the next turn of the loop has its descriptor.
    Socket* accepted = nullptr;
    const bool isThere = listener_.acceptConnection(&accepted) == 0;
    if (isThere)
        clients_.emplace_back(std::unique_ptr<Socket>(accepted));
    const bool areTooMany = isThere ? std::ssize(clients_) > kMostClients : errno == EMFILE || errno == ENFILE;
    if (areTooMany && !clients_.empty())
        clients_.erase(clients_.begin());
    return isThere;
}
