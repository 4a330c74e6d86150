#include "platform/qt/ListWidget.h"

#include "platform/ListItem.h"
#include "platform/ListView.h"

#include <QApplication>
#include <QClipboard>
#include <QKeyEvent>
#include <QPainter>

namespace {

std::vector<int32> rowsOf(const QItemSelection& selection)
{
    std::vector<int32> rows;
    for (const auto& range : selection) {
        for (int row = range.top(); row <= range.bottom(); ++row)
            rows.push_back(row);
    }
    return rows;
}

} // namespace

int ListModel::rowCount(const QModelIndex& parent) const
{
    return parent.isValid() ? 0 : list_.CountItems();
}

QVariant ListModel::data(const QModelIndex& index, int role) const
{
    const BListItem* item = list_.ItemAt(index.row());
    if (item == nullptr || (role != Qt::DisplayRole && role != Qt::AccessibleTextRole))
        return {};
    return QString::fromStdString(item->Text());
}

QModelIndexList ListModel::match(const QModelIndex& start, int role, const QVariant& value, int hits,
                                 Qt::MatchFlags flags) const
{
    const QModelIndexList beginning = QAbstractListModel::match(start, role, value, hits, flags);
    if (!beginning.empty())
        return beginning;
    return QAbstractListModel::match(start, role, '\t' + value.toString(), hits, Qt::MatchContains | Qt::MatchWrap);
}

void ListRows::paint(QPainter* painter, const QStyleOptionViewItem& option, const QModelIndex& index) const
{
    const QRect area = option.rect;
    const bool selected = (option.state & QStyle::State_Selected) != 0;
    const bool active = (option.state & QStyle::State_Active) != 0 && option.widget->hasFocus();
    QColor ground =
        index.row() % 2 == 0 ? option.palette.color(QPalette::Base) : option.palette.color(QPalette::AlternateBase);
    if (selected)
        ground = active ? option.palette.color(QPalette::Highlight) : QColor(176, 190, 208);
    painter->fillRect(area, ground);
    const QColor text =
        selected && active ? option.palette.color(QPalette::HighlightedText) : option.palette.color(QPalette::Text);
    list_.SetHighColor({static_cast<std::uint8_t>(text.red()), static_cast<std::uint8_t>(text.green()),
                        static_cast<std::uint8_t>(text.blue()), 255});
    list_.drawRow(*painter,
                  {static_cast<float>(area.left()), static_cast<float>(area.top()),
                   static_cast<float>(area.left() + area.width()), static_cast<float>(area.top() + area.height())},
                  index.row());
    if ((option.state & QStyle::State_HasFocus) != 0 && !selected) {
        painter->setPen(QPen(option.palette.color(QPalette::Highlight), 1, Qt::DotLine));
        painter->drawRect(area.adjusted(0, 0, -1, -1));
    }
}

QSize ListRows::sizeHint(const QStyleOptionViewItem&, const QModelIndex&) const
{
    return {1, static_cast<int>(list_.RowHeight())};
}

ListWidget::ListWidget(BListView& list) : list_(list), rows_(list), painter_(list)
{
    setUniformItemSizes(true);
    setModel(&rows_);
    setItemDelegate(&painter_);
    setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    setVerticalScrollBarPolicy(Qt::ScrollBarAlwaysOn);
    setVerticalScrollMode(QAbstractItemView::ScrollPerItem);
    setEditTriggers(QAbstractItemView::NoEditTriggers);
    silent_ = false;
}

ListWidget::~ListWidget()
{
    silent_ = true;
    setModel(nullptr); // it dies before the base class that looks at it
    setItemDelegate(nullptr);
}

void ListWidget::selectionChanged(const QItemSelection& selected, const QItemSelection& deselected)
{
    QListView::selectionChanged(selected, deselected);
    if (!silent_)
        list_.selectionChangedByWidget(rowsOf(selected), rowsOf(deselected));
}

void ListWidget::keyPressEvent(QKeyEvent* event)
{
    if (event->key() == Qt::Key_Return || event->key() == Qt::Key_Enter)
        list_.invokedByWidget();
    else if (event->matches(QKeySequence::Copy))
        QApplication::clipboard()->setText(QString::fromStdString(list_.SelectedText()));
    else
        QListView::keyPressEvent(event);
}

void ListWidget::mouseDoubleClickEvent(QMouseEvent* event)
{
    QListView::mouseDoubleClickEvent(event);
    list_.invokedByWidget();
}

void ListWidget::paintEvent(QPaintEvent* event)
{
    QListView::paintEvent(event);
    if (!hasFocus())
        return;
    QPainter painter(viewport());
    painter.setPen(palette().color(QPalette::Highlight));
    painter.drawRect(viewport()->rect().adjusted(0, 0, -1, -1));
}
