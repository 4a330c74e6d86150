#pragma once

#include "market/Currency.h"
#include "views/ObjectListView.h"

/// A currency with its latest rate.
class CurrencyItem final : public ColumnItem {
public:
    explicit CurrencyItem(Currency* currency) : currency_(currency) {}

    Currency* object() const { return currency_; }
    const void* key() const { return currency_; }
    Cell cell(int column) const override;

private:
    Currency* currency_;
};

/// The currencies in the order of the catalogue.
class CurrencyListView final : public ObjectListView<Currency, CurrencyItem> {
public:
    explicit CurrencyListView(const char* name);
};
