#pragma once

#include "foundation/Serializable.h"
#include "foundation/String.h"
#include "market/Currency.h"
#include "portfolio/PortfolioLinks.h"
#include "portfolio/TransferAccountOperation.h"

#include <cstdint>
#include <vector>

/// A cash account in one currency. Its balance at a day is computed by an `AccountState`.
///
/// Owns its operations and its states; destroying it also destroys the transfers it receives, wherever they came from.
class Account final : public Serializable {
public:
    Account();
    explicit Account(const String& name);
    virtual ~Account();

    /// File: name, flag for the default transfer account, number of operations, then a type letter for each with its
    /// body; a transfer's body stands in the transfer block instead. The currency's name is written by the wallet.
    int wrt(FILE* file) const override;
    /// @return 0; -1 when the file ends inside the record or a holding is unknown: the operations before it stay.
    int rd(FILE* file) override;
    /// The transfer block: number of transfers sent, then their bodies in the order of their letters.
    int writeTransferOperations(FILE* file) const;
    /// @param hasLostRecipient becomes true at a transfer, one of those that the account has letters for, whose
    /// recipient is unknown; may be null.
    /// @return 0; -1 at a transfer whose recipient is unknown, which stays as a new one without recipient, and when
    /// the file ends inside the block. All accounts of the wallet have been read before.
    int readTransferOperations(FILE* file, bool* hasLostRecipient = nullptr);

    const String& getName() const { return name_; }
    void setName(const String& name) { name_ = name; }
    /// True when the profits of automatic sales in this account's currency are transferred here.
    bool isDefaultTransferAccount() const { return defaultTransfer_; }
    void setDefaultTransferAccount(bool isDefault) { defaultTransfer_ = isDefault; }

    int getWallet(Wallet** out) const { return wallet_.get(out); }
    /// The same; null when there is none.
    Wallet* wallet() const { return wallet_.partner(); }
    int setWallet(Wallet* wallet);
    int getCurrency(Currency** out) const { return currency_.get(out); }
    /// The same; null when there is none.
    Currency* currency() const { return currency_.partner(); }
    int setCurrency(Currency* currency) { return currency_.set(this, currency); }
    /// Of its currency; Strings without text when it has none.
    const String& getCurrencyName() const { return currency() != nullptr ? currency()->getName() : String::none(); }
    const String& getCurrencyRepresentation() const
    {
        return currency() != nullptr ? currency()->getRepresentation() : String::none();
    }

    int addOperation(Operation* operation) { return operations_.add(operation); }
    int removeOperation(Operation* operation) { return operations_.remove(operation); }
    unsigned getNbrOperations() const { return operations_.getNbr(); }
    Operation** getAllOperations(unsigned* n) const { return operations_.getAll(n); }
    std::span<Operation* const> operations() const { return operations_.all(); }
    Operation* getOperation(unsigned i) const { return operations_.at(i); }
    /// To be called when the date of one of the operations has changed.
    void operationChanged() { operations_.changeNotice(); }

    int addTransferOperation(TransferAccountOperation* transfer) { return transfers_.add(transfer); }
    int removeTransferOperation(TransferAccountOperation* transfer) { return transfers_.remove(transfer); }
    unsigned getNbrTransferOperations() const { return transfers_.getNbr(); }
    TransferAccountOperation** getAllTransferOperations(unsigned* n) const { return transfers_.getAll(n); }
    std::span<TransferAccountOperation* const> transferOperations() const { return transfers_.all(); }
    TransferAccountOperation* getTransferOperation(unsigned i) const { return transfers_.at(i); }
    /// To be called when the date of one of the received transfers has changed.
    void transferOperationChanged() { transfers_.changeNotice(); }

    int addAccountState(AccountState* state);
    int removeAccountState(AccountState* state);
    unsigned getNbrAccountStates() const { return states_.getNbr(); }
    AccountState** getAllAccountStates(unsigned* n) const { return states_.getAll(n); }
    std::span<AccountState* const> accountStates() const { return states_.all(); }
    AccountState* getAccountState(unsigned i) const { return states_.at(i); }

    /// The wallet's holding of that market name and ticker. @return 0; -1 and a null `*out` when there is none.
    int getShare(const String& market, const String& abbreviation, Share** out) const;
    /// The first account of that name in the wallet, null when there is none.
    Account* getAccountByName(const String& name) const;

private:
    friend struct AccountStatesToAccount;
    friend struct OperationsToAccount;
    friend struct TransferOperationsToAccount;
    friend class CurrencyToAccounts;
    friend class WalletToAccounts;

    int readOperation(FILE* file);

    String name_;
    bool defaultTransfer_ = false;
    AccountsToWallet wallet_;
    AccountsToCurrency currency_;
    AccountToOperations operations_;
    AccountToTransferOperations transfers_;
    AccountToAccountStates states_;
    std::vector<std::uint32_t> transferTurns_; // between the two halves of reading: the turns of the letters "T"
};
