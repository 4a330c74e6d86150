#pragma once

#include "market/Market.h"
#include "views/ObjectListView.h"

/// A market with its currency and the number of its companies.
class MarketItem final : public ObjectItem<Market> {
public:
    using ObjectItem::ObjectItem;
    Cell cell(int column) const override;
};

/// Markets in the order of the catalogue.
class MarketListView final : public ObjectListView<Market, MarketItem> {
public:
    /// `nameWidth` is the room for the names, in pixels.
    MarketListView(const char* name, float nameWidth);
    /// What the other columns take.
    static constexpr float kOtherWidth = 66 + 78;
};
