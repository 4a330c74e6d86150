// What a view shows: its picture, the state that it draws with, and the drawing itself.

#include "platform/View.h"
#include "platform/qt/Canvas.h"

#include <QPainter>
#include <QWidget>

#include <algorithm>
#include <cmath>

namespace {

/// A line along the pixels is a filled rectangle, which no smoothing blurs.
void strokeLine(QPainter& painter, BPoint from, BPoint to, float pen, const QColor& color)
{
    if (from.x == to.x || from.y == to.y) {
        // Across the line the pen is centred; along it the line ends where it is told to.
        const float left = std::floor(std::min(from.x, to.x) - (from.x == to.x ? (pen - 1) / 2 : 0));
        const float top = std::floor(std::min(from.y, to.y) - (from.y == to.y ? (pen - 1) / 2 : 0));
        const float width = from.x == to.x ? pen : std::abs(to.x - from.x);
        const float height = from.y == to.y ? pen : std::abs(to.y - from.y);
        painter.fillRect(QRectF(left, top, std::max(width, 1.0F), std::max(height, 1.0F)), color);
        return;
    }
    painter.setRenderHint(QPainter::Antialiasing);
    painter.setPen(QPen(color, pen, Qt::SolidLine, Qt::RoundCap, Qt::RoundJoin));
    painter.drawLine(QPointF(from.x, from.y), QPointF(to.x, to.y));
}

QPolygonF polygon(const BPoint* points, int32 count)
{
    QPolygonF result;
    result.reserve(count);
    for (int32 i = 0; i < count; ++i)
        result.append({points[i].x, points[i].y});
    return result;
}

void strokePath(QPainter& painter, const std::vector<BPoint>& points, float pen, const QColor& color)
{
    painter.setRenderHint(QPainter::Antialiasing);
    painter.setPen(QPen(color, pen, Qt::SolidLine, Qt::RoundCap, Qt::RoundJoin));
    painter.drawPolyline(polygon(points.data(), static_cast<int32>(points.size())));
}

} // namespace

void BView::drawAll()
{
    canvas_->drawAll([this] {
        // A view that does not draw still gets its ground.
        if ((flags_ & B_WILL_DRAW) != 0)
            Draw(Bounds());
    });
}

const QPixmap& BView::picture()
{
    // Drawn when it is looked at, however often it was invalidated before.
    bool fresh = false;
    canvas_->picture(&fresh);
    if (fresh)
        drawAll();
    return canvas_->picture(&fresh);
}

void BView::paintOn(QPainter& screen)
{
    const bool draws = (flags_ & B_WILL_DRAW) != 0;
    if (canvas_->hasNoGround()) {
        if (draws)
            canvas_->drawWith(screen, [this] { Draw(Bounds()); });
    } else if (draws) {
        screen.drawPixmap(0, 0, picture()); // as `Draw` has left it
    } else {
        screen.fillRect(widget_->rect(), toQt(state_.view)); // all that there is
    }
    // Above it what comes and goes.
    canvas_->drawWith(screen, [this] { DrawOver(Bounds()); });
}

void BView::Invalidate()
{
    canvas_->markStale();
    widget_->update();
}

void BView::RefreshOver()
{
    widget_->update();
}

void BView::Sync()
{
    // What was drawn is in the picture in any case; a view that does not show has no screen to bring it to.
    if (widget_->isVisible())
        widget_->repaint();
}

void BView::SetViewColor(rgb_color color)
{
    state_.view = color;
    Invalidate();
}

void BView::SetFont(const BFont* font, uint32 mask)
{
    // There is one family of fonts, so of family and style only the weight is left.
    if ((mask & B_FONT_FAMILY_AND_STYLE) != 0)
        state_.font.SetBold(font->IsBold());
    if ((mask & B_FONT_SIZE) != 0)
        state_.font.SetSize(font->Size());
}

void BView::SetFontSize(float size)
{
    const BFont font(size, false);
    SetFont(&font, B_FONT_SIZE);
}

