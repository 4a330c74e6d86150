#include "net/PageTransfer.h"

#include "net/QuoteServers.h"

#include <chrono>

int connectToQuotes(Socket* socket, const String& host)
{
    socket->setTimeLimit(quoteServers().limit);
    // A short chunk keeps the end of the one before. Waiting for whole ones leaves that to the end of the page, however
    // the network cuts it into packets.
    socket->setWholeReceives(true);
    return socket->connectToName(host, quoteServers().port);
}

int requestPage(Socket* socket, const String& path, std::size_t limit, std::string* page)
{
    String request("GET ");
    request += path;
    if (socket->writeLine(request) != 0)
        return -1;
    constexpr int kChunk = 256;
    char chunk[kChunk + 1] = {};
    // A server that has closed without a word, or that sends zeros, adds nothing for ever; one that trickles would take
    // a day for a page.
    std::size_t useless = 0;
    constexpr int kLongestTransfer = 10; // time limits
    const auto end = std::chrono::steady_clock::now() + kLongestTransfer * quoteServers().limit;
    while (page->size() <= limit && useless <= limit && std::chrono::steady_clock::now() < end &&
           socket->getCharacterArray(chunk, kChunk) == 0) {
        chunk[kChunk] = '\0';
        page->append(chunk);
        useless += chunk[0] == '\0' ? 1 : 0;
    }
    return 0;
}
