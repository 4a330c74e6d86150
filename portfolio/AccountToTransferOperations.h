#pragma once

#include "foundation/OneToManyAssociation.h"

class Account;
class TransferAccountOperation;

int sortOperationByDate(const void* a, const void* b);

/// The transfers that an account receives, by date.
class AccountToTransferOperations final
    : public OneToManyAssociation<AccountToTransferOperations, Account, TransferAccountOperation, true> {
public:
    using OneToManyAssociation::OneToManyAssociation;
    static auto& link(auto& transfer) { return transfer.recipient_; }
    static int compare(const void* a, const void* b) { return sortOperationByDate(a, b); }
};

/// The transfer's link to the account that receives it.
class TransferOperationsToAccount final
    : public ManyToOneAssociation<TransferOperationsToAccount, TransferAccountOperation, Account, true> {
public:
    static auto& list(auto& account) { return account.transfers_; }
};
