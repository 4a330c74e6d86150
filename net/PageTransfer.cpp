#include "net/PageTransfer.h"

#include "net/QuoteServers.h"

#include <algorithm>

int connectToQuotes(Socket* socket, const String& host)
{
    // Before it connects, since that counts as a wait, too.
    socket->setTimeLimit(quoteServers().limit);
    return socket->connectToName(host, quoteServers().port);
}

int requestPage(Socket* socket, const String& path, const IsEnough& isEnough, ReceivedPage* page)
{
    String request("GET ");
    request += path;
    if (socket->writeLine(request) != 0)
        return -1;
    constexpr int kLongestTransfer = 10; // time limits: a server that trickles would take a day for a page
    const auto end = Socket::Clock::now() + kLongestTransfer * quoteServers().limit;
    char bytes[256];
    std::size_t known = 0; // characters that were not enough
    while (const std::size_t room = std::min(page->room(), sizeof bytes)) {
        // Two limits: a server may be silent for one, and send for ten, however often a byte comes.
        const auto deadline = std::min(end, Socket::Clock::now() + quoteServers().limit);
        std::size_t count = 0;
        const int result = socket->receive(bytes, room, deadline, &count);
        // What has come until now is a page cut anywhere, not one that the server has ended.
        if (result == Socket::kTimedOut)
            return -1;
        if (result != 0) {
            page->endWithBreak();
            return 0;
        }
        if (count == 0) {
            page->endWithClose();
            return 0;
        }
        // `isEnough` is asked again only when there is more text. Bytes that a zero byte hides make none.
        page->add({bytes, count});
        if (page->text().size() > known && isEnough(page->text()))
            return 0;
        known = page->text().size();
    }
    return 0;
}
