#pragma once

#include "foundation/OneToManyAssociation.h"

class Share;
class ShareOperation;

/// The buys and sells of a holding, by date.
class ShareToShareOperations final : public OneToManyAssociation<Share, ShareOperation> {
public:
    explicit ShareToShareOperations(Share* owner);

private:
    ManyToOneAssociation<ShareOperation, Share>& backLink(ShareOperation& e) const override;
};

/// The operation's link to its holding.
class ShareOperationsToShare final : public ManyToOneAssociation<ShareOperation, Share> {
public:
    using ManyToOneAssociation::ManyToOneAssociation;

private:
    int xAdd(Share* partner) override;
    int xRemove(Share* partner) override;
};
