#pragma once

#include "platform/ListView.h"

#include <string>
#include <vector>

class ColumnItem;

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

/// The base line of a text, in the view's font, in the middle of `line`.
float baseLine(const BView& view, BRect line);

/// A list of rows with fields in columns. Owns its rows.
class ColumnListView : public BListView {
public:
    /// `frame` is that of the rows; the heading stands in the pixels above, see `addTo`.
    ColumnListView(BRect frame, const char* name, list_view_type type, std::vector<ListColumn> columns);
    ~ColumnListView() override;

    int CountColumns() const { return static_cast<int>(columns_.size()); }
    const ListColumn& ColumnAt(int i) const { return columns_[static_cast<std::size_t>(i)]; }

    /// Puts the list and its heading into `parent`, in `area`, which takes the place of its frame. What assistive tools
    /// call it is `title`.
    void addTo(BView* parent, BRect area, const char* title);

protected:
    void addRow(ColumnItem* row, int32 index);
    void addRows(const std::vector<ColumnItem*>& rows);
    /// Destroys the row.
    void destroyRow(int32 index);
    void destroyRows();

private:
    std::vector<ListColumn> columns_;
};
