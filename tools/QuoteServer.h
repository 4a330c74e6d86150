#pragma once

#include "storage/Descriptor.h"
#include "tools/QuoteClient.h"

#include <vector>

/// Answers quote requests out of a folder, those of several clients at once, on one thread. A source of quotes is asked
/// meanwhile: only those wait for it who ask for its ticker.
///
/// A client that has not got its page in time is sent away, and so is the one that has been there longest when there
/// are too many: one that asks at once is answered however many are silent.
class QuoteServer {
public:
    /// `listener` listens already; it and what is on the shelf outlive the server.
    QuoteServer(Socket& listener, const QuoteShelf& shelf);

    /// Serves until there is something to read at `stop`.
    void serve(const Descriptor& stop);

private:
    static constexpr int kMostClients = 64;

    std::vector<pollfd> waiting(const Descriptor& stop) const;
    int timeLeft() const;
    void proceed(const std::vector<pollfd>& ready);
    void acceptClients();
    bool acceptClient();

    Socket& listener_;
    QuoteShelf shelf_;
    std::vector<QuoteClient> clients_; // in the order in which they came
};
