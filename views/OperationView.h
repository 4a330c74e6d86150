#pragma once

#include "views/PageView.h"

class Account;
class BCheckBox;
class Operation;
class OperationListView;
class ShareOperation;

/// The page of the operations on the portfolio's accounts.
class OperationView final : public PageView {
public:
    OperationView(BRect frame, const char* name, BWindow* window);

    /// Whether automatic sales are searched.
    bool isPrevision() const;

    /// Fills the account menus.
    void SetAccountsList(Account** accounts, int count);
    /// Empties the list, keeping in mind what was selected.
    void ClearAllOperations();
    /// Puts rows behind the others.
    void AddOperationList(Operation** operations, int count);
    /// To be called when the list is filled again: selects what was selected, where it still is.
    void RecallSelection();
    /// What was selected belongs to a portfolio that is gone.
    void ForgetSelection();

    /// Shows nothing of the operation any more, in constant time; its row goes with the next refresh.
    void RemoveShareOperation(ShareOperation* operation);
    /// Draws the operation's row again.
    void UpdateShareOperation(ShareOperation* operation);

private:
    BCheckBox* prevision_;
    OperationListView* operations_;
};
