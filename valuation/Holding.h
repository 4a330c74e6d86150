#pragma once

#include "foundation/PackedDate.h"

class ShareOperation;

/// A number of shares with their average purchase price, as the purchases and sales replayed so far have left it.
struct Holding {
    int quantity = 0;
    float buyQuote = 0; // average purchase price, weighted by quantity
    PackedDate endDate; // end of the investment horizon

    /// Adds a purchase; `period` is the length of the horizon in days. A first purchase sets the end date; a further
    /// one moves it by whole multiples of the distance to its own, which for a positive holding is none.
    void buy(const ShareOperation& purchase, int period);
    /// Takes off a sale: average price and end date stay.
    void sell(const ShareOperation& sale);
};
