#pragma once

#include "foundation/Date.h"
#include "foundation/Serializable.h"
#include "portfolio/PortfolioLinks.h"

/// A dated event on a cash account: a deposit, a transfer, a purchase or a sale.
///
/// It is listed by the account, which owns it. Destroying an operation takes it out of every list it is in.
class Operation : public Serializable {
public:
    /// The codes that `getType` gives; the file has a letter for each.
    static constexpr short kDeposit = 1;
    static constexpr short kTransfer = 2;
    static constexpr short kBuy = 3;
    static constexpr short kSell = 4;

    virtual ~Operation();

    virtual short getType() const = 0;

    const Date& getDate() const { return date_; }
    /// The lists that hold the operation put it in its new place.
    void setDate(const Date& date);

    /// True for what a valuation has generated; the file does not record it.
    bool isAutomatic() const { return automatic_; }
    void setAutomatic(bool automatic) { automatic_ = automatic; }

    /// @return 0; -1 and a null `*out` without an account, as automatic sales are.
    int getAccount(Account** out) const { return account_.get(out); }
    /// The same; null when there is none.
    Account* account() const { return account_.partner(); }
    int setAccount(Account* account);

    /// The account's currency symbol; a String without text when account or currency is missing.
    const String& getCurrencyRepresentation() const;
    /// The first account of that name in the account's wallet, null when there is none.
    Account* getAccountByName(const String& name) const;

protected:
    Operation() = default;
    Operation(const Date& date, bool automatic) : date_(date), automatic_(automatic) {}

    /// Tells every list that holds the operation that its date has changed.
    virtual void notifyChange();

private:
    friend class AccountToOperations;

    Date date_;
    bool automatic_ = false;
    OperationsToAccount account_;
};

/// Orders two places of an array of operation pointers by date, ascending, for `qsort`.
int sortOperationByDate(const void* a, const void* b);
