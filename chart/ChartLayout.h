#pragma once

#include "chart/ChartFlag.h"
#include "chart/ChartSeries.h"
#include "chart/ChartText.h"

#include <optional>
#include <vector>

/// What is to be shown, and in how much room.
struct ChartContents {
    BRect bounds;
    std::vector<ChartSeries> series; // at least one
    bool isDateBased = false;
    std::string xLegend;
    std::string yLegend;
    ChartFont labelFont;
    ChartFont legendFont;
    ChartRange x;                  // what is shown; when it is empty, all that there is
    bool goesOnBefore = false;     // whether there is more of it at that side
    bool goesOnBehind = false;     //
    std::vector<PlacedFlag> flags; // by x; those that are shown
    ChartFlagStyles flagStyles;    // the key has those with a name
    BRect controls{0, 0, 0, 0};    // what is taken at the right upper corner; nothing when it has no width
};

/// The lowest or the highest value, with its number.
struct ChartMark {
    BPoint where;
    rgb_color color;
    ChartText label;
};

/// A flag in pixels.
struct ChartFlagMark {
    ChartFlag::Shape shape;
    BPoint where; // on the line
};

/// One line of the key: a sample of what an element or a flag looks like, and its name.
struct ChartKeyEntry {
    ChartSeries::Shape shape;
    std::optional<ChartFlag::Shape> flag; // counts instead of the shape
    rgb_color color;
    float penSize;
    BRect sample;
    ChartText name;
};

/// Where everything on a chart stands. No text reaches out of the bounds or into another one.
///
/// From top to bottom: the unit of the values at the left, the key at the right, beside the controls; the plot with the
/// value axis at its left, the labels of the x axis, and what that axis stands for. What finds no room is left out; on
/// a chart that is too small for axes the plot takes it all.
struct ChartLayout {
    BRect plot; // on whole pixels
    ChartScale scale;
    std::vector<float> columns; // where the grid's upright lines stand
    std::vector<float> rows;    // and the level ones
    std::vector<float> zero;    // the line of value 0, where it divides the values
    std::vector<ChartText> labels;
    std::vector<ChartText> legends;
    std::vector<ChartKeyEntry> key;
    std::vector<ChartMark> marks; // of the first line; of everything where there is none
    std::vector<ChartFlagMark> flags;

    bool hasAxes() const { return !rows.empty() || !columns.empty(); }
};

ChartLayout layOutChart(const ChartContents& contents);

// Parts of that, in ChartMarks.cpp.
/// Of flags of one shape that fall into one column of pixels only the first, which covers the others.
std::vector<ChartFlagMark> placeFlagMarks(const ChartContents& contents, const ChartScale& scale);

/// The room above the highest and below the lowest value: for their labels, unless the plot is too low for that.
float marksInset(const ChartContents& contents, const BRect& plot);

/// The first of the highest and of the lowest values, each with its number above or below, within the plot. Only one
/// of them when all values are the same, and no number where there is no room.
/// Their numbers stand beyond the triangles of flags.
std::vector<ChartMark> placeMarks(const ChartContents& contents, const BRect& plot, const ChartScale& scale,
                                  const std::vector<ChartFlagMark>& flags);
