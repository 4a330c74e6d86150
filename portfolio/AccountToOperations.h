#pragma once

#include "foundation/OneToManyAssociation.h"

class Account;
class Operation;

int sortOperationByDate(const void* a, const void* b);

/// Every operation on an account, by date.
class AccountToOperations final : public OneToManyAssociation<AccountToOperations, Account, Operation, true> {
public:
    using OneToManyAssociation::OneToManyAssociation;
    static auto& link(auto& operation) { return operation.account_; }
    static int compare(const void* a, const void* b) { return sortOperationByDate(a, b); }
};

/// The operation's link to its account.
class OperationsToAccount final : public ManyToOneAssociation<OperationsToAccount, Operation, Account, true> {
public:
    static auto& list(auto& account) { return account.operations_; }
};
