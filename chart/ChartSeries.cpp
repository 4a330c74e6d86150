#include "chart/ChartSeries.h"

#include "chart/DateTicks.h"
#include "chart/GraphLine.h"
#include "chart/GraphPoint.h"
#include "chart/GraphPolygon.h"

#include <algorithm>
#include <cmath>

namespace {

ChartSeries::Shape shapeOf(const GraphElement& element)
{
    return static_cast<ChartSeries::Shape>(element.getType());
}

/// A corner wherever the value changes: it stays the same up to the day of the next one.
void addStep(std::vector<ChartPoint>& points, const ChartPoint& point)
{
    if (!points.empty() && points.back().y != point.y)
        points.push_back({point.x, points.back().y});
    points.push_back(point);
}

bool comesBefore(const ChartPoint& point, double x)
{
    return point.x < x;
}

bool comesBehind(double x, const ChartPoint& point)
{
    return x < point.x;
}

/// Where the line from `a` to `b` is at `x`.
ChartPoint between(const ChartPoint& a, const ChartPoint& b, double x)
{
    return {x, a.x == b.x ? b.y : a.y + (b.y - a.y) * ((x - a.x) / (b.x - a.x))};
}

void cropLine(ChartSeries& line, const ChartRange& range)
{
    const std::vector<ChartPoint> all = std::move(line.points);
    const auto first = std::lower_bound(all.begin(), all.end(), range.min, comesBefore);
    const auto end = std::upper_bound(first, all.end(), range.max, comesBehind);
    line.points.clear();
    // The whole line lies at one side of the range.
    if (first == all.end() || end == all.begin())
        return;
    line.points.reserve(static_cast<std::size_t>(end - first) + 2);
    line.isCutAtStart = first != all.begin() && first->x > range.min;
    if (line.isCutAtStart)
        line.points.push_back(between(*std::prev(first), *first, range.min));
    line.points.insert(line.points.end(), first, end);
    line.isCutAtEnd = end != all.end() && std::prev(end)->x < range.max;
    if (line.isCutAtEnd)
        line.points.push_back(between(*std::prev(end), *end, range.max));
}

/// Leaves the part of an outline for which `sign` times x is at most `sign` times `limit`.
void cropOutline(std::vector<ChartPoint>& corners, double limit, double sign)
{
    std::vector<ChartPoint> inside;
    for (std::size_t i = 0; i < corners.size(); ++i) {
        const ChartPoint& from = corners[i];
        const ChartPoint& to = corners[(i + 1) % corners.size()];
        const bool isFromInside = sign * from.x <= sign * limit;
        if (isFromInside)
            inside.push_back(from);
        if (isFromInside != (sign * to.x <= sign * limit))
            inside.push_back(between(from, to, limit));
    }
    corners = std::move(inside);
}

void crop(ChartSeries& series, const ChartRange& range)
{
    switch (series.shape) {
    case ChartSeries::Shape::kLine:
        return cropLine(series, range);
    case ChartSeries::Shape::kPolygon:
        cropOutline(series.points, range.max, 1);
        return cropOutline(series.points, range.min, -1);
    case ChartSeries::Shape::kPoint:
        std::erase_if(series.points, [&](const ChartPoint& p) { return p.x < range.min || p.x > range.max; });
    }
}

} // namespace

std::vector<ChartSeries> seriesOf(std::span<GraphElement* const> elements, bool isDateBased)
{
    std::vector<ChartSeries> all;
    for (GraphElement* element : elements) {
        if (element->isUndefined())
            continue;
        ChartSeries series{
            shapeOf(*element), element->getColor(), std::max<float>(element->getPenSize(), 1), legendOf(*element), {}};
        GraphPoint* single;
        const auto points = pointsOf(*element, single);
        const auto* line = dynamic_cast<const GraphLine*>(element);
        const bool isStepped = line != nullptr && line->isStepped();
        series.points.reserve(points.size());
        for (const GraphPoint* point : points) {
            const ChartPoint place = chartPointOf(*point, isDateBased);
            // Such a point leaves no gap: the line goes from its neighbour to its neighbour.
            if (!hasPlace(place))
                continue;
            if (isStepped)
                addStep(series.points, place);
            else
                series.points.push_back(place);
        }
        // What shows nothing has no place in the key, either.
        if (!series.points.empty())
            all.push_back(std::move(series));
    }
    return all;
}

ChartRange rangeOf(std::span<const ChartSeries> all)
{
    ChartRange range;
    for (const ChartSeries& series : all)
        for (const ChartPoint& point : series.points)
            range.include(point.x);
    return range;
}

std::vector<ChartSeries> cropped(std::vector<ChartSeries> all, const ChartRange& range)
{
    for (ChartSeries& series : all)
        crop(series, range);
    std::erase_if(all, [](const ChartSeries& series) { return series.points.empty(); });
    return all;
}

std::optional<double> valueAt(const ChartSeries& series, double x)
{
    if (series.shape == ChartSeries::Shape::kPolygon || series.points.empty())
        return std::nullopt;
    // Of several points of one x the last one counts.
    const auto next = std::upper_bound(series.points.begin(), series.points.end(), x, comesBehind);
    if (next == series.points.begin())
        return std::nullopt;
    const ChartPoint& before = *std::prev(next);
    if (before.x == x)
        return before.y;
    if (next == series.points.end())
        return std::nullopt;
    return between(before, *next, x).y;
}

const ChartSeries* mainSeries(std::span<const ChartSeries> all)
{
    const auto line = std::ranges::find(all, ChartSeries::Shape::kLine, &ChartSeries::shape);
    return line != all.end() ? &*line : all.empty() ? nullptr : &all.front();
}

ChartPoint chartPointOf(const GraphPoint& point, bool isDateBased)
{
    return {isDateBased ? dayNumber(point.getDateX()) : static_cast<double>(point.getX()),
            static_cast<double>(point.getY())};
}

std::string legendOf(const GraphElement& element)
{
    const auto* named = dynamic_cast<const GraphPolyElement*>(&element);
    return named != nullptr ? std::string(named->getLegend().bytes()) : std::string();
}

bool hasPlace(const ChartPoint& point)
{
    return std::isfinite(point.x) && std::isfinite(point.y);
}

std::span<GraphPoint* const> pointsOf(GraphElement& element, GraphPoint*& single)
{
    switch (shapeOf(element)) {
    case ChartSeries::Shape::kLine:
        return static_cast<GraphLine&>(element).points();
    case ChartSeries::Shape::kPolygon:
        return static_cast<GraphPolygon&>(element).points();
    case ChartSeries::Shape::kPoint:
        break;
    }
    // A single point is in no array that could be pointed to, so the caller lends the room for one.
    single = &static_cast<GraphPoint&>(element);
    return {&single, 1};
}
