#pragma once

#include "foundation/OneToManyAssociation.h"

class Share;
class ShareOperation;

int sortOperationByDate(const void* a, const void* b);

/// The buys and sells of a holding, by date.
class ShareToShareOperations final : public OneToManyAssociation<ShareToShareOperations, Share, ShareOperation, true> {
public:
    using OneToManyAssociation::OneToManyAssociation;
    static auto& link(auto& operation) { return operation.share_; }
    static int compare(const void* a, const void* b) { return sortOperationByDate(a, b); }
};

/// The operation's link to its holding.
class ShareOperationsToShare final : public ManyToOneAssociation<ShareOperationsToShare, ShareOperation, Share, true> {
public:
    static auto& list(auto& share) { return share.operations_; }
};
