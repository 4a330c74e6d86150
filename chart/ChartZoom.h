#pragma once

#include "chart/ChartScale.h"

/// Which part of its x axis a chart shows, while its data changes.
///
/// What a person has asked for is kept, and what is shown is the part of it that there is data for: all of the data
/// when there is too little of it. So a range stays on its days whatever company is shown, and is there again behind
/// one that has no quotes in it. An end that lay at the end of the data stays there when data is added, and the last
/// months always end at the last day.
class ChartZoom {
public:
    /// `bounds` are the x of all data, `least` is the shortest range that is worth showing. To be called before
    /// anything is asked of it, and again when the data may have changed.
    void setBounds(const ChartRange& bounds, double least);
    const ChartRange& bounds() const { return bounds_; }
    /// Within the bounds.
    ChartRange shown() const;
    bool isAll() const { return shown() == bounds_; }

    void showAll() { wish_ = {}; }
    void show(const ChartRange& range) { show(range.min, range.max); }
    /// The last so many months of a calendar axis, up to the last day; `months` is above 0.
    void showLast(int months) { wish_ = {.months = months}; }
    /// The number of months that `showLast` was given; 0 when something else was asked for since.
    int lastMonths() const { return wish_.months; }
    /// Makes the range `factor` times as long; `x` keeps its place in it as long as the bounds allow.
    void zoom(double x, double factor);
    /// Moves the range as far as the bounds allow.
    void pan(double by);

private:
    static constexpr double kEnd = std::numeric_limits<double>::infinity();
    struct Wish {
        double min = -kEnd; // the beginning of the data, wherever that is
        double max = kEnd;
        int months = 0; // counts instead of the two when it is above 0
    };
    void show(double min, double max);
    ChartRange wished() const;

    ChartRange bounds_;
    double least_ = 0;
    Wish wish_;
};
