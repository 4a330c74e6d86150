#include "platform/View.h"

#include "platform/Canvas.h"
#include "platform/ViewWidget.h"
#include "platform/Window.h"

#include <QPainter>

#include <algorithm>
#include <cmath>

namespace {

int whole(float length)
{
    return static_cast<int>(std::lround(length));
}

} // namespace

/// The stroke at the end of the lines that were added so far.
class LineArray {
public:
    std::vector<BPoint> points;
    rgb_color color;
};

BView::BView(BRect frame, const char* name, uint32 resizingMode, uint32 flags)
    : BView(frame, name, resizingMode, flags, new ViewWidget(*this))
{}

BView::BView(BRect frame, const char* name, uint32 resizingMode, uint32 flags, QWidget* widget)
    : BHandler(name), frame_(frame), resizingMode_(resizingMode), flags_(flags), widget_(widget),
      canvas_(std::make_unique<Canvas>(*widget))
{
    widget_->setObjectName(QString::fromUtf8(Name()));
    if ((flags & B_NAVIGABLE) != 0)
        widget_->setFocusPolicy(Qt::StrongFocus);
    placeWidget();
}

BView::~BView()
{
    if (parent_ != nullptr)
        parent_->RemoveChild(this);
    while (!children_.empty())
        delete children_.back(); // takes itself out
    delete widget_;
}

// --- The tree of views.

void BView::AddChild(BView* child)
{
    children_.push_back(child);
    child->parent_ = this;
    child->widget_->setParent(childHost());
    child->placeWidget();
    child->widget_->setVisible(!child->hidden_);
    child->setWindow(window_);
}

bool BView::RemoveChild(BView* child)
{
    const auto found = std::find(children_.begin(), children_.end(), child);
    if (found == children_.end())
        return false;
    children_.erase(found);
    child->parent_ = nullptr;
    child->window_ = nullptr;
    child->widget_->setParent(nullptr);
    return true;
}

BView* BView::ChildAt(int32 index) const
{
    return index >= 0 && index < CountChildren() ? children_[static_cast<std::size_t>(index)] : nullptr;
}

BLooper* BView::Looper() const
{
    return window_;
}

BView* BView::FindView(const char* name)
{
    if (std::string_view(name) == Name())
        return this;
    for (BView* child : children_) {
        if (BView* found = child->FindView(name))
            return found;
    }
    return nullptr;
}

BView* BView::viewAround(const QWidget& inner)
{
    if (widget_ != &inner && !widget_->isAncestorOf(&inner))
        return nullptr;
    for (BView* child : children_) {
        if (BView* found = child->viewAround(inner))
            return found;
    }
    return this;
}

void BView::setWindow(BWindow* window)
{
    if (window == window_)
        return;
    window_ = window;
    if (window != nullptr)
        AttachedToWindow();
    for (BView* child : children_)
        child->setWindow(window);
}

// --- Place and size.

void BView::placeWidget()
{
    widget_->setGeometry(whole(frame_.left), whole(frame_.top), whole(frame_.Width()), whole(frame_.Height()));
}

BPoint BView::ConvertToScreen(BPoint where) const
{
    const QPointF place = widget_->mapToGlobal(QPointF(where.x, where.y));
    return {static_cast<float>(place.x()), static_cast<float>(place.y())};
}

void BView::MoveTo(float x, float y)
{
    frame_ = frame_.OffsetToCopy(x, y);
    placeWidget();
}

void BView::ResizeTo(float width, float height)
{
    const float dx = width - frame_.Width();
    const float dy = height - frame_.Height();
    if (dx == 0 && dy == 0)
        return;
    frame_.right += dx;
    frame_.bottom += dy;
    placeWidget();
    for (BView* child : children_)
        child->followParent(dx, dy);
    if ((flags_ & B_FRAME_EVENTS) != 0)
        FrameResized(width, height);
}

