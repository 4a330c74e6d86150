#pragma once

#include "chart/ChartSeries.h"
#include "chart/ChartText.h"

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
};

/// The lowest or the highest value, with its number.
struct ChartMark {
    BPoint where;
    rgb_color color;
    ChartText label;
};

/// One line of the key: a sample of what an element looks like, and its name.
struct ChartKeyEntry {
    ChartSeries::Shape shape;
    rgb_color color;
    float penSize;
    BRect sample;
    ChartText name;
};

/// Where everything on a chart stands. No text reaches out of the bounds or into another one.
///
/// From top to bottom: the unit of the values at the left with the key at the right, the plot with the value axis at
/// its left, the labels of the x axis, and what that axis stands for. What finds no room is left out; on a chart that
/// is too small for axes the plot takes it all.
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

    bool hasAxes() const { return !rows.empty() || !columns.empty(); }
};

ChartLayout layOutChart(const ChartContents& contents);

// A part of that, in ChartMarks.cpp.
/// The room above the highest and below the lowest value: for their labels, unless the plot is too low for that.
float marksInset(const ChartContents& contents, const BRect& plot);

/// The first of the highest and of the lowest values, each with its number above or below, within the plot. Only one
/// of them when all values are the same, and no number where there is no room.
std::vector<ChartMark> placeMarks(const ChartContents& contents, const BRect& plot, const ChartScale& scale);
