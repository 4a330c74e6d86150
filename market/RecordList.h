#pragma once

#include "foundation/FieldIO.h"

/// Lists in a file: a count (i32), then as many records.

/// Writes the count, then each of `records` by its own `wrt`. @return 0; -1 at the first that cannot be written.
template <class Records, class... Stamp>
int writeRecords(FILE* file, const Records& records, const Stamp&... stamp)
{
    fwriteint(file, static_cast<int>(records.size()));
    for (const auto* record : records)
        if (record->wrt(file, stamp...) != 0)
            return -1;
    return 0;
}

/// Reads the count, and calls `read` for one record after the other while there are any.
/// @return 0; -1 when `read` has not given 0, and when the file ends before the last record does.
template <class Read>
int readRecords(FILE* file, const Read& read)
{
    auto missing = static_cast<unsigned>(freadint(file));
    for (; missing > 0 && !reachedEnd(file); --missing)
        if (read() != 0)
            return -1;
    return reachedEnd(file) ? -1 : 0;
}
