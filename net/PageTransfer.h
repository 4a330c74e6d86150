#pragma once

#include "net/FetchEnd.h"
#include "net/ReceivedPage.h"
#include "net/Socket.h"

#include <functional>
#include <string_view>

/// Connects to a quote server, at the port and with the time limit of `quoteServers()`. `stop` ends the waits of the
/// socket from now on. @return `kFetched`, or why there is no connection.
FetchEnd connectToQuotes(Socket* socket, const String& host, const StopCheck& stop);

/// Tells of the text that has come so far whether what follows makes no difference any more. It is asked after each
/// receive: once a byte at worst, of a text that is as long as a page at most.
using IsEnough = std::function<bool(std::string_view text)>;

/// Asks a connected server for `path` and receives its answer into `*page`, until that is enough or full, or the
/// connection ends.
/// @return `kFetched`; `kClosed` when the request cannot be sent, or there is no answer; `kSilent` when a receive has
/// waited for the time limit, or all for ten of them, before the page was enough; `kStopped`.
FetchEnd requestPage(Socket* socket, const String& path, const IsEnough& isEnough, ReceivedPage* page);
