#pragma once

#include "foundation/OneToManyAssociation.h"

class Account;
class AccountState;

/// The states computed for an account. They live a floor higher: the members are defined beside `AccountState`.
class AccountToAccountStates final : public OneToManyAssociation<Account, AccountState> {
public:
    explicit AccountToAccountStates(Account* owner) : OneToManyAssociation(owner) {}

    /// Destroys every state.
    void deleteAll();

private:
    ManyToOneAssociation<AccountState, Account>& backLink(AccountState& e) const override;
};

/// The state's link to its account.
class AccountStatesToAccount final : public ManyToOneAssociation<AccountState, Account> {
public:
    using ManyToOneAssociation::ManyToOneAssociation;

private:
    int xAdd(Account* partner) override;
    int xRemove(Account* partner) override;
};
