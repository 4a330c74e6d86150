#pragma once

#include "chart/ChartScale.h"
#include "platform/GraphicsDefs.h"

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
};

/// The defined ones of `elements` that have a place on a chart that goes by dates or by numbers: no undefined date, no
/// value that is infinite or not a number. A line or polygon leaves such points out.
std::vector<ChartSeries> seriesOf(std::span<GraphElement* const> elements, bool isDateBased);

/// The name of a line or polygon in the key; a point that stands alone has none.
std::string legendOf(const GraphElement& element);

/// The coordinates of `point`, which are not finite where it has no place.
ChartPoint chartPointOf(const GraphPoint& point, bool isDateBased);
bool hasPlace(const ChartPoint& point);

/// The points of an element: of a point, itself. `single` is room for that, and has to outlive the result.
std::span<GraphPoint* const> pointsOf(GraphElement& element, GraphPoint*& single);
