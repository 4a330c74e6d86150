#pragma once

#include "foundation/OneToManyAssociation.h"

class Wallet;
class Account;

/// A wallet's cash accounts.
class WalletToAccounts final : public OneToManyAssociation<Wallet, Account> {
public:
    explicit WalletToAccounts(Wallet* owner) : OneToManyAssociation(owner) {}

private:
    ManyToOneAssociation<Account, Wallet>& backLink(Account& e) const override;
};

/// The account's link to its wallet.
class AccountsToWallet final : public ManyToOneAssociation<Account, Wallet> {
public:
    using ManyToOneAssociation::ManyToOneAssociation;

private:
    int xAdd(Wallet* partner) override;
    int xRemove(Wallet* partner) override;
};
