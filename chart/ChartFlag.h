#pragma once

#include "chart/ChartScale.h"
#include "foundation/Date.h"
#include "platform/GraphicsDefs.h"

#include <array>
#include <span>
#include <string>
#include <vector>

/// Something that happened on a day, to be marked on the first line of a chart that goes by dates.
struct ChartFlag {
    enum class Shape : unsigned char { kUp, kDown, kDiamond };

    Shape shape;
    Date date;
    std::string text; // in the read-out
    bool operator==(const ChartFlag&) const = default;
};

/// The look of all flags of one shape: an upward triangle stands below the line, a downward one above it, a diamond on
/// it.
struct ChartFlagStyle {
    rgb_color color;
    std::string name; // in the key
};
using ChartFlagStyles = std::array<ChartFlagStyle, 3>; // by shape

/// A flag that has its place.
struct PlacedFlag {
    ChartFlag::Shape shape;
    ChartPoint where; // on the line
    std::string text;
};

struct ChartSeries;

/// The flags that have a place on `series`, by their days. Beyond its ends they stand as high as the end does: what
/// happened after the last quote is known before the next one. Those that would stretch the chart are left out: they
/// are more than a month and more than a tenth of its length away.
std::vector<PlacedFlag> placeFlags(std::span<const ChartFlag> flags, const ChartSeries& series);
