#pragma once

#include "exchange/OperationReader.h"

#include <string>
#include <vector>

class Wallet;

/// What a statement would change in a portfolio: the operations that are new, those that it has already, and the lines
/// that are refused. Made first, to be looked at, then carried out by `book`.
///
/// Until then nothing is changed, and accounts and companies must stay as they were.
class OperationPlan {
public:
    /// An account to be made, by its name and the symbol of its currency.
    struct NewAccount {
        std::string name;
        std::string symbol;
    };
    struct Refusal {
        unsigned long line;
        std::string reason; // in words that go on from "line 7: "
        std::optional<UntoldRow::About> untold;
    };

    /// An account to be made that is there already, in the same currency, is no new one. Throws std::runtime_error,
    /// with one line for the user, when it is in another one, or there is no such currency.
    OperationPlan(const StatementTable& table, const StatementProfile& profile,
                  const std::vector<NewAccount>& newAccounts, const Wallet& wallet, const Catalogue& catalogue);
    OperationPlan(const OperationPlan&) = delete; // the operations refer to the accounts in here
    OperationPlan& operator=(const OperationPlan&) = delete;

    // Each in the order of the table:

    const std::vector<PlannedOperation>& operations() const { return operations_; }
    /// What the portfolio has already. Of equal lines as many as there are equal operations.
    const std::vector<PlannedOperation>& booked() const { return booked_; }
    const std::vector<Refusal>& refused() const { return refused_; }

    /// The accounts that are made, in the order in which they were asked for.
    const std::vector<const PlannedAccount*>& newAccounts() const { return newAccounts_; }
    bool isEmpty() const { return operations_.empty() && newAccounts_.empty(); }

    /// Makes the new accounts and operations, the oldest of a day first; the refused lines are left out. To be called
    /// once, with the wallet that the plan was made for.
    void book(Wallet& wallet);

private:
    void addNewAccount(const NewAccount& account, const Catalogue& catalogue);

    OperationReader::Accounts accounts_;
    std::vector<const PlannedAccount*> newAccounts_;
    std::vector<PlannedOperation> operations_;
    std::vector<PlannedOperation> booked_;
    std::vector<Refusal> refused_;
    bool isNewestFirst_;
};
