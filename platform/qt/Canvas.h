#pragma once

#include "platform/View.h"

#include <QColor>
#include <QPixmap>
#include <QRectF>

#include <functional>
#include <optional>
#include <vector>

QColor toQt(rgb_color color);
QRectF toQt(const BRect& rect);

/// A view's picture, and what draws it by the view's state.
///
/// Drawing goes to the picture, at the resolution of the screen that the view is on, or to a painter that somebody else
/// has begun, as a list does for its rows.
class Canvas {
public:
    /// The stroke at the end of the lines that were added so far.
    struct Stroke {
        std::vector<BPoint> points;
        rgb_color color;
    };
    std::optional<Stroke> lines; // while a line array is being made

    /// `state` stays the view's, which changes it as it likes.
    Canvas(QWidget& widget, const DrawingState& state) : widget_(widget), state_(state) {}

    /// Runs `draw` with a painter that is set up by the state.
    void paint(const std::function<void(QPainter&)>& draw);
    /// Runs `draw` with every operation inside it going to one painter on the picture, over the view's colour.
    void drawAll(const std::function<void()>& draw);
    /// Runs `draw` with every operation inside it going to `painter`.
    void drawWith(QPainter& painter, const std::function<void()>& draw);
    /// The same for a painter on paper.
    void print(QPainter& painter, const std::function<void()>& draw);
    bool isPrinting() const { return isPrinting_; }

    /// The picture, of the view's present size. `*fresh` tells that it was just made and holds nothing yet.
    const QPixmap& picture(bool* fresh);
    /// Whether the view is seen through where it does not draw. It is drawn whenever it is looked at: a picture of its
    /// size, most of which is empty, would cost more.
    bool hasNoGround() const { return state_.view == B_TRANSPARENT_COLOR; }
    void markStale() { stale_ = true; }

    QColor color(pattern p) const { return color(p == B_SOLID_HIGH ? state_.high : state_.low); }
    QColor color(rgb_color c) const;

private:
    void fit();

    QWidget& widget_;
    const DrawingState& state_;
    QPixmap picture_;
    QPainter* painter_ = nullptr; // while something is drawn as a whole
    bool stale_ = true;
    bool isPrinting_ = false;
};
