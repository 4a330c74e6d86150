#pragma once

#include "foundation/OneToManyAssociation.h"

// The relations of a portfolio: both ends of each.

class Account;
class AccountState;
class Operation;
class Share;
class ShareOperation;
class ShareState;
class State;
class TransferAccountOperation;
class Wallet;

int sortOperationByDate(const void* a, const void* b);

/// A wallet's cash accounts.
class WalletToAccounts final : public OneToManyAssociation<WalletToAccounts, Wallet, Account> {
public:
    using OneToManyAssociation::OneToManyAssociation;
    static auto& link(auto& account) { return account.wallet_; }
};

/// The account's link to its wallet.
struct AccountsToWallet final : ManyToOneAssociation<AccountsToWallet, Account, Wallet> {
    static auto& list(auto& wallet) { return wallet.accounts_; }
};

/// A wallet's holdings.
class WalletToShares final : public OneToManyAssociation<WalletToShares, Wallet, Share> {
public:
    using OneToManyAssociation::OneToManyAssociation;
    static auto& link(auto& share) { return share.wallet_; }
};

/// The holding's link to its wallet.
struct SharesToWallet final : ManyToOneAssociation<SharesToWallet, Share, Wallet> {
    static auto& list(auto& wallet) { return wallet.shares_; }
};

/// The states computed for a wallet. States live a floor higher: the members are defined beside `State`.
class WalletToStates final : public OneToManyAssociation<WalletToStates, Wallet, State> {
public:
    using OneToManyAssociation::OneToManyAssociation;
    static auto& link(auto& state) { return state.wallet_; }
};

/// The state's link to its wallet.
struct StatesToWallet final : ManyToOneAssociation<StatesToWallet, State, Wallet> {
    static auto& list(auto& wallet) { return wallet.states_; }
};

/// Every operation on an account, by date.
class AccountToOperations final : public OneToManyAssociation<AccountToOperations, Account, Operation, true> {
public:
    using OneToManyAssociation::OneToManyAssociation;
    static auto& link(auto& operation) { return operation.account_; }
    static int compare(const void* a, const void* b) { return sortOperationByDate(a, b); }
};

/// The operation's link to its account.
struct OperationsToAccount final : ManyToOneAssociation<OperationsToAccount, Operation, Account, true> {
    static auto& list(auto& account) { return account.operations_; }
};

/// The transfers that an account receives, by date.
class AccountToTransferOperations final
    : public OneToManyAssociation<AccountToTransferOperations, Account, TransferAccountOperation, true> {
public:
    using OneToManyAssociation::OneToManyAssociation;
    static auto& link(auto& transfer) { return transfer.recipient_; }
    static int compare(const void* a, const void* b) { return sortOperationByDate(a, b); }
};

/// The transfer's link to the account that receives it.
struct TransferOperationsToAccount final
    : ManyToOneAssociation<TransferOperationsToAccount, TransferAccountOperation, Account, true> {
    static auto& list(auto& account) { return account.transfers_; }
};

/// The states computed for an account. They live a floor higher: the members are defined beside `AccountState`.
class AccountToAccountStates final : public OneToManyAssociation<AccountToAccountStates, Account, AccountState> {
public:
    using OneToManyAssociation::OneToManyAssociation;
    /// Destroys every state.
    void deleteAll();
    static auto& link(auto& state) { return state.account_; }
};

/// The state's link to its account.
struct AccountStatesToAccount final : ManyToOneAssociation<AccountStatesToAccount, AccountState, Account> {
    static auto& list(auto& account) { return account.states_; }
};

/// The buys and sells of a holding, by date.
class ShareToShareOperations final : public OneToManyAssociation<ShareToShareOperations, Share, ShareOperation, true> {
public:
    using OneToManyAssociation::OneToManyAssociation;
    static auto& link(auto& operation) { return operation.share_; }
    static int compare(const void* a, const void* b) { return sortOperationByDate(a, b); }
};

/// The operation's link to its holding.
struct ShareOperationsToShare final : ManyToOneAssociation<ShareOperationsToShare, ShareOperation, Share, true> {
    static auto& list(auto& share) { return share.operations_; }
};

/// The states computed for a holding. They live a floor higher: the members are defined beside `ShareState`.
class ShareToShareStates final : public OneToManyAssociation<ShareToShareStates, Share, ShareState> {
public:
    using OneToManyAssociation::OneToManyAssociation;
    /// Destroys every state.
    void deleteAll();
    static auto& link(auto& state) { return state.share_; }
};

/// The state's link to its holding.
struct ShareStatesToShare final : ManyToOneAssociation<ShareStatesToShare, ShareState, Share> {
    static auto& list(auto& share) { return share.states_; }
};
