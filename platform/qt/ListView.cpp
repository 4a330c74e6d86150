#include "platform/ListView.h"

#include "platform/ListItem.h"
#include "platform/qt/Canvas.h"
#include "platform/qt/ListWidget.h"

#include <QApplication>
#include <QClipboard>
#include <QItemSelectionModel>
#include <QPainter>
#include <QScrollBar>

#include <algorithm>
#include <utility>

// What is selected is known in three places: the list widget knows it by row numbers, which it moves along when rows
// come and go; each item knows it of itself, so that taking a row out need not ask; and `selection_` holds the numbers,
// gathered when they are asked for. Between calls of the functions here all three agree, or `selectionStale_` is set.

BListView::BListView(BRect frame, const char* name, list_view_type type)
    : BView(frame, name, B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW | B_FRAME_EVENTS | B_NAVIGABLE,
            new ListWidget(*this))
{
    SetAccessibleName(name);
    listWidget().setSelectionMode(type == B_SINGLE_SELECTION_LIST ? QAbstractItemView::SingleSelection
                                                                  : QAbstractItemView::ExtendedSelection);
}

ListWidget& BListView::listWidget() const
{
    return *static_cast<ListWidget*>(widget());
}

bool BListView::AddItem(BListItem* item, int32 index)
{
    if (item == nullptr || index < 0 || index > CountItems())
        return false;
    // From begin to end the widget must not be asked for rows: it has been told of a change that `items_` does not show
    // yet.
    const auto silence = listWidget().silence();
    listWidget().rows().beginInsert(index, index);
    items_.insert(items_.begin() + index, item);
    firstUnnumbered_ = std::min(firstUnnumbered_, index);
    // The same rows are selected as before, but those below have other numbers.
    selectionStale_ = true;
    listWidget().rows().endInsert();
    return true;
}

void BListView::AddItems(const std::vector<BListItem*>& items)
{
    if (items.empty())
        return;
    const auto silence = listWidget().silence();
    const int first = CountItems();
    listWidget().rows().beginInsert(first, first + static_cast<int>(items.size()) - 1);
    items_.insert(items_.end(), items.begin(), items.end());
    firstUnnumbered_ = std::min(firstUnnumbered_, first);
    // Rows at the end move no others, so the selection is not stale.
    listWidget().rows().endInsert();
}

BListItem* BListView::RemoveItem(int32 index)
{
    BListItem* item = ItemAt(index);
    if (item == nullptr)
        return nullptr;
    const auto silence = listWidget().silence();
    // From here to the end of the removal rows and numbers differ, as in `AddItem`.
    listWidget().rows().beginRemove(index, index);
    items_.erase(items_.begin() + index);
    firstUnnumbered_ = std::min(firstUnnumbered_, index);
    selectionStale_ = true;
    listWidget().rows().endRemove();
    // Nothing in the item speaks of this list any more: it may be put into it again, or die.
    item->selected_ = false;
    item->index_ = -1;
    // Qt selects a neighbour in the place of the row that the keyboard was at; here nothing comes to be selected.
    for (const auto& row : listWidget().selectionModel()->selectedIndexes()) {
        if (!items_[static_cast<std::size_t>(row.row())]->selected_)
            listWidget().selectionModel()->select(row, QItemSelectionModel::Deselect);
    }
    return item;
}

void BListView::SetItems(std::vector<BListItem*> items)
{
    const auto silence = listWidget().silence();
    const BListItem* current = ItemAt(listWidget().currentIndex().row());
    // The reset takes the selection with it. Until it is made again, what each item says of itself is what counts.
    listWidget().rows().beginReset();
    for (BListItem* item : items_)
        item->index_ = -1;
    items_.swap(items);
    firstUnnumbered_ = 0;
    renumber();
    for (BListItem* former : items)
        former->selected_ = former->selected_ && former->index_ >= 0;
    listWidget().rows().endReset();
    // At once: each change of a selection takes as long as it has runs of rows.
    QItemSelection selected;
    for (int32 i = 0; i < CountItems(); ++i) {
        const int32 first = i;
        while (i < CountItems() && items_[static_cast<std::size_t>(i)]->selected_)
            ++i;
        if (i > first)
            selected.select(listWidget().rows().index(first), listWidget().rows().index(i - 1));
    }
    listWidget().selectionModel()->select(selected, QItemSelectionModel::ClearAndSelect);
    if (current != nullptr && current->index_ >= 0)
        listWidget().selectionModel()->setCurrentIndex(listWidget().rows().index(current->index_),
                                                       QItemSelectionModel::NoUpdate);
    selectionStale_ = true;
}

void BListView::MakeEmpty()
{
    const auto silence = listWidget().silence();
    // The reset takes the selection with it, without a message.
    listWidget().rows().beginReset();
    for (BListItem* item : items_) {
        item->selected_ = false;
        item->index_ = -1;
    }
    items_.clear();
    selection_.clear();
    selectionStale_ = false;
    firstUnnumbered_ = 0;
    listWidget().rows().endReset();
}

