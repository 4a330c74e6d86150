#pragma once

#include "platform/View.h"
#include "views/ColumnListView.h"

#include <vector>

/// The titles above the columns of a list.
class ColumnHeading final : public BView {
public:
    ColumnHeading(BRect frame, std::vector<ListColumn> columns);

    void Draw(BRect updateRect) override;

private:
    std::vector<ListColumn> columns_;
};
