#pragma once

#include "foundation/PackedDate.h"
#include "portfolio/Wallet.h"
#include "valuation/AccountState.h"
#include "valuation/ShareState.h"

class Account;

/// The portfolio as it stands at a day: the cash of every account and every holding, by replay of the operations up to
/// and including that day. Listed by the wallet, which owns it; never written to a file.
///
/// Owns its account states and share states.
class State final {
public:
    /// Builds the whole state. `automatic` also searches the automatic sales. Any automatic operation that accounts of
    /// the wallet still list is destroyed first. Without a wallet or with an undefined date the state stays empty.
    State(Wallet* wallet, const Date& date, bool automatic);
    ~State();
    State(const State&) = delete;
    State& operator=(const State&) = delete;

    int getWallet(Wallet** out) const { return wallet_.get(out); }
    /// The same; null when there is none.
    Wallet* wallet() const { return wallet_.partner(); }
    int setWallet(Wallet* wallet) { return wallet_.set(this, wallet); }

    Date getDate() const { return date_.date(); }
    /// Sum of the deposits, each in the reference currency of its own day.
    float getTotalDeposit() const { return totalDeposit_; }
    void setTotalDeposit(float total) { totalDeposit_ = total; }
    /// Day of the earliest operation, also when it lies after the state's day; `afterAllOperations` without any.
    Date getFirstOperationDate() const { return firstOperationDate_.date(); }
    void setFirstOperationDate(const Date& date) { firstOperationDate_ = date; }
    /// Takes `date` when it is earlier than the first operation date known so far.
    void noteOperationDate(const Date& date);
    bool isAutomatic() const { return automatic_; }
    void setAutomatic(bool automatic) { automatic_ = automatic; }

    /// 31 December 32767, later than any real operation.
    static Date afterAllOperations() { return {31, 12, 32767}; }

    /// Take `amount` from, or give it to, the cash of `account`; nothing happens when the state has no such account.
    void BuyShares(Account* account, float amount);
    void SellShares(Account* account, float amount);

    int addAccountState(AccountState* state) { return accountStates_.add(state); }
    int removeAccountState(AccountState* state) { return accountStates_.remove(state); }
    unsigned getNbrAccountStates() const { return accountStates_.getNbr(); }
    AccountState** getAllAccountStates(unsigned* n) const { return accountStates_.getAll(n); }
    std::span<AccountState* const> accountStates() const { return accountStates_.all(); }
    AccountState* getAccountState(unsigned i) const { return accountStates_.at(i); }

    int addShareState(ShareState* state) { return shareStates_.add(state); }
    int removeShareState(ShareState* state) { return shareStates_.remove(state); }
    unsigned getNbrShareStates() const { return shareStates_.getNbr(); }
    ShareState** getAllShareStates(unsigned* n) const { return shareStates_.getAll(n); }
    std::span<ShareState* const> shareStates() const { return shareStates_.all(); }
    ShareState* getShareState(unsigned i) const { return shareStates_.at(i); }

private:
    friend class AccountStatesToState;
    friend class ShareStatesToState;
    friend class WalletToStates;
    friend class DailyStates;

    /// An empty state of the wallet, to be filled by the evolution.
    State(Wallet* wallet, const Date& date);

    AccountState* findAccountState(Account* account) const;

    StatesToWallet wallet_;
    StateToShareStates shareStates_;
    StateToAccountStates accountStates_;
    float totalDeposit_ = 0;
    PackedDate date_;
    PackedDate firstOperationDate_;
    bool automatic_ = false;
};
