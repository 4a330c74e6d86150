#include "views/ColumnHeading.h"

#include "chart/ChartText.h"
#include "views/ColumnListView.h"
#include "views/Look.h"

#include <algorithm>
#include <cmath>
#include <utility>

namespace {

constexpr float kGrip = 4;       // pixels at either side of a separator
constexpr float kArrowRoom = 10; // pixels
constexpr float kSmallest = 16;  // width of a column
constexpr auto kDoubleClick = std::chrono::milliseconds(400);

} // namespace

ColumnHeading::ColumnHeading(BRect frame, ColumnListView& list)
    : BView(frame, "", B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW), list_(list)
{
    SetViewColor(look::kHeading);
    SetFont(be_bold_font, B_FONT_FAMILY_AND_STYLE);
    SetFontSize(11);
}

void ColumnHeading::Draw(BRect)
{
    // The heading is as wide as the list with its scroll bar, the columns are not. It scrolls sideways with the list.
    const BRect bounds = Bounds();
    float left = -list_.LeftEdge();
    for (std::size_t i = 0; i < list_.columns().size(); ++i) {
        if (list_.columns()[i].isHidden)
            continue;
        drawTitle(i, left);
        left += list_.columns()[i].width;
        SetHighColor(look::kLine);
        // Behind the last column there is the scroll bar of the list, and no line.
        if (left < bounds.right - look::kScrollBar)
            FillRect({left - 1, 3, left, bounds.bottom - 3});
    }
    SetHighColor(look::kHeading);
    FillRect({bounds.right - look::kScrollBar, 0, bounds.right, bounds.bottom}); // a title that is scrolled there
    SetHighColor(look::kLine);
    FillRect({0, bounds.bottom - 1, bounds.right, bounds.bottom});
}

float ColumnHeading::titleRoom(std::size_t column) const
{
    return list_.columns()[column].textWidth() - (list_.sortedBy() == column ? kArrowRoom : 0);
}

std::string ColumnHeading::toolTipAt(float x) const
{
    const auto column = columnAt(x);
    if (!column)
        return {};
    const std::string& title = list_.columns()[*column].title;
    return StringWidth(title.c_str()) > titleRoom(*column) ? title : "";
}

void ColumnHeading::drawTitle(std::size_t column, float left)
{
    ListColumn shown = list_.columns()[column];
    // The arrow stands beside the title, on the side that the title leaves.
    if (list_.sortedBy() == column) {
        const bool isAtRight = shown.align != B_ALIGN_RIGHT;
        drawArrow(isAtRight ? left + shown.width - kArrowRoom - 2 : left + 2, list_.isDescending());
        shown.width -= kArrowRoom;
        left += isAtRight ? 0 : kArrowRoom;
    }
    SetHighColor(look::kText);
    const TextWidth widthOf = [this](const std::string& text) { return StringWidth(text.c_str()); };
    shown.drawText(*this, fitText(shown.title, widthOf, titleRoom(column)), left, baseLine(*this, Bounds()));
}

void ColumnHeading::drawArrow(float left, bool isDown)
{
    constexpr float kSize = 8;
    const float middle = Bounds().Height() / 2;
    const float tip = middle + (isDown ? 3.0F : -3.0F);
    const float base = middle + (isDown ? -2.0F : 2.0F);
    const BPoint points[] = {{left, base}, {left + kSize, base}, {left + kSize / 2, tip}};
    SetHighColor(look::kText);
    FillPolygon(points, 3);
}

std::optional<std::size_t> ColumnHeading::separatorAt(float x) const
{
    float end = -list_.LeftEdge();
    std::optional<std::size_t> found;
    for (std::size_t i = 0; i < list_.columns().size(); ++i) {
        end += list_.columns()[i].shownWidth();
        // Of two that are as near, the later one: its column may have been made very small.
        if (!list_.columns()[i].isHidden && std::abs(end - x) <= kGrip)
            found = i;
    }
    return found;
}

std::optional<std::size_t> ColumnHeading::columnAt(float x) const
{
    float end = -list_.LeftEdge();
    for (std::size_t i = 0; i < list_.columns().size(); ++i) {
        end += list_.columns()[i].shownWidth();
        if (x < end)
            return i;
    }
    return std::nullopt;
}

void ColumnHeading::MouseDown(BPoint where)
{
    const auto separator = separatorAt(where.x);
    if (!separator) {
        pressed_ = columnAt(where.x);
        return;
    }
    const auto now = Clock::now();
    const bool isDouble = lastSeparator_ == separator && now - lastPress_ < kDoubleClick;
    lastSeparator_ = separator;
    lastPress_ = now;
    if (isDouble)
        list_.fitColumn(*separator);
    else
        drag_ = {*separator, list_.columns()[*separator].width - where.x};
}

void ColumnHeading::MouseMoved(BPoint where, bool inside)
{
    if (drag_)
        list_.setColumnWidth(drag_->column, std::max(where.x + drag_->offset, kSmallest));
    if (const std::string tip = toolTipAt(where.x); tip != toolTip_) {
        toolTip_ = tip;
        SetToolTip(tip.c_str());
    }
    SetMovesSideways(drag_.has_value() || (inside && separatorAt(where.x).has_value()));
}

void ColumnHeading::MouseUp(BPoint where)
{
    drag_.reset();
    const auto pressed = std::exchange(pressed_, std::nullopt);
    // Who lets go elsewhere has thought better of it.
    const bool isInside = where.y >= 0 && where.y < Bounds().Height();
    if (pressed && isInside && columnAt(where.x) == pressed && list_.isSortable())
        list_.sortBy(*pressed);
}
