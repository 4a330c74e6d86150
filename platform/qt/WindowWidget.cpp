#include "platform/qt/WindowWidget.h"

#include "platform/InterfaceDefs.h"
#include "platform/Window.h"
#include "platform/qt/Access.h"
#include "platform/qt/HeldKey.h"

#include <QApplication>
#include <QCloseEvent>
#include <QDir>
#include <QIcon>
#include <QScreen>
#include <QShortcut>
#include <QStyle>
#include <QTimer>
#include <QWindow>

#include <algorithm>
#include <chrono>
#include <utility>

namespace {

/// Gives the program its icon, in all sizes that were built in, if it has one and does not show it yet.
void showIcon()
{
    if (!QApplication::windowIcon().isNull())
        return;
    QIcon icon;
    const QDir icons(":/icons");
    for (const QString& file : icons.entryList({QApplication::desktopFileName() + "-*.png"}))
        icon.addFile(icons.filePath(file));
    QApplication::setWindowIcon(icon);
}

} // namespace

WindowWidget::WindowWidget(BWindow& window) : window_(window)
{
    nameRoles();
    addShortcut(Qt::Key_Q, B_CONTROL_KEY, [this] { close(); });
}

void WindowWidget::addShortcut(int key, uint32 modifiers, const std::function<void()>& action)
{
    constexpr struct {
        uint32 modifier;
        Qt::KeyboardModifier ours;
    } kModifiers[] = {
        {B_SHIFT_KEY, Qt::ShiftModifier}, {B_COMMAND_KEY, Qt::AltModifier}, {B_CONTROL_KEY, Qt::ControlModifier}};
    int combination = key;
    for (const auto& m : kModifiers)
        combination |= (modifiers & m.modifier) != 0 ? static_cast<int>(m.ours) : 0;
    auto* shortcut = new QShortcut(QKeySequence(combination), this); // this owns it
    HeldKey::watch();
    QObject::connect(shortcut, &QShortcut::activated, [this, action] {
        // A key that is held would open dialog after dialog.
        if (HeldKey::isRepeating())
            return;
        if (QWidget* field = focusWidget()) {
            // Leaving the field commits it; the keyboard is back in it before the action asks where it is.
            field->clearFocus();
            field->setFocus(Qt::OtherFocusReason);
        }
        action();
    });
}

QMargins WindowWidget::border() const
{
    const QRect inner = geometry(), outer = frameGeometry();
    if (isVisible())
        return {inner.left() - outer.left(), inner.top() - outer.top(), outer.right() - inner.right(),
                outer.bottom() - inner.bottom()};
    // The desktop's borders are not known before the window is shown; they are about those of a window within one.
    const int width = style()->pixelMetric(QStyle::PM_MdiSubWindowFrameWidth);
    return {width, style()->pixelMetric(QStyle::PM_TitleBarHeight), width, width};
}

void WindowWidget::giveWay()
{
    const QSize most = screen()->availableGeometry().size().shrunkBy(border());
    if (most.width() >= widget()->width() && most.height() >= widget()->height())
        return;
    window_.GiveWay(static_cast<float>(most.width()), static_cast<float>(most.height()));
    fitTo(pos(), widget()->size());
}

void WindowWidget::fitTo(QPoint place, QSize content)
{
    setFrameShape(QFrame::NoFrame);
    setFocusPolicy(Qt::NoFocus);
    const QRect desk = screen()->availableGeometry();
    const QMargins around = border();
    const QSize room = desk.size().shrunkBy(around);
    const int bar = style()->pixelMetric(QStyle::PM_ScrollBarExtent);
    // A scroll bar takes room itself: where the content is too high it needs more width, and the other way round.
    QSize size = content;
    if (!isResizable_ && room.height() < size.height())
        size.rwidth() += bar;
    if (!isResizable_ && room.width() < size.width() && room.height() >= content.height() + bar)
        size.rheight() += bar;
    size = size.boundedTo(room);
    // From here on the window fits the screen. It is moved as far as needed for all of it to show.
    if (isResizable_)
        resize(size);
    else
        setFixedSize(size);
    const QSize whole = size.grownBy(around);
    move(std::max(desk.left(), std::min(place.x(), desk.right() + 1 - whole.width())),
         std::max(desk.top(), std::min(place.y(), desk.bottom() + 1 - whole.height())));
}

void WindowWidget::moveEvent(QMoveEvent* event)
{
    QScrollArea::moveEvent(event);
    // The desktop has put its borders around the window, or it has come to another screen. Where it stands is the
    // person's business, but no part of it may be too large for the screen.
    const QSize whole = frameGeometry().size();
    const QSize desk = screen()->availableGeometry().size();
    if (isVisible() && (whole.width() > desk.width() || whole.height() > desk.height()))
        giveWay();
}

void WindowWidget::makeModal(const QWidget* below)
{
    setWindowFlags(Qt::Dialog);
    setWindowModality(Qt::ApplicationModal);
    addShortcut(Qt::Key_Escape, 0, [this] { close(); });
    winId(); // from here on there is a window of the desktop
    // No child of that window's widget, which would destroy this one along with itself.
    if (below != nullptr)
        windowHandle()->setTransientParent(below->window()->windowHandle());
}

void WindowWidget::showEvent(QShowEvent* event)
{
    QScrollArea::showEvent(event);
    if (!std::exchange(wasShown_, true))
        windowHandle()->installEventFilter(this); // until it is on the screen
}

bool WindowWidget::eventFilter(QObject* watched, QEvent* event)
{
    if (watched == windowHandle() && event->type() == QEvent::Expose && windowHandle()->isExposed()) {
        watched->removeEventFilter(this);
        // It is painted by what handles this event next. Soon after the desktop gives it the keyboard, which is to show
        // before anything else is done.
        QMetaObject::invokeMethod(
            this, [this] { QTimer::singleShot(std::chrono::milliseconds(10), this, &WindowWidget::tellPainted); },
            Qt::QueuedConnection);
    }
    return QScrollArea::eventFilter(watched, event);
}

void WindowWidget::tellPainted()
{
    showIcon();
    window_.Painted();
}

void WindowWidget::closeEvent(QCloseEvent* event)
{
    // The window closes itself with its own message later; here the desktop only hears whether it may.
    if (window_.askToClose())
        event->accept();
    else
        event->ignore();
}

void WindowWidget::resizeEvent(QResizeEvent* event)
{
    QScrollArea::resizeEvent(event);
    if (isResizable_)
        window_.fitContent(event->size());
}
