#pragma once

#include "market/Market.h"
#include "views/ObjectListView.h"

/// A market with its currency and the number of its companies.
class MarketItem final : public ColumnItem {
public:
    explicit MarketItem(Market* market) : market_(market) {}

    Market* object() const { return market_; }
    const void* key() const { return market_; }
    Cell cell(int column) const override;

private:
    Market* market_;
};

/// Markets in the order of the catalogue.
class MarketListView final : public ObjectListView<Market, MarketItem> {
public:
    /// `nameWidth` is the room for the names, in pixels.
    MarketListView(const char* name, float nameWidth);
    /// What the other columns take.
    static constexpr float kOtherWidth = 66 + 78;
};
