#include "tools/QuoteClient.h"

#include "tools/QuoteFetches.h"
#include "tools/QuoteFolder.h"

#include <cerrno>
#include <string_view>

namespace {

constexpr std::size_t kLongestRequest = 4096;

bool isOnlyNotReady()
{
    return errno == EAGAIN || errno == EINTR;
}

} // namespace

QuoteClient::QuoteClient(std::unique_ptr<Socket> connection)
    : connection_(std::move(connection)), deadline_(Socket::Clock::now() + kLimit)
{}

pollfd QuoteClient::waiting() const
{
    const int events = isWaitingForSource_ ? 0 : page_.empty() ? POLLIN : POLLOUT;
    return {connection_->descriptor(), static_cast<short>(events), 0};
}

bool QuoteClient::proceed(const QuoteShelf& shelf, short events)
{
    if (isWaitingForSource_)
        return waitForSource(shelf, events);
    return page_.empty() ? receive(shelf) : send();
}

/// The request ends as a line that a `Socket` reads: with a line feed, or before a zero byte.
bool QuoteClient::receive(const QuoteShelf& shelf)
{
    char bytes[kLongestRequest];
    const ssize_t count = recv(connection_->descriptor(), bytes, sizeof bytes, MSG_DONTWAIT);
    if (count <= 0)
        return count < 0 && isOnlyNotReady();
    const std::string_view come(bytes, static_cast<std::size_t>(count));
    const std::size_t end = come.find_first_of(std::string_view("\n\0", 2));
    // What comes behind the line end is lost: a client has one request.
    request_ += come.substr(0, end);
    if (request_.size() > kLongestRequest)
        return false;
    if (end == come.npos)
        return true;
    if (shelf.fetches == nullptr || !shelf.fetches->ask(std::string(QuoteFolder::tickerOf(request_))))
        return answer(shelf);
    isWaitingForSource_ = true;
    deadline_ = Socket::Clock::now() + shelf.fetches->limit();
    return true;
}

/// A source that has others to tell of first may take longer than a client waits: what comes later is for the next one.
bool QuoteClient::waitForSource(const QuoteShelf& shelf, short events)
{
    if (events != 0)
        return false;
    if (shelf.fetches->isAsking(std::string(QuoteFolder::tickerOf(request_))) && Socket::Clock::now() < deadline_)
        return true;
    isWaitingForSource_ = false;
    deadline_ = Socket::Clock::now() + kLimit;
    return answer(shelf);
}

bool QuoteClient::answer(const QuoteShelf& shelf)
{
    // A page is never empty, so from here on the client is one that takes its page.
    page_ = shelf.folder.answer(request_);
    return send();
}

bool QuoteClient::send()
{
    const ssize_t count =
        ::send(connection_->descriptor(), page_.data() + sent_, page_.size() - sent_, MSG_DONTWAIT | MSG_NOSIGNAL);
    if (count < 0)
        return isOnlyNotReady();
    sent_ += static_cast<std::size_t>(count);
    return sent_ < page_.size();
}
