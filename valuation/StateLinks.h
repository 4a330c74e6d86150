#pragma once

#include "foundation/OneToManyAssociation.h"

// The relations of a state: both ends of each.

class AccountState;
class ShareState;
class State;

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

/// The holdings in a state, in the wallet's order.
class StateToShareStates final : public OneToManyAssociation<StateToShareStates, State, ShareState> {
public:
    using OneToManyAssociation::OneToManyAssociation;
    static auto& link(auto& shareState) { return shareState.state_; }
};

/// The holding state's link to the state it is part of.
class ShareStatesToState final : public ManyToOneAssociation<ShareStatesToState, ShareState, State> {
public:
    static auto& list(auto& state) { return state.shareStates_; }
};
