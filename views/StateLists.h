#pragma once

#include "valuation/AccountState.h"
#include "valuation/HoldingFigures.h"
#include "valuation/ShareState.h"
#include "views/ObjectListView.h"

#include <optional>
#include <string>
#include <vector>

class State;
struct Totals;

/// An account with its balance. Found again by the account, as the states of a valuation go with the next.
class AccountStateItem final : public ColumnItem {
public:
    static const std::vector<ColumnOf<AccountState>> kColumns;

    explicit AccountStateItem(AccountState* state) : state_(state), account_(state->account()) {}

    AccountState* object() const { return state_; }
    const void* key() const { return account_; }
    Cell cell(std::size_t column) const override { return kColumns[column].cell(*state_); }

private:
    AccountState* state_;
    const Account* account_;
};

/// A holding with what it is worth. The row keeps to its valuation: quotes and rates that come later show with the
/// next.
class ShareStateItem final : public ColumnItem {
public:
    static const std::vector<ColumnOf<ShareStateItem>> kColumns;
    static constexpr std::size_t kEndDate =
        10; ///< the column that shows while sales are simulated: only they look at it

    explicit ShareStateItem(ShareState* state) : state_(state), share_(state->share()), basis_(state->quoteBasis()) {}

    ShareState* object() const { return state_; }
    const void* key() const { return share_; }
    /// Has the row show what the holding is in the reference currency, which counts `rate` in it, and which part of
    /// `total`; 0 where there is none.
    void showIn(const std::string& symbol, double rate, double total);
    /// In the reference currency; nothing where it is not known.
    std::optional<double> value() const { return value_; }
    std::optional<double> part() const { return part_; }
    const std::string& reference() const { return reference_; }
    /// What the holding has come to; `showFigures` has the row show it.
    void showFigures(const HoldingFigures& figures) { figures_ = figures; }
    const HoldingFigures& figures() const { return figures_; }
    /// The quote that the holding was valued by, from when the row was made.
    const QuoteBasis& basis() const { return basis_; }
    Cell cell(std::size_t column) const override { return kColumns[column].cell(*this); }

private:
    ShareState* state_;
    const Share* share_;
    QuoteBasis basis_;
    std::optional<double> value_;
    std::optional<double> part_;
    HoldingFigures figures_;
    std::string reference_;
};

/// The accounts of the portfolio.
using AccountStateListView = ObjectListView<AccountState, AccountStateItem>;

/// The holdings of the portfolio.
class ShareStateListView final : public ObjectListView<ShareState, ShareStateItem> {
public:
    using ObjectListView::ObjectListView;

    /// Adds the holdings of `state`, of which these are the totals, and of each holding the figures.
    void addAllOf(const State& state, const Totals& totals, const std::vector<HoldingFigures>& figures);
};
