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
    if (state_.mode == B_OP_ALPHA)
        result.setAlpha(c.alpha);
    return result;
}

void Canvas::fit()
{
    const qreal ratio = widget_.devicePixelRatioF();
    const QSize size(static_cast<int>(std::ceil(widget_.width() * ratio)),
                     static_cast<int>(std::ceil(widget_.height() * ratio)));
    if (picture_.size() == size && picture_.devicePixelRatio() == ratio)
        return;
    // The view has another size, or has come to a screen of another resolution. What was drawn is lost with the old
    // picture, so the view is asked to draw again.
    picture_ = QPixmap(size.expandedTo({1, 1}));
    picture_.setDevicePixelRatio(ratio);
    picture_.fill(toQt(state_.view));
    stale_ = true;
}

const QPixmap& Canvas::picture(bool* fresh)
{
    fit();
    // Who is told that the picture is fresh has it drawn; it counts as up to date from here on.
    *fresh = std::exchange(stale_, false);
    return picture_;
}

void Canvas::paint(const std::function<void(QPainter&)>& draw)
{
    // Inside `drawAll` or `drawWith` all operations share one painter.
    if (painter_ != nullptr) {
        draw(*painter_);
        return;
    }
    widget_.update();
    if (hasNoGround())
        return;
    fit();
    if (stale_)
        return; // it is drawn anew before somebody looks, and that would cover this
    QPainter painter(&picture_);
    draw(painter);
    // The painter has to let go of the picture before somebody shows it.
    painter.end();
}

void Canvas::drawAll(const std::function<void()>& draw)
{
    fit();
    // Before the drawing, so that a view which asks inside `Draw` to be drawn again will be.
    stale_ = false;
    picture_.fill(toQt(state_.view));
    QPainter painter(&picture_);
    drawWith(painter, draw);
}

void Canvas::drawWith(QPainter& painter, const std::function<void()>& draw)
{
    // The painter that was in use before, if any, is in use again when this returns.
    QPainter* outer = std::exchange(painter_, &painter);
    painter.setFont(state_.font.toQt());
    draw();
    painter_ = outer;
}

void Canvas::print(QPainter& painter, const std::function<void()>& draw)
{
    isPrinting_ = true;
    drawWith(painter, draw);
    isPrinting_ = false;
}
