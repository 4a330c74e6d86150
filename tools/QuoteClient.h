#pragma once

#include "net/Socket.h"

#include <memory>
#include <poll.h>
#include <string>

class QuoteFolder;

/// A client of the quote server: sends one request line and gets the page for it. Nothing here waits.
class QuoteClient {
public:
    /// From now on it has `kLimit` to ask and to take its page.
    explicit QuoteClient(std::unique_ptr<Socket> connection);

    /// What is to be waited for: its request, or room for the page.
    pollfd waiting() const;
    Socket::Clock::time_point deadline() const { return deadline_; }

    /// Goes on with what has come, or what can be sent.
    /// @return false when it has its page, when it has gone, and when its request is too long.
    bool proceed(const QuoteFolder& folder);

private:
    static constexpr std::chrono::seconds kLimit{5};

    bool receive(const QuoteFolder& folder);
    bool send();

    std::unique_ptr<Socket> connection_;
    Socket::Clock::time_point deadline_;
    std::string request_; // as far as it has come
    std::string page_;    // empty until the request is there
    std::size_t sent_ = 0;
};
