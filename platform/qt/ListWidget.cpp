#include "platform/qt/ListWidget.h"

#include "platform/ListItem.h"
#include "platform/ListView.h"
#include "platform/qt/Canvas.h"

#include <QContextMenuEvent>
#include <QHelpEvent>
#include <QKeyEvent>
#include <QPainter>
#include <QScrollBar>
#include <QToolTip>

namespace {

/// The numbers of the rows of a selection, which Qt gives as ranges.
std::vector<int32> rowsOf(const QItemSelection& selection)
{
    std::vector<int32> rows;
    for (const auto& range : selection) {
        for (int row = range.top(); row <= range.bottom(); ++row)
            rows.push_back(row);
    }
    return rows;
}

/// What `KeyDown` of a list gets for a key; 0 for a key that is none of its business.
char keyOf(const QKeyEvent& event)
{
    if ((event.modifiers() & ~Qt::KeypadModifier) != Qt::NoModifier)
        return '\0';
    switch (event.key()) {
    case Qt::Key_Delete:
        return B_DELETE;
    case Qt::Key_F2:
        return B_FUNCTION_KEY;
    case Qt::Key_Return:
    case Qt::Key_Enter:
        return B_ENTER;
    default:
        return '\0';
    }
}

} // namespace

int ListModel::rowCount(const QModelIndex& parent) const
{
    return parent.isValid() ? 0 : list_.CountItems();
}

QVariant ListModel::data(const QModelIndex& index, int role) const
{
    const BListItem* item = list_.ItemAt(index.row());
    // Nothing else is asked of the texts: the rows draw themselves. This is for typing and for assistive tools.
    if (item == nullptr || (role != Qt::DisplayRole && role != Qt::AccessibleTextRole))
        return {};
    return QString::fromStdString(item->Text());
}

QModelIndexList ListModel::match(const QModelIndex& start, int role, const QVariant& value, int hits,
                                 Qt::MatchFlags flags) const
{
    // First the usual way, by the beginning of a row, which is its first cell.
    const QModelIndexList beginning = QAbstractListModel::match(start, role, value, hits, flags);
    if (!beginning.empty())
        return beginning;
    // Another cell begins behind a tab.
    return QAbstractListModel::match(start, role, '\t' + value.toString(), hits, Qt::MatchContains | Qt::MatchWrap);
}

void ListRows::paint(QPainter* painter, const QStyleOptionViewItem& option, const QModelIndex& index) const
{
    // The list paints the ground and the item writes on it, in the high colour that is set here: what can be read on
    // that ground. Without the keyboard the selection is paler, so that a person sees where the keys go.
    const QRect area = option.rect;
    const bool selected = (option.state & QStyle::State_Selected) != 0;
    const bool active = (option.state & QStyle::State_Active) != 0 && option.widget->hasFocus();
    QColor ground =
        index.row() % 2 == 0 ? option.palette.color(QPalette::Base) : option.palette.color(QPalette::AlternateBase);
    if (selected)
        ground = active ? option.palette.color(QPalette::Highlight) : toQt(kPaleSelection);
    painter->fillRect(area, ground);
    const QColor text =
        selected && active ? option.palette.color(QPalette::HighlightedText) : option.palette.color(QPalette::Text);
    list_.SetHighColor({static_cast<std::uint8_t>(text.red()), static_cast<std::uint8_t>(text.green()),
                        static_cast<std::uint8_t>(text.blue()), 255});
    list_.drawRow(*painter,
                  {static_cast<float>(area.left()), static_cast<float>(area.top()),
                   static_cast<float>(area.left() + area.width()), static_cast<float>(area.top() + area.height())},
                  index.row());
    // Where the keyboard stands, in a list of which that row is not selected.
    if ((option.state & QStyle::State_HasFocus) != 0 && !selected) {
        painter->setPen(QPen(option.palette.color(QPalette::Highlight), 1, Qt::DotLine));
        painter->drawRect(area.adjusted(0, 0, -1, -1));
    }
}

QSize ListRows::sizeHint(const QStyleOptionViewItem&, const QModelIndex&) const
{
    return {std::max(static_cast<int>(list_.RowWidth()), 1), static_cast<int>(list_.RowHeight())};
}

namespace {

/// An empty groove while there is nothing to scroll. What the style paints then looks as if it could be moved, and is
/// the dearest of all controls: a start has four of them.
class QuietScrollBar final : public QScrollBar {
public:
    using QScrollBar::QScrollBar;

protected:
    void paintEvent(QPaintEvent* event) override
    {
        if (maximum() > minimum())
            return QScrollBar::paintEvent(event);
        QPainter painter(this);
        painter.fillRect(rect(), palette().color(QPalette::Window));
    }
};

} // namespace

