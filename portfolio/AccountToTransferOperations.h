#pragma once

#include "foundation/OneToManyAssociation.h"

class Account;
class TransferAccountOperation;

/// The transfers that an account receives, by date.
class AccountToTransferOperations final : public OneToManyAssociation<Account, TransferAccountOperation> {
public:
    explicit AccountToTransferOperations(Account* owner);

private:
    ManyToOneAssociation<TransferAccountOperation, Account>& backLink(TransferAccountOperation& e) const override;
};

/// The transfer's link to the account that receives it.
class TransferOperationsToAccount final : public ManyToOneAssociation<TransferAccountOperation, Account> {
public:
    using ManyToOneAssociation::ManyToOneAssociation;

private:
    int xAdd(Account* partner) override;
    int xRemove(Account* partner) override;
};
