#pragma once

#include "views/PageView.h"

class Account;
class BCheckBox;
class Operation;

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

private:
    BCheckBox* prevision_;
};
