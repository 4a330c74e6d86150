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
};

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
