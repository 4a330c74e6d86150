#pragma once

#include "platform/GraphicsDefs.h"
#include "platform/ListItem.h"

#include <string>

/// One field of a row.
struct Cell {
    std::string text;
    /// Black, unless the row is selected: then it is what can be read on the selection.
    rgb_color color = {0, 0, 0, 255};
};

/// A row of a `ColumnListView`, which draws a cell into each of its columns. The cells are asked for when they show.
class ColumnItem : public BListItem {
public:
    virtual Cell cell(int column) const = 0;

    void DrawItem(BView* owner, BRect frame, bool complete) override;
    /// The cells with tabs between.
    std::string Text() const override;

private:
    friend class ColumnListView;
    int columns_ = 0; // of the list
};
