#pragma once

#include "foundation/OneToManyAssociation.h"

class State;
class ShareState;

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
