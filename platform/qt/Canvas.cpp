#include "platform/qt/Canvas.h"

#include <QPainter>
#include <QWidget>

#include <cmath>
#include <utility>

QColor toQt(rgb_color color)
{
    return {color.red, color.green, color.blue};
}

QRectF toQt(const BRect& rect)
{
    return {QPointF(rect.left, rect.top), QPointF(rect.right, rect.bottom)};
}

QColor Canvas::color(rgb_color c) const
{
    QColor result = toQt(c);
    if (mode == B_OP_ALPHA)
        result.setAlpha(c.alpha);
    return result;
}

QColor Canvas::color(pattern p) const
{
    return color(p == B_SOLID_HIGH ? high : low);
}

void Canvas::fit()
{
    const qreal ratio = widget_.devicePixelRatioF();
    const QSize size(static_cast<int>(std::ceil(widget_.width() * ratio)),
                     static_cast<int>(std::ceil(widget_.height() * ratio)));
    if (picture_.size() == size && picture_.devicePixelRatio() == ratio)
        return;
    picture_ = QPixmap(size.expandedTo({1, 1}));
    picture_.setDevicePixelRatio(ratio);
    picture_.fill(toQt(view));
    stale_ = true;
}

const QPixmap& Canvas::picture(bool* fresh)
{
    fit();
    *fresh = std::exchange(stale_, false);
    return picture_;
}

void Canvas::paint(const std::function<void(QPainter&)>& draw)
{
    if (painter_ != nullptr) {
        draw(*painter_);
        return;
    }
    fit();
    QPainter painter(&picture_);
    draw(painter);
    painter.end();
    widget_.update();
}

void Canvas::drawAll(const std::function<void()>& draw)
{
    fit();
    stale_ = false;
    if (view != B_TRANSPARENT_COLOR)
        picture_.fill(toQt(view));
    else
        picture_.fill(Qt::transparent);
    QPainter painter(&picture_);
    drawWith(painter, draw);
}

void Canvas::drawWith(QPainter& painter, const std::function<void()>& draw)
{
    QPainter* outer = std::exchange(painter_, &painter);
    painter.setFont(font.toQt());
    draw();
    painter_ = outer;
}
