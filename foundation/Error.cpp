#include "foundation/Error.h"

#include <cstdio>
#include <cstdlib>

void xError(const String& message)
{
    std::fprintf(stderr, "%s\n", message.getCharacterArray());
    std::exit(-1);
}
