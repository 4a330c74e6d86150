#include "net/PageTransfer.h"

#include "net/QuoteServers.h"

#include <algorithm>

namespace {

/// Of a wait that has failed.
FetchEnd endOf(int result, FetchEnd otherwise)
{
    switch (result) {
    case kTimedOut:
        return FetchEnd::kSilent;
    case kStopped:
        return FetchEnd::kStopped;
    case Socket::kNoHost:
        return FetchEnd::kNoHost;
    default:
        return otherwise;
    }
}

} // namespace

FetchEnd connectToQuotes(Socket* socket, const String& host, const StopCheck& stop)
{
    socket->setTimeLimit(quoteServers().limit);
    socket->setStopCheck(stop);
    if (socket->connectToName(host, quoteServers().port) == 0)
        return FetchEnd::kFetched;
    return endOf(socket->connectFailure(), FetchEnd::kRefused);
}

FetchEnd requestPage(Socket* socket, const String& path, const IsEnough& isEnough, ReceivedPage* page)
{
    String request("GET ");
    request += path;
    if (socket->writeLine(request) != 0)
        return FetchEnd::kClosed;
    constexpr int kLongestTransfer = 10; // time limits: a server that trickles would take a day for a page
    const auto end = Socket::Clock::now() + kLongestTransfer * quoteServers().limit;
    char bytes[256];
    std::size_t known = 0; // characters that were not enough
    while (const std::size_t room = std::min(page->room(), sizeof bytes)) {
        const auto deadline = std::min(end, Socket::Clock::now() + quoteServers().limit);
        std::size_t count = 0;
        const int result = socket->receive(bytes, room, deadline, &count);
        // What has come until now is a page cut anywhere, not one that the server has ended.
        if (result == kTimedOut || result == kStopped)
            return endOf(result, FetchEnd::kClosed);
        if (result != 0 || count == 0) {
            const FetchEnd outcome = page->received().empty() ? FetchEnd::kClosed : FetchEnd::kFetched;
            result != 0 ? page->endWithBreak() : page->endWithClose();
            return outcome;
        }
        page->add({bytes, count});
        if (page->text().size() > known && isEnough(page->text()))
            break;
        known = page->text().size();
    }
    return FetchEnd::kFetched;
}
