#include "platform/qt/ViewWidget.h"

#include "platform/View.h"
#include "platform/qt/Keys.h"

#include <QContextMenuEvent>
#include <QKeyEvent>
#include <QMouseEvent>
#include <QPainter>

namespace {

BPoint at(const QMouseEvent& event)
{
    return {static_cast<float>(event.position().x()), static_cast<float>(event.position().y())};
}

} // namespace

ViewWidget::ViewWidget(BView& view) : view_(view)
{
    // The view hears of the pointer also while no button is held.
    setMouseTracking(true);
}

void ViewWidget::paintEvent(QPaintEvent*)
{
    QPainter screen(this);
    view_.paintOn(screen);
}

void ViewWidget::mousePressEvent(QMouseEvent* event)
{
    if (event->button() == Qt::LeftButton)
        view_.MouseDown(at(*event));
    else
        QWidget::mousePressEvent(event);
}

void ViewWidget::mouseReleaseEvent(QMouseEvent* event)
{
    if (event->button() == Qt::LeftButton)
        view_.MouseUp(at(*event));
    else
        QWidget::mouseReleaseEvent(event);
}

void ViewWidget::mouseMoveEvent(QMouseEvent* event)
{
    view_.MouseMoved(at(*event), rect().contains(event->position().toPoint()));
}

void ViewWidget::leaveEvent(QEvent*)
{
    // Nowhere in the view.
    view_.MouseMoved({-1, -1}, false);
}

void ViewWidget::contextMenuEvent(QContextMenuEvent* event)
{
    view_.MenuRequested({static_cast<float>(event->x()), static_cast<float>(event->y())});
}

void ViewWidget::keyPressEvent(QKeyEvent* event)
{
    const std::string bytes = keyBytes(*event);
    // Keys without text, such as Tab, are for Qt, or for a widget further out.
    if (bytes.empty())
        QWidget::keyPressEvent(event);
    else
        view_.KeyDown(bytes.c_str(), static_cast<int32>(bytes.size()));
}

void ViewWidget::focusInEvent(QFocusEvent* event)
{
    // What marks the keyboard is drawn over the picture, which stays.
    view_.RefreshOver();
    QWidget::focusInEvent(event);
}

void ViewWidget::focusOutEvent(QFocusEvent* event)
{
    view_.RefreshOver();
    QWidget::focusOutEvent(event);
}
