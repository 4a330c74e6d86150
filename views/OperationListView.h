#pragma once

#include "portfolio/Operation.h"
#include "views/ObjectListView.h"

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

    Cell cell(std::size_t column) const override { return operation_ ? kColumns[column].cell(*this) : Cell(); }
    void DrawItem(BView* owner, BRect frame, bool complete) override;

private:
    Operation* operation_;
    bool isAutomatic_; // known also when the operation is gone
    float light_ = 0;
};

/// The operations of all accounts, automatic ones on a ground of their own.
using OperationListView = ObjectListView<Operation, OperationItem>;
