#include "platform/qt/FieldButton.h"

#include <QMouseEvent>
#include <QPainter>

FieldButton::FieldButton(QWidget& field, const QIcon& icon, std::function<void()> press)
    : QWidget(&field), icon_(icon), press_(std::move(press))
{
    setCursor(Qt::ArrowCursor);
}

void FieldButton::paintEvent(QPaintEvent*)
{
    QPainter painter(this);
    icon_.paint(&painter, rect());
}

void FieldButton::mousePressEvent(QMouseEvent* event)
{
    if (event->button() == Qt::LeftButton)
        press_();
}
