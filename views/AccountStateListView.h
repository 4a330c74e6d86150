#pragma once

#include "valuation/AccountState.h"
#include "views/ObjectListView.h"

/// An account with its balance.
class AccountStateItem final : public ColumnItem {
public:
    explicit AccountStateItem(AccountState* state);

    AccountState* object() const { return state_; }
    const void* key() const { return account_; }
    Cell cell(int column) const override;

private:
    AccountState* state_;
    const Account* account_;
};

/// The accounts of the portfolio.
class AccountStateListView final : public ObjectListView<AccountState, AccountStateItem> {
public:
    explicit AccountStateListView(const char* name);
};
