#pragma once

#include "market/Quote.h"
#include "views/DatedListView.h"

/// A day and the value of that day.
class QuoteItem final : public ColumnItem {
public:
    explicit QuoteItem(Quote* quote) : quote_(quote) {}

    Quote* object() const { return quote_; }
    const void* key() const { return quote_; }
    void release() { quote_ = nullptr; }
    Cell cell(int column) const override;

private:
    Quote* quote_;
};

/// The quotes of a company or the rates of a currency, by date; several can be selected.
class QuoteListView final : public DatedListView<Quote, QuoteItem> {
public:
    explicit QuoteListView(const char* name);
};
