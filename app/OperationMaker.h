#pragma once

#include "foundation/Date.h"
#include "foundation/String.h"
#include "portfolio/TransferAccountOperation.h"

#include <cstddef>
#include <memory>

class Account;
class Company;
class OperationView;
class PLWindow;
class ShareOperation;
class Wallet;

/// Makes operations of what the operation page says. It keeps nothing: the operations are the accounts'.
class OperationMaker {
public:
    /// Both outlive this.
    OperationMaker(PLWindow& window, const OperationView& page) : window_(window), page_(page) {}

    /// A new operation, linked to its account and to its holding; null, after a message or in silence, when the page
    /// says none.
    Operation* make() const;
    /// What the fields say, of that day, on no account and of no holding yet.
    std::unique_ptr<Operation> draft(const Date& date) const;
    /// The company that the fields name; null when there is none. For an income, a market that is left out is found
    /// when only one lists the ticker.
    Company* company() const;

private:
    Wallet& wallet() const;
    bool isMove() const;
    Operation* link(std::unique_ptr<Operation> draft, Account* account) const;
    Operation* linkTransfer(std::unique_ptr<Operation> draft, Account* from) const;
    Operation* linkMove(std::unique_ptr<Operation> draft, Account* account) const;
    Operation* linkTrade(std::unique_ptr<Operation> draft, Account* account) const;
    /// What they end with when they make none: tells the reason in the status line, or in a notice.
    std::nullptr_t refuse(const char* reason) const;
    std::nullptr_t explain(const char* reason) const;

    PLWindow& window_;
    const OperationView& page_;
};
