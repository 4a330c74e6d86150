#include "chart/ChartSeries.h"

#include "chart/ChartDays.h"
#include "chart/GraphLine.h"
#include "chart/GraphPoint.h"
#include "chart/GraphPolygon.h"

#include <algorithm>
#include <cmath>

namespace {

ChartSeries::Shape shapeOf(const GraphElement& element)
{
    if (element.getType() == GraphLine::kType)
        return ChartSeries::Shape::kLine;
    return element.getType() == GraphPolygon::kType ? ChartSeries::Shape::kPolygon : ChartSeries::Shape::kPoint;
}

} // namespace

std::vector<ChartSeries> seriesOf(GraphElement* const* elements, unsigned count, bool isDateBased)
{
    std::vector<ChartSeries> all;
    for (unsigned i = 0; i < count; ++i) {
        GraphElement& element = *elements[i];
        if (element.isUndefined())
            continue;
        ChartSeries series{
            shapeOf(element), element.getColor(), std::max<float>(element.getPenSize(), 1), legendOf(element), {}};
        unsigned n;
        GraphPoint* single;
        GraphPoint* const* points = pointsOf(element, &n, &single);
        series.points.reserve(n);
        for (unsigned k = 0; k < n; ++k)
            if (const ChartPoint point = chartPointOf(*points[k], isDateBased); hasPlace(point))
                series.points.push_back(point);
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
    if (element.getType() == GraphPoint::kType)
        return {};
    return std::string(static_cast<const GraphPolyElement&>(element).getLegend().bytes());
}

bool hasPlace(const ChartPoint& point)
{
    return std::isfinite(point.x) && std::isfinite(point.y);
}

GraphPoint* const* pointsOf(GraphElement& element, unsigned* count, GraphPoint** single)
{
    switch (shapeOf(element)) {
    case ChartSeries::Shape::kLine:
        return static_cast<GraphLine&>(element).getAllGraphPoints(count);
    case ChartSeries::Shape::kPolygon:
        return static_cast<GraphPolygon&>(element).getAllGraphPoints(count);
    case ChartSeries::Shape::kPoint:
        break;
    }
    *single = &static_cast<GraphPoint&>(element);
    *count = 1;
    return single;
}
