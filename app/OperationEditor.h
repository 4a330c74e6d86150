#pragma once

#include "app/DividendNotes.h"
#include "app/OperationMaker.h"
#include "app/OperationOffers.h"

#include <string>

class AccountOperation;
class CompanyView;

/// The commands on operations: booking what the operation page says, in place of the selected one or beside it, and
/// putting the selected one into its fields. What is made is made by the `OperationMaker`, what is offered while a
/// person types by the `OperationOffers`.
///
/// It keeps no operation: these are in the window's wallet, and their rows on the page. A row goes before its operation
/// does.
class OperationEditor {
public:
    /// All outlive this.
    OperationEditor(PLWindow& window, OperationView& page, CompanyView& companies);
    ~OperationEditor();
    OperationEditor(const OperationEditor&) = delete;
    OperationEditor& operator=(const OperationEditor&) = delete;

    void updateTotal();
    void add();
    /// Makes a new operation of the fields, in place of the selected one; just makes it when none is selected.
    void update();
    void remove();
    void showSelected();
    /// "DEPOSIT", "TRANSFER", "BUY", "SELL", "INCOME" or "CHARGE".
    void changeType(const String& type);
    /// Brings what is offered on the page up to date with its fields, the quotes and the parameters; to be called when
    /// one of these has changed, or a company was chosen, by other means than typing.
    void renewOffers() { offers_.renew(); }

private:
    /// `former`, which the new operation replaces, may be null.
    void book(Operation* former);
    /// Values the portfolio with the operation just made, which replaces `former` unless that is null, and shows it.
    void showMade(Operation* made, Operation* former);
    void destroy(Operation* operation);
    /// Says for some seconds what was done: the status line says nothing of a success.
    void tell(const std::string& deed);
    Operation* selected() const;
    void showCash(const AccountOperation& operation);
    void showPayer(const Operation& income);
    void showTrade(const ShareOperation& trade);
    void showCommonFields(const Operation& operation);

    PLWindow& window_;
    OperationView& page_;
    OperationMaker maker_;
    OperationOffers offers_;
    DividendNotes notes_;
    std::string payer_; // whose note the income has that was shown or made last; empty without one
};
