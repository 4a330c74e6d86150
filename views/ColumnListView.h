#pragma once

#include "platform/GraphicsDefs.h"
#include "platform/ListItem.h"
#include "platform/ListView.h"

#include <string>
#include <vector>

/// One field of a row.
struct Cell {
    std::string text;
    /// Black, unless the row is selected: then it is what can be read on the selection.
    rgb_color color = {0, 0, 0, 255};
};

/// The width of a column that takes what the others of its list leave.
constexpr float kRemainingWidth = 0;

/// A column of a list: its heading, its width in pixels, and the side that its cells stand on.
struct ListColumn {
    const char* title;
    float width;
    alignment align = B_ALIGN_LEFT;

    /// The room for a text.
    float textWidth() const;
    /// Draws a text that fits on the column's side. `left` is where the column begins, `base` the text's base line.
    void drawText(BView& view, const std::string& text, float left, float base) const;
};

/// A column with what stands in it in the row of a `Shown`.
template <class Shown>
struct ColumnOf : ListColumn {
    Cell (*cell)(const Shown& shown);
};

/// The base line of a text, in the view's font, in the middle of `line`.
float baseLine(const BView& view, BRect line);

/// A row of a `ColumnListView`, which draws a cell into each of its columns. The cells are asked for when they show.
class ColumnItem : public BListItem {
public:
    virtual Cell cell(std::size_t column) const = 0;

    void DrawItem(BView* owner, BRect frame, bool complete) override;
    /// The cells with tabs between.
    std::string Text() const override;

private:
    friend class ColumnListView;
    std::size_t columns_ = 0; // of the list
};

/// A list of rows with fields in columns. Owns its rows.
class ColumnListView : public BListView {
public:
    /// Has no place before `addTo`.
    ColumnListView(const char* name, list_view_type type, std::vector<ListColumn> columns);
    ~ColumnListView() override { destroyRows(); }

    /// Puts the list and its heading into `parent`, in `area`. What assistive tools call it is `title`.
    void addTo(BView* parent, BRect area, const char* title);

protected:
    void addRow(ColumnItem* row, int32 index);
    void addRows(const std::vector<ColumnItem*>& rows);
    /// Destroys the row. The list does not know it any more when it dies.
    void destroyRow(int32 index) { delete RemoveItem(index); }
    void destroyRows();

private:
    friend class ColumnItem;
    std::vector<ListColumn> columns_;
};
