#pragma once

#include "market/Currency.h"
#include "views/ObjectListView.h"

/// A currency with its latest rate.
class CurrencyItem final : public ObjectItem<Currency> {
public:
    using ObjectItem::ObjectItem;
    Cell cell(int column) const override;
};

/// The currencies in the order of the catalogue.
class CurrencyListView final : public ObjectListView<Currency, CurrencyItem> {
public:
    explicit CurrencyListView(const char* name);
};
