#pragma once

#include "views/ColumnListView.h"

#include <vector>

class SplitPlan;

/// A row with texts of its own: what it tells of need not live any more.
class PlainRow final : public ColumnItem {
public:
    explicit PlainRow(std::vector<Cell> cells, bool isMadeUp = false) : cells_(std::move(cells)), isMadeUp_(isMadeUp) {}

    Cell cell(std::size_t column) const override { return cells_[column]; }
    /// What the program has made up has a ground of its own.
    void DrawItem(BView* owner, BRect frame, bool complete) override;

private:
    std::vector<Cell> cells_;
    bool isMadeUp_;
};

/// A list that shows the texts of a plan of a split, and forgets the plan.
class PlainListView : public ColumnListView {
public:
    using ColumnListView::ColumnListView;

protected:
    void showRows(const std::vector<ColumnItem*>& rows)
    {
        destroyRows();
        addRows(rows);
    }
};

/// The purchases and sales before a split and what becomes of each, and the sales that settle fractions.
class SplitTradeListView final : public PlainListView {
public:
    explicit SplitTradeListView(const char* name);
    void show(const SplitPlan& plan);
};

/// The holdings of the company with their value in old and in new shares.
class SplitHoldingListView final : public PlainListView {
public:
    explicit SplitHoldingListView(const char* name);
    void show(const SplitPlan& plan);
};

/// A price in as many decimals as it needs, up to four where it is not small.
std::string priceText(float price);
/// "1/2" for 2 / 4.
std::string fractionText(int numerator, int denominator);
