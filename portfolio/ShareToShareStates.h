#pragma once

#include "foundation/OneToManyAssociation.h"

class Share;
class ShareState;

/// The states computed for a holding. They live a floor higher: the members are defined beside `ShareState`.
class ShareToShareStates final : public OneToManyAssociation<Share, ShareState> {
public:
    explicit ShareToShareStates(Share* owner) : OneToManyAssociation(owner) {}

    /// Destroys every state.
    void deleteAll();

private:
    ManyToOneAssociation<ShareState, Share>& backLink(ShareState& e) const override;
};

/// The state's link to its holding.
class ShareStatesToShare final : public ManyToOneAssociation<ShareState, Share> {
public:
    using ManyToOneAssociation::ManyToOneAssociation;

private:
    int xAdd(Share* partner) override;
    int xRemove(Share* partner) override;
};
