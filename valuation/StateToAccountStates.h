#pragma once

#include "foundation/OneToManyAssociation.h"

class State;
class AccountState;

/// The cash of each account in a state, in the wallet's order.
class StateToAccountStates final : public OneToManyAssociation<State, AccountState> {
public:
    explicit StateToAccountStates(State* owner) : OneToManyAssociation(owner) {}

private:
    ManyToOneAssociation<AccountState, State>& backLink(AccountState& e) const override;
};

/// The account state's link to the state it is part of.
class AccountStatesToState final : public ManyToOneAssociation<AccountState, State> {
public:
    using ManyToOneAssociation::ManyToOneAssociation;

private:
    int xAdd(State* partner) override;
    int xRemove(State* partner) override;
};
