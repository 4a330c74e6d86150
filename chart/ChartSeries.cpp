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
        series.points.reserve(points.size());
        for (const GraphPoint* point : points)
            // Such a point leaves no gap: the line goes from its neighbour to its neighbour.
            if (const ChartPoint place = chartPointOf(*point, isDateBased); hasPlace(place))
                series.points.push_back(place);
        // What shows nothing has no place in the key, either.
        if (!series.points.empty())
            all.push_back(std::move(series));
    }
    return all;
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