void BView::FillRect(BRect rect, pattern p)
{
    canvas_->paint([&](QPainter& painter) { painter.fillRect(toQt(rect), canvas_->color(p)); });
}

void BView::StrokeRect(BRect rect, pattern p)
{
    const float pen = state_.penSize;
    // Within the rectangle, and no pixel twice: a translucent colour would show where sides meet.
    FillRect({rect.left, rect.top, rect.right, rect.top + pen}, p);
    FillRect({rect.left, rect.bottom - pen, rect.right, rect.bottom}, p);
    FillRect({rect.left, rect.top + pen, rect.left + pen, rect.bottom - pen}, p);
    FillRect({rect.right - pen, rect.top + pen, rect.right, rect.bottom - pen}, p);
}

void BView::StrokeLine(BPoint from, BPoint to, pattern p)
{
    canvas_->paint([&](QPainter& painter) { strokeLine(painter, from, to, state_.penSize, canvas_->color(p)); });
}

void BView::BeginLineArray(int32 count)
{
    canvas_->lines.emplace();
    canvas_->lines->points.reserve(static_cast<std::size_t>(count) + 1);
}

void BView::AddLine(BPoint from, BPoint to, rgb_color color)
{
    if (!canvas_->lines)
        return;
    constexpr std::size_t kLongest = 16; // of a stroke: the time for one grows faster than its length
    auto& points = canvas_->lines->points;
    // A line that does not go on where the last one ended begins a stroke of its own, as does one of another colour.
    // After this the stroke has at least this line.
    if (points.empty() || points.size() > kLongest || !(points.back() == from) || !(canvas_->lines->color == color))
        flushLines();
    if (points.empty())
        points.push_back(from);
    points.push_back(to);
    canvas_->lines->color = color;
}

void BView::EndLineArray()
{
    if (canvas_->lines)
        flushLines();
    canvas_->lines.reset();
}

void BView::flushLines()
{
    auto& points = canvas_->lines->points;
    canvas_->paint([&](QPainter& painter) {
        const QColor color = canvas_->color(canvas_->lines->color);
        // A single line may be upright or level, and is then sharp.
        if (points.size() == 2)
            strokeLine(painter, points[0], points[1], state_.penSize, color);
        else if (!points.empty())
            strokePath(painter, points, state_.penSize, color);
    });
    points.clear();
}

void BView::FillPolygon(const BPoint* points, int32 count, pattern p)
{
    canvas_->paint([&](QPainter& painter) {
        painter.setRenderHint(QPainter::Antialiasing);
        painter.setPen(Qt::NoPen);
        painter.setBrush(canvas_->color(p));
        painter.drawPolygon(polygon(points, count));
    });
}

void BView::FillArc(BPoint center, float xRadius, float yRadius, float startAngle, float arcAngle, pattern p)
{
    canvas_->paint([&](QPainter& painter) {
        constexpr float kUnitsPerDegree = 16;
        painter.setRenderHint(QPainter::Antialiasing);
        painter.setPen(Qt::NoPen);
        painter.setBrush(canvas_->color(p));
        painter.drawPie(QRectF(center.x - xRadius, center.y - yRadius, 2 * xRadius, 2 * yRadius),
                        static_cast<int>(std::lround(startAngle * kUnitsPerDegree)),
                        static_cast<int>(std::lround(arcAngle * kUnitsPerDegree)));
    });
}

bool BView::IsPrinting() const
{
    return canvas_->isPrinting();
}

void BView::DrawString(const char* text, BPoint where)
{
    canvas_->paint([&](QPainter& painter) {
        QFont font = state_.font.toQt();
        if (IsPrinting())
            font.setHintingPreference(QFont::PreferNoHinting);
        painter.setFont(font);
        painter.setPen(canvas_->color(B_SOLID_HIGH));
        painter.drawText(QPointF(where.x, where.y), QString::fromUtf8(text));
    });
}
