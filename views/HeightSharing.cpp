#include "views/HeightSharing.h"

#include "chart/GraphView.h"
#include "platform/Box.h"
#include "platform/TextView.h"
#include "views/ColumnListView.h"
#include "views/Look.h"

#include <algorithm>
#include <cmath>
#include <utility>

namespace {

constexpr float kFewestRows = 3 * look::kListRow + 2;
constexpr float kLowestChart = 90;
constexpr float kLowestText = 24;    // a line of it
constexpr float kUsualGap = 10;      // more is room that nobody needs
constexpr float kClosestGap = 0.35F; // of a usual one
constexpr float kTitle = 3;          // that the titles of boxes, and what is above all others, can do without

/// What `view` comes down to; its own height for one that does not give way.
float lowest(const BView& view)
{
    const float height = view.Frame().Height();
    if (dynamic_cast<const ColumnListView*>(&view) != nullptr)
        return std::min(height, kFewestRows);
    if (dynamic_cast<const GraphView*>(&view) != nullptr)
        return std::min(height, kLowestChart);
    if (dynamic_cast<const BTextView*>(&view) != nullptr)
        return std::min(height, kLowestText);
    return height;
}

} // namespace

HeightSharing::Row::Row(Member first, float end)
{
    // The one above all others is of use: a title stands there, or what is drawn.
    const float above = first.frame.top - end;
    const float easy = end > 0 ? std::min(above, kUsualGap) : above;
    gap = {above, easy, easy > kUsualGap ? easy - kTitle : std::ceil(easy * kClosestGap)};
    frame = first.frame;
    add(std::move(first));
}

void HeightSharing::Row::add(Member member)
{
    const Length& h = member.height;
    const float above = member.frame.top - frame.top; // nobody in the row stands higher than the first one
    frame.bottom = std::max(frame.bottom, member.frame.bottom);
    height = {frame.Height(), std::max(height.easy, above + h.easy), std::max(height.closest, above + h.closest)};
    members.push_back(std::move(member));
}

HeightSharing::Column::Column(std::vector<Member> members, float height)
{
    std::ranges::sort(members, {}, [](const Member& m) { return m.frame.top; });
    for (Member& member : members) {
        const float end = rows.empty() ? 0 : rows.back().frame.bottom;
        if (rows.empty() || member.frame.top >= end)
            rows.emplace_back(std::move(member), end);
        else
            rows.back().add(std::move(member));
    }
    const float below = height - rows.back().frame.bottom;
    sum = {below, std::min(below, kUsualGap), std::ceil(std::min(below, kUsualGap) * kClosestGap)};
    for (const Row& row : rows) {
        for (const Length& length : {row.gap, row.height}) {
            sum.whole += length.whole;
            sum.easy += length.easy;
            sum.closest += length.closest;
        }
    }
}

void HeightSharing::Column::share(float height) const
{
    // Each gives the same part of what it has to give.
    const auto part = [](float missing, float all) { return all > 0 ? std::clamp(missing / all, 0.0F, 1.0F) : 0; };
    const float first = part(sum.whole - height, sum.whole - sum.easy);
    const float last = part(sum.easy - height, sum.easy - sum.closest);
    float end = 0;
    for (const Row& row : rows) {
        const float top = end + row.gap.given(first, last);
        end = top + row.height.given(first, last);
        for (const Member& member : row.members) {
            // Whole pixels, which do not add up to more.
            const float begin = std::round(top) + member.frame.top - row.frame.top;
            const float room = std::round(end) - begin;
            const bool givesWay = member.height.closest < member.height.whole;
            const float shown = givesWay ? std::min(room, member.frame.Height()) : member.frame.Height();
            member.view->MoveTo(member.frame.left, begin);
            member.view->ResizeTo(member.frame.Width(), shown);
            if (member.inside != nullptr)
                member.inside->share(shown);
        }
    }
}

HeightSharing::HeightSharing(const BView& view, float height)
{
    std::vector<Member> members;
    for (int32 i = 0; i < view.CountChildren(); ++i)
        members.push_back(memberOf(*view.ChildAt(i)));
    std::ranges::sort(members, {}, [](const Member& m) { return m.frame.left; });
    // What overlaps from left to right, also by way of others, is in one column.
    std::vector<Member> column;
    float right = 0;
    for (Member& member : members) {
        if (!column.empty() && member.frame.left >= right)
            columns_.emplace_back(std::exchange(column, {}), height);
        right = column.empty() ? member.frame.right : std::max(right, member.frame.right);
        column.push_back(std::move(member));
    }
    if (!column.empty())
        columns_.emplace_back(std::move(column), height);
}

HeightSharing::~HeightSharing() = default;

HeightSharing::Member HeightSharing::memberOf(BView& view)
{
    const float height = view.Frame().Height();
    if (dynamic_cast<BBox*>(&view) == nullptr)
        return {&view, view.Frame(), {height, lowest(view), lowest(view)}, nullptr};
    Member box{&view, view.Frame(), {height, 0, 0}, std::make_unique<HeightSharing>(view, height)};
    for (const Column& column : box.inside->columns_) {
        box.height.easy = std::max(box.height.easy, column.sum.easy);
        box.height.closest = std::max(box.height.closest, column.sum.closest);
    }
    return box;
}

float HeightSharing::least() const
{
    float most = 0;
    for (const Column& column : columns_)
        most = std::max(most, column.sum.closest);
    return most;
}

void HeightSharing::share(float height) const
{
    for (const Column& column : columns_)
        column.share(height);
}
