#include "platform/View.h"

#include "platform/Invoker.h"
#include "platform/Window.h"
#include "platform/qt/Canvas.h"
#include "platform/qt/ViewWidget.h"

#include <QWidget>

#include <cmath>

namespace {

int whole(float length)
{
    return static_cast<int>(std::lround(length));
}

} // namespace

BView::BView(BRect frame, const char* name, uint32 resizingMode, uint32 flags)
    : BView(frame, name, resizingMode, flags, new ViewWidget(*this))
{}

BView::BView(BRect frame, const char* name, uint32 resizingMode, uint32 flags, QWidget* widget)
    : BHandler(name), frame_(frame), resizingMode_(resizingMode), flags_(flags), widget_(widget),
      canvas_(std::make_unique<Canvas>(*widget, state_))
{
    widget_->setObjectName(QString::fromUtf8(Name()));
    if ((flags & B_NAVIGABLE) != 0)
        widget_->setFocusPolicy(Qt::StrongFocus);
    placeWidget();
}

BView::~BView()
{
    // Whoever destroys a view need not take it out of its parent before. After this nobody reaches the view or its
    // children any more.
    if (parent_ != nullptr)
        std::erase(parent_->children_, this);
    while (!children_.empty())
        delete children_.back(); // takes itself out
    // Only now: the children's widgets stood in it and would have gone with it.
    delete widget_;
}

void BView::AddChild(BView* child)
{
    // In this order: the widget has its parent and its place before it shows, and the view hears of its window when all
    // of that is done.
    children_.push_back(child);
    child->parent_ = this;
    child->widget_->setParent(childHost());
    child->placeWidget();
    child->widget_->setVisible(!child->hidden_);
    child->setWindow(window_);
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
    // A view without window may be put together for long before it gets one, and hears of it once.
    if (window == window_)
        return;
    window_ = window;
    // What sends messages sends them to its window, unless it was told of another target.
    auto* invoker = dynamic_cast<BInvoker*>(this);
    if (invoker != nullptr && !invoker->HasTarget())
        invoker->SetTarget(window);
    if (window != nullptr)
        AttachedToWindow();
    // After their parent, which may have added some of them just now. Those know already.
    for (BView* child : children_)
        child->setWindow(window);
}

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
    // Children follow by what the size has changed, so rounding does not add up.
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
    // A view that follows both sides grows, one that follows only the far side moves, any other stays.
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
    // A widget without parent would show as a window of its own. `AddChild` shows it, unless it was hidden.
    widget_->setVisible(parent_ != nullptr || window_ != nullptr);
}

bool BView::IsFocus() const
{
    return widget_->hasFocus();
}

void BView::MakeFocus()
{
    widget_->setFocus(Qt::TabFocusReason);
}

void BView::SetMovesSideways(bool movesSideways)
{
    if (movesSideways)
        widget_->setCursor(Qt::SplitHCursor);
    else
        widget_->unsetCursor();
}

void BView::SetAccessibleName(const char* text)
{
    widget_->setAccessibleName(QString::fromUtf8(text));
}

void BView::SetToolTip(const char* text)
{
    widget_->setToolTip(QString::fromUtf8(text));
}
