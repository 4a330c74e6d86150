#pragma once

#include "net/Wait.h"

#include <netinet/in.h>
#include <optional>

/// Finds the first IPv4 address of a host by `gethostbyname`, whose answers it gives; a host without an address leaves
/// `*address` alone. Where the wait ends before, the search ends by itself some time later.
/// @return 0; -1 when there is no such host, `kTimedOut` or `kStopped`.
int lookUpHost(const char* host, std::optional<std::chrono::steady_clock::time_point> deadline, const StopCheck& stop,
               in_addr* address);
