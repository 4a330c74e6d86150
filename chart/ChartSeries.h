#pragma once

#include "chart/ChartScale.h"
#include "platform/GraphicsDefs.h"

#include <optional>
#include <span>
#include <string>
#include <vector>

class GraphElement;
class GraphPoint;

/// What one element of a chart shows, in numbers.
struct ChartSeries {
    enum class Shape : short { kLine = 1, kPolygon = 2, kPoint = 3 }; // by `GraphElement::getType`

    Shape shape = Shape::kLine;
    rgb_color color;
    float penSize = 1;
    std::string name;               // in the key; empty for none
    std::vector<ChartPoint> points; // those that have a place on the chart, in the element's order
    bool isCutAtStart = false;      // the first point is where the line was cut, and none of the element's
    bool isCutAtEnd = false;

    /// Without where the line was cut.
    std::span<const ChartPoint> ownPoints() const
    {
        const std::size_t first = isCutAtStart ? 1 : 0;
        return std::span(points).subspan(first, points.size() - first - (isCutAtEnd ? 1 : 0));
    }
};

/// The defined ones of `elements` that have a place on a chart that goes by dates or by numbers: no undefined date, no
/// value that is infinite or not a number. A line or polygon leaves such points out. The points of a line ascend in x;
/// one that goes in steps has its corners among them.
std::vector<ChartSeries> seriesOf(std::span<GraphElement* const> elements, bool isDateBased);

/// The x of all points.
ChartRange rangeOf(std::span<const ChartSeries> all);

/// What of `all` lies within `range`, which is not empty: lines and polygons are cut at its ends. What has nothing in
/// it is left out.
std::vector<ChartSeries> cropped(std::vector<ChartSeries> all, const ChartRange& range);

/// The value of a line at `x`, on the way between two of its points; of any other series, that of its point there.
/// Nothing beyond its ends.
std::optional<double> valueAt(const ChartSeries& series, double x);

/// The series that a chart is about: the first line, or the first of all where there is none; null without any.
const ChartSeries* mainSeries(std::span<const ChartSeries> all);

/// The name of a line or polygon in the key; a point that stands alone has none.
std::string legendOf(const GraphElement& element);

/// The coordinates of `point`, which are not finite where it has no place.
ChartPoint chartPointOf(const GraphPoint& point, bool isDateBased);
bool hasPlace(const ChartPoint& point);

/// The points of an element: of a point, itself. `single` is room for that, and has to outlive the result.
std::span<GraphPoint* const> pointsOf(GraphElement& element, GraphPoint*& single);