BListItem* BListView::ItemAt(int32 index) const
{
    return index >= 0 && index < CountItems() ? items_[static_cast<std::size_t>(index)] : nullptr;
}

void BListView::renumber() const
{
    for (int32 i = firstUnnumbered_; i < CountItems(); ++i)
        items_[static_cast<std::size_t>(i)]->index_ = i;
    firstUnnumbered_ = CountItems();
}

int32 BListView::IndexOf(const BListItem* item) const
{
    if (item == nullptr)
        return -1;
    // The item of another list may have a number that is good here, too, so what stands there is compared.
    renumber();
    return ItemAt(item->index_) == item ? item->index_ : -1;
}

void BListView::InvalidateItem(int32 index)
{
    // The next paint asks the item for its cells; nothing is kept of what they said.
    listWidget().update(listWidget().rows().index(index));
}

void BListView::InvalidateItems()
{
    listWidget().viewport()->update();
}

void BListView::Select(int32 first, int32 last, bool extend)
{
    if (ItemAt(first) == nullptr || ItemAt(last) == nullptr)
        return;
    // A row that is selected already changes nothing and sends no message, unless others lose their selection.
    const bool severalAllowed = listWidget().selectionMode() == QAbstractItemView::ExtendedSelection;
    const auto top = listWidget().rows().index(first);
    const auto bottom = listWidget().rows().index(severalAllowed ? last : first);
    listWidget().selectionModel()->select(
        {top, bottom}, extend && severalAllowed ? QItemSelectionModel::Select : QItemSelectionModel::ClearAndSelect);
    // The keyboard goes on from this row. That alone selects nothing.
    listWidget().selectionModel()->setCurrentIndex(top, QItemSelectionModel::NoUpdate);
}

void BListView::selectionChangedByWidget(const std::vector<int32>& on, const std::vector<int32>& off)
{
    // Rows that were taken out are not among these: they go silently.
    for (const int32 row : off) {
        if (BListItem* item = ItemAt(row))
            item->selected_ = false;
    }
    for (const int32 row : on) {
        if (BListItem* item = ItemAt(row))
            item->selected_ = true;
    }
    // Before the message: what it sets off asks for the selection.
    selectionStale_ = true;
    SelectionChanged();
    if (!quiet_)
        Invoke();
}

int32 BListView::CountSelected() const
{
    if (std::exchange(selectionStale_, false)) {
        selection_.clear();
        // The ranges come in the order in which they were selected.
        for (const auto& range : listWidget().selectionModel()->selection()) {
            for (int row = range.top(); row <= range.bottom(); ++row)
                selection_.push_back(row);
        }
        std::sort(selection_.begin(), selection_.end());
    }
    return static_cast<int32>(selection_.size());
}

int32 BListView::CurrentSelection(int32 which) const
{
    return which >= 0 && which < CountSelected() ? selection_[static_cast<std::size_t>(which)] : -1;
}

bool BListView::IsItemSelected(int32 index) const
{
    const BListItem* item = ItemAt(index);
    return item != nullptr && item->selected_;
}

void BListView::SelectAll()
{
    listWidget().selectAll();
}

void BListView::DeselectAll()
{
    listWidget().selectionModel()->clearSelection();
}

std::string BListView::SelectedText() const
{
    std::string text;
    for (int32 i = 0; i < CountSelected(); ++i)
        text += (i > 0 ? "\n" : "") + ItemAt(CurrentSelection(i))->CopyText();
    return text;
}

void BListView::CopySelected() const
{
    QApplication::clipboard()->setText(QString::fromStdString(SelectedText()));
}

void BListView::SetRowWidth(float width)
{
    if (width == rowWidth_)
        return;
    rowWidth_ = width;
    // The widget has asked a row for its size once, for all.
    listWidget().doItemsLayout();
    InvalidateItems();
}

float BListView::LeftEdge() const
{
    return static_cast<float>(listWidget().horizontalScrollBar()->value());
}

void BListView::ScrollTo(int32 index)
{
    if (ItemAt(index) != nullptr)
        listWidget().scrollTo(listWidget().rows().index(index));
}

int32 BListView::TopRow() const
{
    return std::max(listWidget().indexAt({0, 0}).row(), 0);
}

void BListView::SetTopRow(int32 index)
{
    // There may be fewer rows now than when the number was taken.
    index = std::min(index, CountItems() - 1);
    if (ItemAt(index) != nullptr)
        listWidget().scrollTo(listWidget().rows().index(index), QAbstractItemView::PositionAtTop);
}

void BListView::drawRow(QPainter& painter, BRect frame, int32 index)
{
    BListItem* item = ItemAt(index);
    if (item == nullptr)
        return;
    // A cell that is too wide must not write over its neighbours, nor change the pen of the list.
    painter.save();
    painter.setClipRect(toQt(frame));
    // The item draws by the functions of the view, which go to the list's own painter meanwhile.
    canvas().drawWith(painter, [&] { item->DrawItem(this, frame, true); });
    painter.restore();
}
