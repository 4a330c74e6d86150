#include "chart/ChartLayout.h"
#include "chart/ValueFormat.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr float kSmallInset = 6;  // keeps the line off the plot's edges
constexpr float kMarkGap = 6;     // between a point's middle and its label
constexpr float kEdgeGap = 3;     // between a label and the plot's edges
constexpr float kFlagRoom = 10;   // what a triangle of a flag takes, off the line
constexpr float kPlotHeights = 5; // the plot is so many times as high as a label, at least

struct Extreme {
    const ChartSeries* series = nullptr;
    ChartPoint point;
};

/// The first line, or else everything: a band around a line would hide what the line itself reached.
std::vector<const ChartSeries*> markedSeries(const std::vector<ChartSeries>& series)
{
    std::vector<const ChartSeries*> all;
    for (const ChartSeries& one : series) {
        if (one.shape == ChartSeries::Shape::kLine)
            return {&one};
        all.push_back(&one);
    }
    return all;
}

void findExtremes(const std::vector<const ChartSeries*>& marked, Extreme* lowest, Extreme* highest)
{
    for (const ChartSeries* series : marked)
        for (const ChartPoint& point : series->ownPoints()) {
            // Of equal values the first one stays.
            if (lowest->series == nullptr || point.y < lowest->point.y)
                *lowest = {series, point};
            if (highest->series == nullptr || point.y > highest->point.y)
                *highest = {series, point};
        }
}

/// The label with its left end so that it stands within the plot; without text where it does not fit.
ChartText labelAt(const std::string& text, const ChartFont& font, float middle, float top, const BRect& plot)
{
    const float width = font.width(text);
    const float furthest = plot.right - kEdgeGap - width;
    // The plot is narrower than the label.
    if (furthest < plot.left + kEdgeGap)
        return {};
    return textAt(text, font, std::clamp(middle - width / 2, plot.left + kEdgeGap, furthest), top);
}

/// Whether a triangle of that shape stands above or below the label.
bool hasFlagNear(const std::vector<ChartFlagMark>& flags, ChartFlag::Shape shape, const BRect& label)
{
    constexpr float kHalfWidth = 6;
    return std::ranges::any_of(flags, [&](const ChartFlagMark& flag) {
        return flag.shape == shape && flag.where.x > label.left - kHalfWidth && flag.where.x < label.right + kHalfWidth;
    });
}

bool hasRoom(const ChartContents& contents, const BRect& plot)
{
    return plot.Height() >= kPlotHeights * contents.labelFont.height();
}

} // namespace

std::vector<ChartFlagMark> placeFlagMarks(const ChartContents& contents, const ChartScale& scale)
{
    std::vector<ChartFlagMark> marks;
    float columns[] = {-1, -1, -1}; // where the last one of each shape stands
    for (const PlacedFlag& flag : contents.flags) {
        const BPoint where = scale.pixel(flag.where);
        float& column = columns[static_cast<std::size_t>(flag.shape)];
        if (std::floor(where.x) == column)
            continue;
        column = std::floor(where.x);
        marks.push_back({flag.shape, where});
    }
    return marks;
}

float marksInset(const ChartContents& contents, const BRect& plot)
{
    if (!hasRoom(contents, plot))
        return kSmallInset;
    return std::ceil(kMarkGap + contents.labelFont.height() + 2) + (contents.flags.empty() ? 0 : kFlagRoom);
}

std::vector<ChartMark> placeMarks(const ChartContents& contents, const BRect& plot, const ChartScale& scale,
                                  const std::vector<ChartFlagMark>& flags)
{
    Extreme lowest, highest;
    findExtremes(markedSeries(contents.series), &lowest, &highest);
    // The range lies between two of its points.
    if (lowest.series == nullptr)
        return {};
    const ValueFormat format = ValueFormat::forValues({lowest.point.y, highest.point.y});
    const ChartFont& font = contents.labelFont;
    std::vector<ChartMark> marks;
    const auto add = [&](const Extreme& extreme, float gap) {
        // The disc stands in any case, its number only where the plot is high enough.
        const BPoint where = scale.pixel(extreme.point);
        ChartMark mark{where, extreme.series->color, {}};
        if (hasRoom(contents, plot)) {
            mark.label = labelAt(format(extreme.point.y), font, where.x, where.y + gap, plot);
            const auto shape = gap < 0 ? ChartFlag::Shape::kDown : ChartFlag::Shape::kUp;
            if (hasFlagNear(flags, shape, mark.label.box))
                mark.label =
                    labelAt(mark.label.text, font, where.x, where.y + gap + std::copysign(kFlagRoom, gap), plot);
        }
        marks.push_back(mark);
    };
    add(highest, -kMarkGap - std::ceil(font.height()));
    if (lowest.point.y < highest.point.y)
        add(lowest, kMarkGap);
    return marks;
}
