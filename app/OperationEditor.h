#pragma once

#include "foundation/Date.h"
#include "foundation/String.h"

#include <cstddef>

class Account;
class AccountOperation;
class Operation;
class OperationView;
class PLWindow;
class ShareOperation;
class Wallet;

/// The commands on operations: making what the operation page says, putting the selected one into its fields, and
/// offering values while a person types. The page puts an offer in only where nothing was typed.
///
/// It keeps nothing of its own: the operations are in the window's wallet, and their rows on the page. A row goes
/// before its operation does.
class OperationEditor {
public:
    /// Both outlive this.
    OperationEditor(PLWindow& window, OperationView& page);
    ~OperationEditor();
    OperationEditor(const OperationEditor&) = delete;
    OperationEditor& operator=(const OperationEditor&) = delete;

    void updateTotal();
    void add();
    /// Makes a new operation of the fields, in place of the selected one; just makes it when none is selected.
    void update();
    void remove();
    void showSelected();
    /// "DEPOSIT", "TRANSFER", "BUY" or "SELL".
    void changeType(const String& type);
    /// Brings what is offered on the page up to date with its fields, the quotes and the parameters.
    void renewOffers();

private:
    Wallet& wallet() const;
    // These make an operation as the page says; null, after a message or in silence, when it says none.
    Operation* make();
    Operation* makeTransfer(const Date& date, Account* from);
    Operation* makeTrade(const Date& date, Account* account, bool isBuy);
    /// What they end with when they make none: tells the reason.
    std::nullptr_t refuse(const char* reason) const;
    /// Values the portfolio with the operation just made, which replaces `former` unless that is null, and shows it.
    void showMade(Operation* made, Operation* former);
    void destroy(Operation* operation);
    Operation* selected() const;
    void showCash(const AccountOperation& operation);
    void showTrade(const ShareOperation& trade);
    void showCommonFields(const Operation& operation);
    void offerTransferQuotes(const Date& date);

    PLWindow& window_;
    OperationView& page_;
};
