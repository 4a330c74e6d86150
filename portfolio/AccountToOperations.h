#pragma once

#include "foundation/OneToManyAssociation.h"

class Account;
class Operation;

/// Every operation on an account, by date.
class AccountToOperations final : public OneToManyAssociation<Account, Operation> {
public:
    explicit AccountToOperations(Account* owner);

private:
    ManyToOneAssociation<Operation, Account>& backLink(Operation& e) const override;
};

/// The operation's link to its account.
class OperationsToAccount final : public ManyToOneAssociation<Operation, Account> {
public:
    using ManyToOneAssociation::ManyToOneAssociation;

private:
    int xAdd(Account* partner) override;
    int xRemove(Account* partner) override;
};
