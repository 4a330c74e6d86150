#pragma once

#include "chart/ChartLayout.h"

#include <optional>

/// One line of what a chart says of a day: a name and a value, in the colour of what has it.
struct ReadOutRow {
    std::string name;
    double value;
    std::optional<rgb_color> color; // none for what is not drawn
};

/// What a chart says of one day or number: an upright line there, a disc on each line that it crosses, and a box with
/// the day, the values and what has happened.
struct ChartReadOut {
    struct Disc {
        BPoint where;
        rgb_color color;
    };
    float x = 0;
    std::vector<Disc> discs;
    BRect box; // beside the line, within the chart
    std::vector<ChartText> texts;
    std::vector<Disc> samples; // before the names, within the box
};

/// The x that a read-out beside `x` is about: that of the flag that is nearest, if it is at most `reach` away, and
/// otherwise that of the nearest point of the main series. Nothing where there is none.
std::optional<double> readOutPlace(const ChartContents& contents, double x, double reach);

/// The next x that a read-out can be about, before `x` when `isBack` is set, else behind it; `x` itself at the end.
double nextReadOutPlace(const ChartContents& contents, double x, bool isBack);

/// A row for each series that has a value at `x`.
std::vector<ReadOutRow> readOutRows(const ChartContents& contents, double x);

/// The read-out at `x` with these rows and the texts of the flags there.
ChartReadOut layOutReadOut(const ChartContents& contents, const ChartLayout& layout, double x,
                           const std::vector<ReadOutRow>& rows);