void BView::followParent(float dx, float dy)
{
    const auto follows = [this](uint32 sides) { return (resizingMode_ & sides) == sides; };
    const float right = follows(B_FOLLOW_RIGHT) ? dx : 0;
    const float bottom = follows(B_FOLLOW_BOTTOM) ? dy : 0;
    const float left = follows(B_FOLLOW_LEFT) ? 0 : right;
    const float top = follows(B_FOLLOW_TOP) ? 0 : bottom;
    MoveTo(frame_.left + left, frame_.top + top);
    ResizeTo(frame_.Width() + right - left, frame_.Height() + bottom - top);
}

void BView::Hide()
{
    hidden_ = true;
    widget_->setVisible(false);
}

void BView::Show()
{
    hidden_ = false;
    widget_->setVisible(parent_ != nullptr || window_ != nullptr);
}

bool BView::IsHidden() const
{
    return hidden_ || (parent_ != nullptr && parent_->IsHidden());
}

// --- Keyboard focus and what assistive tools say.

void BView::MakeFocus(bool focus)
{
    if (focus)
        widget_->setFocus(Qt::OtherFocusReason);
    else
        widget_->clearFocus();
}

bool BView::IsFocus() const
{
    return widget_->hasFocus();
}

void BView::SetAccessibleName(const char* text)
{
    widget_->setAccessibleName(QString::fromUtf8(text));
}

void BView::SetToolTip(const char* text)
{
    widget_->setToolTip(QString::fromUtf8(text));
}

// --- Hooks.

void BView::Draw(BRect) {}
void BView::DrawOver(BRect) {}
void BView::MenuRequested(BPoint) {}
void BView::FrameResized(float, float) {}
void BView::MouseUp(BPoint) {}
void BView::MouseMoved(BPoint, bool) {}
void BView::KeyDown(const char*, int32) {}

void BView::MouseDown(BPoint)
{
    if ((flags_ & B_NAVIGABLE) != 0)
        MakeFocus();
}

// --- Drawing.

void BView::drawAll()
{
    canvas_->drawAll([this] {
        if ((flags_ & B_WILL_DRAW) != 0)
            Draw(Bounds());
    });
}

void BView::paintOn(QPainter& screen)
{
    bool fresh = false;
    canvas_->picture(&fresh);
    if (fresh)
        drawAll();
    screen.drawPixmap(0, 0, canvas_->picture(&fresh));
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
    if (widget_->isVisible())
        widget_->repaint();
}

void BView::SetViewColor(rgb_color color)
{
    canvas_->view = color;
    Invalidate();
}

rgb_color BView::ViewColor() const
{
    return canvas_->view;
}

void BView::SetHighColor(rgb_color color)
{
    canvas_->high = color;
}

rgb_color BView::HighColor() const
{
    return canvas_->high;
}

void BView::SetLowColor(rgb_color color)
{
    canvas_->low = color;
}

rgb_color BView::LowColor() const
{
    return canvas_->low;
}

void BView::SetPenSize(float size)
{
    canvas_->penSize = size;
}

float BView::PenSize() const
{
    return canvas_->penSize;
}

void BView::SetDrawingMode(drawing_mode mode)
{
    canvas_->mode = mode;
}

void BView::SetFont(const BFont* font, uint32 mask)
{
    if ((mask & B_FONT_FAMILY_AND_STYLE) != 0)
        canvas_->font.SetBold(font->IsBold());
    if ((mask & B_FONT_SIZE) != 0)
        canvas_->font.SetSize(font->Size());
}

void BView::SetFontSize(float size)
{
    const BFont font(size, false);
    SetFont(&font, B_FONT_SIZE);
}

void BView::GetFont(BFont* font) const
{
    *font = canvas_->font;
}

float BView::StringWidth(const char* text) const
{
    return canvas_->font.StringWidth(text);
}

void BView::FillRect(BRect rect, pattern p)
{
    canvas_->paint([&](QPainter& painter) { painter.fillRect(toQt(rect), canvas_->color(p)); });
}

