#pragma once

#include "foundation/OneToManyAssociation.h"

class Share;
class ShareState;

/// The states computed for a holding. They live a floor higher: the members are defined beside `ShareState`.
class ShareToShareStates final : public OneToManyAssociation<ShareToShareStates, Share, ShareState> {
public:
    using OneToManyAssociation::OneToManyAssociation;
    /// Destroys every state.
    void deleteAll();
    static auto& link(auto& state) { return state.share_; }
};

/// The state's link to its holding.
class ShareStatesToShare final : public ManyToOneAssociation<ShareStatesToShare, ShareState, Share> {
public:
    static auto& list(auto& share) { return share.states_; }
};
