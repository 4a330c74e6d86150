#pragma once

#include "foundation/OneToManyAssociation.h"

class State;
class AccountState;

/// The cash of each account in a state, in the wallet's order.
class StateToAccountStates final : public OneToManyAssociation<StateToAccountStates, State, AccountState> {
public:
    using OneToManyAssociation::OneToManyAssociation;
    static auto& link(auto& accountState) { return accountState.state_; }
};

/// The account state's link to the state it is part of.
class AccountStatesToState final : public ManyToOneAssociation<AccountStatesToState, AccountState, State> {
public:
    static auto& list(auto& state) { return state.accountStates_; }
};
