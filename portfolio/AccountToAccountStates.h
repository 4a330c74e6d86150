#pragma once

#include "foundation/OneToManyAssociation.h"

class Account;
class AccountState;

/// The states computed for an account. They live a floor higher: the members are defined beside `AccountState`.
class AccountToAccountStates final : public OneToManyAssociation<AccountToAccountStates, Account, AccountState> {
public:
    using OneToManyAssociation::OneToManyAssociation;
    /// Destroys every state.
    void deleteAll();
    static auto& link(auto& state) { return state.account_; }
};

/// The state's link to its account.
class AccountStatesToAccount final : public ManyToOneAssociation<AccountStatesToAccount, AccountState, Account> {
public:
    static auto& list(auto& account) { return account.states_; }
};
