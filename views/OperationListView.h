#pragma once

#include "portfolio/Operation.h"
#include "views/ObjectListView.h"

#include <optional>
#include <vector>

class Account;

/// A row for one operation.
class OperationItem final : public ColumnItem {
public:
    static const std::vector<ColumnOf<OperationItem>> kColumns;

    explicit OperationItem(Operation* operation) : operation_(operation), isAutomatic_(operation->isAutomatic()) {}

    Operation* object() const { return operation_; }
    /// Null for an automatic operation: the next valuation destroys it and may make another one in its place.
    const void* key() const { return isAutomatic_ ? nullptr : operation_; }
    bool isAutomatic() const { return isAutomatic_; }
    /// Leaves the row without operation, and blank until it is dropped.
    void release() { operation_ = nullptr; }
    /// How far the row stands out: 1 when it has just come, 0 when it looks as always.
    void setLight(float light) { light_ = light; }

    /// What the row shows the effect on: the account that the list is about, otherwise the operation's own; may be
    /// null.
    const Account* account() const;
    /// What the account has after the operation; nothing where the list is about no account.
    std::optional<double> balance() const { return balance_; }
    /// Has the row show the effect on `account`, which then has `balance`; null for the operation's own account.
    void showEffectOn(const Account* account, std::optional<double> balance);

    Cell cell(std::size_t column) const override { return operation_ ? kColumns[column].cell(*this) : Cell(); }
    void DrawItem(BView* owner, BRect frame, bool complete) override;

private:
    Operation* operation_;
    bool isAutomatic_; // known also when the operation is gone
    float light_ = 0;
    const Account* shown_ = nullptr;
    std::optional<double> balance_;
};

/// The operations of all accounts, automatic ones on a ground of their own.
///
/// Of one account it shows also the transfers that it has received from others, all by date, with the balance behind
/// each; two of a day in the order of the accounts.
class OperationListView final : public ObjectListView<Operation, OperationItem> {
public:
    using ObjectListView::ObjectListView;

    /// Null shows the operations of all accounts.
    void setAccount(const Account* account);
    /// Nothing shows those of all years.
    void setYear(std::optional<int> year);
    /// The years that there are operations of, the latest first.
    std::vector<int> years() const;

protected:
    bool isArranged() const override;
    void choose(std::vector<ColumnItem*>& rows) override;

private:
    void chooseOfAccount(std::vector<ColumnItem*>& rows);

    const Account* account_ = nullptr; // looked into only while the list is filled
    std::optional<int> year_;
};
