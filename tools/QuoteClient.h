#pragma once

#include "net/Socket.h"

#include <memory>
#include <poll.h>
#include <string>

class QuoteFetches;
class QuoteFolder;

/// Where the pages of a quote server come from.
struct QuoteShelf {
    const QuoteFolder& folder;
    QuoteFetches* fetches; // bring the folder up to date before it answers; null for none
};

/// A client of the quote server: sends one request line and gets the page for it, perhaps after the source of quotes
/// has been asked for its ticker. Nothing here waits.
class QuoteClient {
public:
    /// From now on it has `kLimit` to ask and to take its page; the time that a source takes does not count.
    explicit QuoteClient(std::unique_ptr<Socket> connection);

    /// What is to be waited for: its request, or room for the page. Nothing but its leaving while a source is asked.
    pollfd waiting() const;
    /// When its time is over: that of the client, or that of a source, without which it is answered then.
    Socket::Clock::time_point deadline() const { return deadline_; }
    bool isWaitingForSource() const { return isWaitingForSource_; }

    /// Goes on with what has come, what can be sent, or what the source has brought; `events` is what `poll` has told.
    /// @return false when it has its page, when it has gone, and when its request is too long.
    bool proceed(const QuoteShelf& shelf, short events);

private:
    static constexpr std::chrono::seconds kLimit{5};

    bool receive(const QuoteShelf& shelf);
    bool waitForSource(const QuoteShelf& shelf, short events);
    bool answer(const QuoteShelf& shelf);
    bool send();

    std::unique_ptr<Socket> connection_;
    Socket::Clock::time_point deadline_;
    std::string request_; // as far as it has come
    bool isWaitingForSource_ = false;
    std::string page_; // empty until the request is there
    std::size_t sent_ = 0;
};
