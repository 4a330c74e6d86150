#pragma once

#include "valuation/ShareState.h"
#include "views/ObjectListView.h"

/// A holding with what it is worth. The row keeps to its valuation: quotes and rates that come later show with the
/// next.
class ShareStateItem final : public ColumnItem {
public:
    explicit ShareStateItem(ShareState* state) : state_(state), share_(state->share()), basis_(state->quoteBasis()) {}

    ShareState* object() const { return state_; }
    const void* key() const { return share_; }
    Cell cell(int column) const override;

private:
    Cell quoteDay() const;
    Cell gain() const;

    ShareState* state_;
    const Share* share_;
    QuoteBasis basis_; // from when the row was made
};

/// The holdings of the portfolio.
class ShareStateListView final : public ObjectListView<ShareState, ShareStateItem> {
public:
    explicit ShareStateListView(const char* name);
};
