#pragma once

#include "valuation/ShareState.h"
#include "views/ObjectListView.h"

/// A holding with what it is worth. The row keeps to its valuation: quotes and rates that come later show with the
/// next.
class ShareStateItem final : public ColumnItem {
public:
    explicit ShareStateItem(ShareState* state);

    ShareState* object() const { return state_; }
    const void* key() const { return share_; }
    Cell cell(int column) const override;

private:
    /// False for what was sold whole; such a holding stays in the portfolio.
    bool isHeld() const { return state_->getQuantity() != 0; }
    Cell quoteDay() const;
    Cell gain() const;

    ShareState* state_;
    const Share* share_;

    // What the state's quote rests on, from when the row was made.
    bool hasQuote_ = false;
    bool hasRate_ = false;
    bool isEstimate_ = false; // outside the series, where the quote is on a straight line
    Date quoteDay_;           // of the quote that counts
};

/// The holdings of the portfolio.
class ShareStateListView final : public ObjectListView<ShareState, ShareStateItem> {
public:
    explicit ShareStateListView(const char* name);
};
