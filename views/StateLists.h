#pragma once

#include "valuation/AccountState.h"
#include "valuation/ShareState.h"
#include "views/ObjectListView.h"

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

    explicit ShareStateItem(ShareState* state) : state_(state), share_(state->share()), basis_(state->quoteBasis()) {}

    ShareState* object() const { return state_; }
    const void* key() const { return share_; }
    /// The quote that the holding was valued by, from when the row was made.
    const QuoteBasis& basis() const { return basis_; }
    Cell cell(std::size_t column) const override { return kColumns[column].cell(*this); }

private:
    ShareState* state_;
    const Share* share_;
    QuoteBasis basis_;
};

/// The accounts of the portfolio.
using AccountStateListView = ObjectListView<AccountState, AccountStateItem>;

/// The holdings of the portfolio.
using ShareStateListView = ObjectListView<ShareState, ShareStateItem>;
