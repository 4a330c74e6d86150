#pragma once

#include "chart/ChartText.h"
#include "platform/GraphicsDefs.h"

/// What a chart says of one point: the name of what it belongs to, its date or number, and its value.
struct ChartReadOut {
    BPoint where; // the point
    rgb_color color;
    BRect box; // beside it, within the chart
    ChartText text;
};

class GraphPoint;
class ChartScale;

/// The read-out of `point`, which has a place on the chart.
ChartReadOut layOutReadOut(const GraphPoint& point, bool isDateBased, const ChartScale& scale, const ChartFont& font,
                           const BRect& bounds);
