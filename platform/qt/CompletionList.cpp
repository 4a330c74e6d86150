#include "platform/qt/CompletionList.h"

#include <QApplication>
#include <QKeyEvent>
#include <QLineEdit>
#include <QScreen>
#include <QScrollBar>

#include <algorithm>

namespace {

constexpr int kMostRows = 8; // that show without scrolling
constexpr int kPadding = 12; // beside the longest row
constexpr int kSpacing = 1;  // around a row: capitals may have accents

} // namespace

CompletionList::CompletionList(QLineEdit& field, Find find, Choose choose)
    : QListView(&field), field_(field), find_(std::move(find)), choose_(std::move(choose))
{
    // A tool tip's kind of window takes neither the keyboard nor the mouse of other windows: a click elsewhere is one.
    setWindowFlags(Qt::ToolTip | Qt::FramelessWindowHint);
    setAttribute(Qt::WA_ShowWithoutActivating);
    setFocusPolicy(Qt::NoFocus);
    viewport()->setFocusPolicy(Qt::NoFocus);
    setObjectName(field.objectName() + "Completions");
    setAccessibleName(field.accessibleName() + " suggestions");
    setUniformItemSizes(true);
    setSpacing(kSpacing);
    setEditTriggers(NoEditTriggers);
    setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    setFrameStyle(QFrame::Box | QFrame::Plain);
    setModel(&labels_);
    QObject::connect(this, &QListView::clicked, [this](const QModelIndex& row) {
        setCurrentIndex(row);
        takeChosen();
    });
    field.window()->installEventFilter(this);
}

void CompletionList::offer(const std::string& typed)
{
    found_ = find_(typed);
    QStringList labels;
    for (const Completion& completion : found_)
        labels.append(QString::fromStdString(completion.label));
    labels_.setStringList(labels); // which leaves no row chosen
    if (found_.empty())
        return hide();
    place();
    show();
}

void CompletionList::place()
{
    const int rows = std::min(static_cast<int>(found_.size()), kMostRows);
    const int bar = static_cast<int>(found_.size()) > kMostRows ? verticalScrollBar()->sizeHint().width() : 0;
    const int frame = 2 * frameWidth();
    const QRect screen = field_.screen()->availableGeometry();
    const QSize size(std::clamp(sizeHintForColumn(0) + kPadding + bar + frame, field_.width(), screen.width()),
                     rows * (sizeHintForRow(0) + 2 * kSpacing) + frame);
    // Below the field or, where there is no room, above.
    QPoint corner = field_.mapToGlobal(QPoint(0, field_.height()));
    if (corner.y() + size.height() > screen.bottom())
        corner.setY(std::max(field_.mapToGlobal(QPoint(0, 0)).y() - size.height(), screen.top()));
    corner.setX(std::max(screen.left(), std::min(corner.x(), screen.right() - size.width())));
    setGeometry(QRect(corner, size));
}

void CompletionList::step(int rows)
{
    // One above the first row nothing is chosen, as at the beginning.
    const int row = std::clamp(currentIndex().row() + rows, -1, static_cast<int>(found_.size()) - 1);
    if (row < 0)
        selectionModel()->clear();
    else
        setCurrentIndex(labels_.index(row));
}

bool CompletionList::takeChosen()
{
    const int row = currentIndex().row();
    hide();
    if (row < 0 || row >= static_cast<int>(found_.size()))
        return false;
    const Completion chosen = found_[static_cast<std::size_t>(row)]; // what it sets off may look for others
    choose_(chosen);
    return true;
}

bool CompletionList::takeKey(const QKeyEvent& event)
{
    if (!isOpen())
        return false;
    switch (event.key()) {
    case Qt::Key_Down:
        step(1);
        return true;
    case Qt::Key_Up:
        step(-1);
        return true;
    case Qt::Key_PageDown:
        step(kMostRows);
        return true;
    case Qt::Key_PageUp:
        step(-kMostRows);
        return true;
    case Qt::Key_Escape:
        hide();
        return true;
    case Qt::Key_Return:
    case Qt::Key_Enter:
        return takeChosen();
    default:
        return false;
    }
}

void CompletionList::showEvent(QShowEvent* event)
{
    qApp->installEventFilter(this);
    QListView::showEvent(event);
}

void CompletionList::hideEvent(QHideEvent* event)
{
    qApp->removeEventFilter(this);
    QListView::hideEvent(event);
}

bool CompletionList::eventFilter(QObject* watched, QEvent* event)
{
    // The list's own scroll bars are watched, too, and the whole program while the list is open.
    const auto* pressed = event->type() == QEvent::MouseButtonPress ? qobject_cast<QWidget*>(watched) : nullptr;
    if (pressed != nullptr && pressed != &field_ && pressed != this && !isAncestorOf(pressed))
        hide(); // the click then does what it is for
    const bool isGone =
        event->type() == QEvent::Move || event->type() == QEvent::Resize || event->type() == QEvent::Hide;
    if (isGone && watched == field_.window())
        hide();
    return QListView::eventFilter(watched, event);
}
