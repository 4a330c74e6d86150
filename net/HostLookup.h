#pragma once

#include <chrono>
#include <netinet/in.h>
#include <optional>

/// Finds the first IPv4 address of a host by `gethostbyname`, whose answers it gives; a host without an address leaves
/// `*address` alone. Where the deadline passes first, the search ends by itself some time later.
/// @return 0; -1 when there is no such host, or at the deadline.
int lookUpHost(const char* host, std::optional<std::chrono::steady_clock::time_point> deadline, in_addr* address);
