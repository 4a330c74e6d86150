#pragma once

/// How a fetch of quotes has ended.
enum class FetchEnd {
    kFetched,
    kNoHistory, ///< the company's market is none that has a history; nobody was asked
    kNoHost,    ///< there is no host of that name
    kRefused,   ///< no connection: nobody listens there, or there is no way to it
    kSilent,    ///< the server has let a time limit pass
    kStopped,   ///< `StopCheck` has ended it
    kClosed,    ///< the server has closed the connection without a word
    kNoPrice,   ///< its page holds no price, or only a part of one
};