ListWidget::ListWidget(BListView& list) : list_(list), rows_(list), painter_(list)
{
    // The widget then asks one row for its size, and not 100,000.
    setUniformItemSizes(true);
    // Before there is a model: it would be asked for its rows, and the list is still being made.
    setHorizontalScrollMode(QAbstractItemView::ScrollPerPixel);
    setModel(&rows_);
    setItemDelegate(&painter_);
    QObject::connect(horizontalScrollBar(), &QScrollBar::valueChanged, [this] { list_.ScrolledSideways(); });
    // Always, so that the columns keep their width, which the pages have reckoned with.
    setVerticalScrollBarPolicy(Qt::ScrollBarAlwaysOn);
    setVerticalScrollBar(new QuietScrollBar(this)); // which the widget owns
    // By whole rows, as `TopRow` and `SetTopRow` count them.
    setVerticalScrollMode(QAbstractItemView::ScrollPerItem);
    setEditTriggers(QAbstractItemView::NoEditTriggers);
    silent_ = false;
}

ListWidget::~ListWidget()
{
    // What follows changes the selection of a list view that is half destroyed.
    silent_ = true;
    setModel(nullptr); // it dies before the base class that looks at it
    setItemDelegate(nullptr);
}

void ListWidget::selectionChanged(const QItemSelection& selected, const QItemSelection& deselected)
{
    QListView::selectionChanged(selected, deselected);
    // Silent while rows come and go: the list view then settles the selection itself, and no command is to hear of it.
    if (!silent_)
        list_.selectionChangedByWidget(rowsOf(selected), rowsOf(deselected));
}

void ListWidget::keyPressEvent(QKeyEvent* event)
{
    // The rows that are selected, as a table that a spreadsheet takes.
    if (event->matches(QKeySequence::Copy))
        return list_.CopySelected();
    // In a list of rows these two have nothing else to do.
    const bool isLeft = event->key() == Qt::Key_Left;
    if ((isLeft || event->key() == Qt::Key_Right) && horizontalScrollBar()->maximum() > 0)
        return horizontalScrollBar()->triggerAction(isLeft ? QAbstractSlider::SliderSingleStepSub
                                                           : QAbstractSlider::SliderSingleStepAdd);
    const char key = keyOf(*event);
    if (key != '\0')
        list_.KeyDown(&key, 1);
    else
        QListView::keyPressEvent(event);
}

void ListWidget::contextMenuEvent(QContextMenuEvent* event)
{
    // The press of the right button has selected the row below the pointer, unless it was among those selected. By the
    // key the menu comes up where the keyboard stands.
    QPoint where = event->pos();
    if (event->reason() == QContextMenuEvent::Keyboard)
        where = visualRect(currentIndex()).bottomLeft();
    where.setY(std::clamp(where.y(), 0, viewport()->height()));
    list_.MenuRequested({static_cast<float>(where.x()), static_cast<float>(where.y())});
}

bool ListWidget::viewportEvent(QEvent* event)
{
    if (event->type() != QEvent::ToolTip)
        return QListView::viewportEvent(event);
    const auto& help = static_cast<QHelpEvent&>(*event);
    const QModelIndex row = indexAt(help.pos());
    const BPoint where(static_cast<float>(help.x()), static_cast<float>(help.y()));
    // The text of an empty list may need more room than a low list has.
    const bool isEmpty = list_.CountItems() == 0;
    const std::string text = isEmpty ? list_.EmptyText() : row.isValid() ? list_.ToolTipAt(where, row.row()) : "";
    // As it stands: a name may look like HTML.
    const QString shown = QString::fromStdString(text).toHtmlEscaped();
    const QString paragraph = isEmpty ? "<p>" : "<p style='white-space:pre'>";
    QToolTip::showText(help.globalPos(), text.empty() ? QString() : paragraph + shown + "</p>", viewport());
    return true;
}

void ListWidget::scrollContentsBy(int dx, int dy)
{
    QListView::scrollContentsBy(dx, dy);
    // What is painted is moved, and the frame of the keyboard with it.
    if (hasFocus())
        viewport()->update();
}

void ListWidget::paintEmptyText()
{
    constexpr int kInset = 6;
    QPainter painter(viewport());
    painter.setFont(be_plain_font->toQt());
    painter.setPen(toQt(kFaintGrey));
    painter.drawText(viewport()->rect().adjusted(kInset, kInset, -kInset, -kInset), Qt::TextWordWrap,
                     QString::fromStdString(list_.EmptyText()));
}

void ListWidget::paintEvent(QPaintEvent* event)
{
    QListView::paintEvent(event);
    if (list_.CountItems() == 0)
        paintEmptyText();
    // Which list has the keyboard shows also when no row is selected.
    if (!hasFocus())
        return;
    QPainter painter(viewport());
    painter.setPen(palette().color(QPalette::Highlight));
    painter.drawRect(viewport()->rect().adjusted(0, 0, -1, -1));
}
