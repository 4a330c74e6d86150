#pragma once

#include "net/Socket.h"

#include <cstddef>
#include <string>

/// Connects to a quote server, at the port and with the time limit of `quoteServers()`. @return 0, or -1.
int connectToQuotes(Socket* socket, const String& host);

/// Asks a connected server for `path` and appends its answer to `*page`, as text, until that is longer than `limit`
/// characters, which it then exceeds by 256 at most, a receive fails, or ten time limits have passed.
///
/// The answer comes in chunks of 256 bytes of which a zero byte hides the rest. When the server has closed the
/// connection, the last chunk is appended again and again. Intended: a page always fills up, and what the parsers look
/// for stands in front.
/// @return 0; -1 when the request cannot be sent.
int requestPage(Socket* socket, const String& path, std::size_t limit, std::string* page);