void BView::StrokeRect(BRect rect, pattern p)
{
    const float pen = canvas_->penSize;
    FillRect({rect.left, rect.top, rect.right, rect.top + pen}, p);
    FillRect({rect.left, rect.bottom - pen, rect.right, rect.bottom}, p);
    FillRect({rect.left, rect.top + pen, rect.left + pen, rect.bottom - pen}, p);
    FillRect({rect.right - pen, rect.top + pen, rect.right, rect.bottom - pen}, p);
}

namespace {

/// A line along the pixels is a filled rectangle, which no smoothing blurs.
void strokeLine(QPainter& painter, BPoint from, BPoint to, float pen, const QColor& color)
{
    if (from.x == to.x || from.y == to.y) {
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

void strokePolygon(QPainter& painter, const BPoint* points, int32 count, bool closed, float pen, const QColor& color)
{
    painter.setRenderHint(QPainter::Antialiasing);
    painter.setPen(QPen(color, pen, Qt::SolidLine, Qt::RoundCap, Qt::RoundJoin));
    painter.setBrush(Qt::NoBrush);
    if (closed)
        painter.drawPolygon(polygon(points, count));
    else
        painter.drawPolyline(polygon(points, count));
}

} // namespace

void BView::StrokeLine(BPoint from, BPoint to, pattern p)
{
    canvas_->paint([&](QPainter& painter) { strokeLine(painter, from, to, canvas_->penSize, canvas_->color(p)); });
}

void BView::BeginLineArray(int32 count)
{
    lines_ = std::make_unique<LineArray>();
    lines_->points.reserve(static_cast<std::size_t>(count) + 1);
}

void BView::AddLine(BPoint from, BPoint to, rgb_color color)
{
    if (lines_ == nullptr)
        return;
    constexpr std::size_t kLongest = 16; // of a stroke: the time for one grows faster than its length
    auto& points = lines_->points;
    if (points.empty() || points.size() > kLongest || !(points.back() == from) || !(lines_->color == color))
        flushLines();
    if (points.empty())
        points.push_back(from);
    points.push_back(to);
    lines_->color = color;
}

void BView::EndLineArray()
{
    flushLines();
    lines_.reset();
}

void BView::flushLines()
{
    auto& points = lines_->points;
    canvas_->paint([&](QPainter& painter) {
        const QColor color = canvas_->color(lines_->color);
        if (points.size() == 2)
            strokeLine(painter, points[0], points[1], canvas_->penSize, color);
        else if (!points.empty())
            strokePolygon(painter, points.data(), static_cast<int32>(points.size()), false, canvas_->penSize, color);
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

void BView::StrokePolygon(const BPoint* points, int32 count, bool closed, pattern p)
{
    canvas_->paint(
        [&](QPainter& painter) { strokePolygon(painter, points, count, closed, canvas_->penSize, canvas_->color(p)); });
}

void BView::FillTriangle(BPoint a, BPoint b, BPoint c, pattern p)
{
    const BPoint corners[] = {a, b, c};
    FillPolygon(corners, 3, p);
}

void BView::FillArc(BPoint center, float xRadius, float yRadius, float startAngle, float arcAngle, pattern p)
{
    canvas_->paint([&](QPainter& painter) {
        constexpr float kUnitsPerDegree = 16;
        painter.setRenderHint(QPainter::Antialiasing);
        painter.setPen(Qt::NoPen);
        painter.setBrush(canvas_->color(p));
        painter.drawPie(QRectF(center.x - xRadius, center.y - yRadius, 2 * xRadius, 2 * yRadius),
                        whole(startAngle * kUnitsPerDegree), whole(arcAngle * kUnitsPerDegree));
    });
}

void BView::DrawString(const char* text, BPoint where)
{
    canvas_->paint([&](QPainter& painter) {
        painter.setFont(canvas_->font.toQt());
        painter.setPen(canvas_->color(B_SOLID_HIGH));
        painter.drawText(QPointF(where.x, where.y), QString::fromUtf8(text));
    });
}
