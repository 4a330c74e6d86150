#include "tools/QuoteClient.h"

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
    return {connection_->descriptor(), static_cast<short>(page_.empty() ? POLLIN : POLLOUT), 0};
}

bool QuoteClient::proceed(const QuoteFolder& folder)
{
    return page_.empty() ? receive(folder) : send();
}

/// The request ends as a line that a `Socket` reads: with a line feed, or before a zero byte.
bool QuoteClient::receive(const QuoteFolder& folder)
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
    // A page is never empty, so from here on the client is one that takes its page.
    page_ = folder.answer(request_);
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
