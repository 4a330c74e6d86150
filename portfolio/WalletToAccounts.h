#pragma once

#include "foundation/OneToManyAssociation.h"

class Wallet;
class Account;

/// A wallet's cash accounts.
class WalletToAccounts final : public OneToManyAssociation<WalletToAccounts, Wallet, Account> {
public:
    using OneToManyAssociation::OneToManyAssociation;
    static auto& link(auto& account) { return account.wallet_; }
};

/// The account's link to its wallet.
class AccountsToWallet final : public ManyToOneAssociation<AccountsToWallet, Account, Wallet> {
public:
    static auto& list(auto& wallet) { return wallet.accounts_; }
};
