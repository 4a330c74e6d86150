#include "valuation/Holding.h"

#include "portfolio/ShareOperation.h"

#include <cstdint>

namespace {

/// Quantities come from files, where they may be anything: a sum beyond 32 bits wraps around.
int addWrapping(int a, std::int64_t b)
{
    return static_cast<int>(a + b);
}

} // namespace

void Holding::buy(const ShareOperation& purchase, int period)
{
    const std::int64_t bought = purchase.getQuantity();
    const std::int64_t total = bought + quantity;
    if (total != 0) { // a holding that was as far below zero keeps its price: there is no average
        const double paid = static_cast<double>(purchase.getQuote()) * static_cast<double>(bought);
        buyQuote = static_cast<float>((paid + static_cast<double>(buyQuote) * quantity) / static_cast<double>(total));
        Date horizon = purchase.getDate();
        horizon.moveBy(period);
        if (quantity == 0)
            endDate = horizon;
        else
            // Intended: a whole-number division, so that a holding above zero keeps the end date of its first
            // purchase. Automatic sales rely on it.
            endDate = endDate.date().moveBy(bought / total * (horizon - endDate.date()));
    }
    // Price and end date above were taken from the former quantity, so it changes last.
    quantity = addWrapping(quantity, bought);
}

void Holding::sell(const ShareOperation& sale)
{
    // Below zero is possible: a sale is replayed whatever is held.
    quantity = addWrapping(quantity, -static_cast<std::int64_t>(sale.getQuantity()));
}
