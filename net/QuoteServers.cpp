#include "net/QuoteServers.h"

QuoteServers& quoteServers()
{
    constexpr std::chrono::seconds kLimit{30};
    static QuoteServers servers{PELORIN_QUOTE_HOST, PELORIN_HISTORY_HOST, PELORIN_QUOTE_PORT, kLimit};
    return servers;
}
