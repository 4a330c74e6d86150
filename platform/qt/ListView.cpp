#include "platform/ListView.h"

#include "platform/ListItem.h"
#include "platform/Window.h"
#include "platform/qt/Canvas.h"
#include "platform/qt/ListWidget.h"

#include <QItemSelectionModel>
#include <QPainter>
#include <QScrollBar>

#include <algorithm>
#include <utility>

namespace {

/// Changes of rows take the selection along; Qt need not tell of that.
class Silence {
public:
    explicit Silence(ListWidget& widget) : widget_(widget) { widget_.setSilent(true); }
    ~Silence() { widget_.setSilent(false); }
    Silence(const Silence&) = delete;
    Silence& operator=(const Silence&) = delete;

private:
    ListWidget& widget_;
};

} // namespace

BListView::BListView(BRect frame, const char* name, list_view_type type, uint32 resizingMode, uint32 flags)
    : BView(frame, name, resizingMode, flags, new ListWidget(*this))
{
    SetAccessibleName(name);
    listWidget().setSelectionMode(type == B_SINGLE_SELECTION_LIST ? QAbstractItemView::SingleSelection
                                                                  : QAbstractItemView::ExtendedSelection);
}

BListView::~BListView()
{
    listWidget().setSilent(true);
}

ListWidget& BListView::listWidget() const
{
    return *static_cast<ListWidget*>(widget());
}

void BListView::AttachedToWindow()
{
    if (!HasTarget())
        SetTarget(Window());
}

bool BListView::AddItem(BListItem* item, int32 index)
{
    if (item == nullptr || index < 0 || index > CountItems())
        return false;
    const Silence silence(listWidget());
    listWidget().rows().beginInsert(index, index);
    items_.insert(items_.begin() + index, item);
    firstUnnumbered_ = std::min(firstUnnumbered_, index);
    selectionStale_ = true;
    listWidget().rows().endInsert();
    return true;
}

void BListView::AddItems(const std::vector<BListItem*>& items)
{
    if (items.empty())
        return;
    const Silence silence(listWidget());
    const int first = CountItems();
    listWidget().rows().beginInsert(first, first + static_cast<int>(items.size()) - 1);
    items_.insert(items_.end(), items.begin(), items.end());
    firstUnnumbered_ = std::min(firstUnnumbered_, first);
    listWidget().rows().endInsert();
}

BListItem* BListView::RemoveItem(int32 index)
{
    BListItem* item = ItemAt(index);
    if (item == nullptr)
        return nullptr;
    const Silence silence(listWidget());
    listWidget().rows().beginRemove(index, index);
    items_.erase(items_.begin() + index);
    firstUnnumbered_ = std::min(firstUnnumbered_, index);
    selectionStale_ = true;
    listWidget().rows().endRemove();
    item->selected_ = false;
    item->index_ = -1;
    // Qt selects a neighbour in the place of the row that the keyboard was at; here nothing comes to be selected.
    for (const auto& row : listWidget().selectionModel()->selectedIndexes()) {
        if (!items_[static_cast<std::size_t>(row.row())]->selected_)
            listWidget().selectionModel()->select(row, QItemSelectionModel::Deselect);
    }
    return item;
}

void BListView::MakeEmpty()
{
    const Silence silence(listWidget());
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
    renumber();
    return ItemAt(item->index_) == item ? item->index_ : -1;
}

void BListView::InvalidateItem(int32 index)
{
    listWidget().update(listWidget().rows().index(index));
}

void BListView::InvalidateItems()
{
    listWidget().viewport()->update();
}

// --- Selection.

void BListView::Select(int32 first, int32 last, bool extend)
{
    if (ItemAt(first) == nullptr || ItemAt(last) == nullptr)
        return;
    const bool severalAllowed = listWidget().selectionMode() == QAbstractItemView::ExtendedSelection;
    const auto top = listWidget().rows().index(first);
    const auto bottom = listWidget().rows().index(severalAllowed ? last : first);
    listWidget().selectionModel()->select(
        {top, bottom}, extend && severalAllowed ? QItemSelectionModel::Select : QItemSelectionModel::ClearAndSelect);
    listWidget().selectionModel()->setCurrentIndex(top, QItemSelectionModel::NoUpdate);
}

void BListView::selectionChangedByWidget(const std::vector<int32>& on, const std::vector<int32>& off)
{
    for (const int32 row : off) {
        if (BListItem* item = ItemAt(row))
            item->selected_ = false;
    }
    for (const int32 row : on) {
        if (BListItem* item = ItemAt(row))
            item->selected_ = true;
    }
    selectionStale_ = true;
    if (!quiet_ && selectionMessage_ != nullptr)
        Invoke(selectionMessage_.get());
}

int32 BListView::CountSelected() const
{
    if (std::exchange(selectionStale_, false)) {
        selection_.clear();
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

std::string BListView::SelectedText() const
{
    std::string text;
    for (int32 i = 0; i < CountSelected(); ++i)
        text += (i > 0 ? "\n" : "") + ItemAt(CurrentSelection(i))->Text();
    return text;
}

void BListView::invokedByWidget()
{
    if (CountSelected() > 0 && Message() != nullptr)
        Invoke();
}

// --- Scrolling and drawing.

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
    index = std::min(index, CountItems() - 1);
    if (ItemAt(index) != nullptr)
        listWidget().scrollTo(listWidget().rows().index(index), QAbstractItemView::PositionAtTop);
}

void BListView::drawRow(QPainter& painter, BRect frame, int32 index)
{
    BListItem* item = ItemAt(index);
    if (item == nullptr)
        return;
    painter.save();
    painter.setClipRect(toQt(frame));
    canvas().drawWith(painter, [&] { item->DrawItem(this, frame, true); });
    painter.restore();
}
