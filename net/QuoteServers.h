#pragma once

#include "foundation/String.h"

#include <chrono>

/// Where quotes are fetched from, and how long a fetch waits.
struct QuoteServers {
    String latestHost;               // of the latest quotes
    String historyHost;              // of the history charts
    unsigned short port;             // of both
    std::chrono::milliseconds limit; // for connecting, and for each receive

    /// The request path of a latest quote; the ticker follows.
    static constexpr const char* kLatestPath = "/quotes?symbol=";
    /// What stands before and behind the ticker in the request path of a history.
    static constexpr const char* kHistoryPath = "/idc/nasdgraph.idc?usymbol=";
    static constexpr const char* kHistoryPathEnd = "&umos=03&site=nasdaq";
};

/// The servers in use: those that the build names (PELORIN_QUOTE_HOST, PELORIN_HISTORY_HOST, PELORIN_QUOTE_PORT) with
/// 30 seconds, until a test puts a server of its own in their place.
QuoteServers& quoteServers();
