#include "views/ColumnListView.h"

#include "views/ColumnHeading.h"
#include "views/ColumnItem.h"
#include "views/Look.h"

#include <utility>

ColumnListView::ColumnListView(BRect frame, const char* name, list_view_type type, std::vector<ListColumn> columns)
    : BListView(frame, name, type), columns_(std::move(columns))
{
    SetRowHeight(look::kListRow);
}

ColumnListView::~ColumnListView()
{
    destroyRows();
}

void ColumnListView::addTo(BView* parent, BRect area, const char* title)
{
    const float top = area.top + look::kHeadingHeight;
    parent->AddChild(new ColumnHeading({area.left, area.top, area.right, top}, columns_));
    MoveTo(area.left, top);
    ResizeTo(area.Width(), area.bottom - top);
    parent->AddChild(this);
    SetAccessibleName(title);
}

void ColumnListView::addRow(ColumnItem* row, int32 index)
{
    row->columns_ = CountColumns();
    AddItem(row, index);
}

void ColumnListView::addRows(const std::vector<ColumnItem*>& rows)
{
    for (ColumnItem* row : rows)
        row->columns_ = CountColumns();
    AddItems({rows.begin(), rows.end()});
}

void ColumnListView::destroyRow(int32 index)
{
    delete RemoveItem(index);
}

void ColumnListView::destroyRows()
{
    std::vector<BListItem*> rows;
    for (int32 i = 0; i < CountItems(); ++i)
        rows.push_back(ItemAt(i));
    MakeEmpty();
    for (BListItem* row : rows)
        delete row;
}
