#include "tools/QuoteServer.h"

#include "tools/StopSignals.h"

#include <algorithm>
#include <cerrno>
#include <fcntl.h>

QuoteServer::QuoteServer(Socket& listener, const QuoteFolder& folder) : listener_(listener), folder_(folder)
{
    // A client may be gone again before it is accepted; that must not become a wait for the next one.
    int descriptor = -1;
    listener.getDescriptor(&descriptor);
    fcntl(descriptor, F_SETFL, fcntl(descriptor, F_GETFL) | O_NONBLOCK);
    // The few that a socket lets stand in line fill up when many come at once; one more would try again in a second.
    listen(descriptor, kMostClients);
}

void QuoteServer::serve(const StopSignals& signals)
{
    for (std::vector<pollfd> all = waiting(); signals.waitFor(all, timeLeft()); all = waiting()) {
        proceed(all);
        if (all.front().revents != 0)
            acceptClients();
    }
}

/// The listener, and behind it the clients in their order.
std::vector<pollfd> QuoteServer::waiting() const
{
    int descriptor = -1;
    listener_.getDescriptor(&descriptor);
    std::vector<pollfd> all = {{descriptor, POLLIN, 0}};
    for (const QuoteClient& client : clients_)
        all.push_back(client.waiting());
    return all;
}

/// Until the first client's time is over; none when there is no client.
std::optional<std::chrono::milliseconds> QuoteServer::timeLeft() const
{
    if (clients_.empty())
        return std::nullopt;
    const auto left = clients_.front().deadline() - Socket::Clock::now();
    return std::max(std::chrono::ceil<std::chrono::milliseconds>(left), std::chrono::milliseconds(0));
}

void QuoteServer::proceed(const std::vector<pollfd>& ready)
{
    std::vector<QuoteClient> staying;
    for (std::size_t i = 0; i < clients_.size(); ++i) {
        QuoteClient& client = clients_[i];
        const bool stays = ready[i + 1].revents == 0 || client.proceed(folder_);
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
    Socket* accepted = nullptr;
    const bool isThere = listener_.acceptConnection(&accepted) == 0;
    if (isThere)
        clients_.emplace_back(std::unique_ptr<Socket>(accepted));
    const bool areTooMany = isThere ? std::ssize(clients_) > kMostClients : errno == EMFILE || errno == ENFILE;
    if (areTooMany && !clients_.empty())
        clients_.erase(clients_.begin());
    return isThere;
}
