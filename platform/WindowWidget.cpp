#include "platform/WindowWidget.h"

#include "platform/Window.h"

#include <QCloseEvent>
#include <QScreen>
#include <QScrollBar>
#include <QStyle>

void WindowWidget::fitTo(QSize content, bool resizable)
{
    setFrameShape(QFrame::NoFrame);
    setFocusPolicy(Qt::NoFocus);
    QSize size = content;
    const QSize available = screen()->availableSize();
    const int bar = style()->pixelMetric(QStyle::PM_ScrollBarExtent);
    if (available.height() < content.height())
        size = {content.width() + bar, available.height()};
    if (available.width() < size.width()) {
        size.setWidth(available.width());
        if (available.height() >= content.height() + bar)
            size.setHeight(content.height() + bar);
    }
    if (resizable)
        resize(size);
    else
        setFixedSize(size);
}

void WindowWidget::closeEvent(QCloseEvent* event)
{
    if (window_.closeByHand())
        event->accept();
    else
        event->ignore();
}
