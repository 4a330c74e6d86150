#pragma once

#include "foundation/OneToManyAssociation.h"

class State;
class ShareState;

/// The holdings in a state, in the wallet's order.
class StateToShareStates final : public OneToManyAssociation<State, ShareState> {
public:
    explicit StateToShareStates(State* owner) : OneToManyAssociation(owner) {}

private:
    ManyToOneAssociation<ShareState, State>& backLink(ShareState& e) const override;
};

/// The holding state's link to the state it is part of.
class ShareStatesToState final : public ManyToOneAssociation<ShareState, State> {
public:
    using ManyToOneAssociation::ManyToOneAssociation;

private:
    int xAdd(State* partner) override;
    int xRemove(State* partner) override;
};
