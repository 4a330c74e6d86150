#pragma once

#include "chart/ChartLayout.h"

/// The room above the highest and below the lowest value: for their labels, unless the plot is too low for that.
float marksInset(const ChartContents& contents, const BRect& plot);

/// The first of the highest and of the lowest values, each with its number above or below, within the plot. Only one
/// of them when all values are the same, and no number where there is no room.
std::vector<ChartMark> placeMarks(const ChartContents& contents, const BRect& plot, const ChartScale& scale);
