#pragma once

#include <cstdio>
#include <cstdlib>

/// Ends the run as a finding when a rule does not hold.
inline void require(bool holds, const char* rule)
{
    if (holds)
        return;
    std::fprintf(stderr, "Does not hold: %s\n", rule);
    std::abort();
}
