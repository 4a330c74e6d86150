#pragma once

#include "platform/SupportDefs.h"

#include <cstddef>
#include <vector>

/// What a list shows, in numbers that outlive its objects: for an undo, which makes new ones.
struct ListPlaces {
    std::vector<std::size_t> rows; // of each row the place of its object among those of the model
    // The others count all rows in their own order, whatever is shown of them, and in which order.
    std::vector<int32> selected; // ascending
    int32 count = 0;             // of all rows
    int32 top = 0;               // the first row in view
};
