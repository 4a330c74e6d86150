#pragma once

#include "platform/Font.h"
#include "platform/GraphicsDefs.h"
#include "platform/Rect.h"

#include <QColor>
#include <QPixmap>
#include <QRectF>

#include <functional>
#include <optional>
#include <vector>

class QPainter;
class QWidget;

QColor toQt(rgb_color color);
QRectF toQt(const BRect& rect);

/// A view's picture and the colours, pen and font that it is drawn with.
///
/// Drawing goes to the picture, at the resolution of the screen that the view is on, or to a painter that somebody else
/// has begun, as a list does for its rows.
class Canvas {
public:
    rgb_color high{0, 0, 0, 255};
    rgb_color low{255, 255, 255, 255};
    rgb_color view{255, 255, 255, 255};
    float penSize = 1;
    drawing_mode mode = B_OP_COPY;
    BFont font;

    /// The stroke at the end of the lines that were added so far.
    struct Stroke {
        std::vector<BPoint> points;
        rgb_color color;
    };
    std::optional<Stroke> lines; // while a line array is being made

    explicit Canvas(QWidget& widget) : widget_(widget) {}

    /// Runs `draw` with a painter that is set up by the state above.
    void paint(const std::function<void(QPainter&)>& draw);
    /// Runs `draw` with every operation inside it going to one painter on the picture, over the view's colour.
    void drawAll(const std::function<void()>& draw);
    /// Runs `draw` with every operation inside it going to `painter`.
    void drawWith(QPainter& painter, const std::function<void()>& draw);

    /// The picture, of the view's present size. `*fresh` tells that it was just made and holds nothing yet.
    const QPixmap& picture(bool* fresh);
    void markStale() { stale_ = true; }

    QColor color(pattern p) const;
    QColor color(rgb_color c) const;

private:
    void fit();

    QWidget& widget_;
    QPixmap picture_;
    QPainter* painter_ = nullptr; // while something is drawn as a whole
    bool stale_ = true;
};
