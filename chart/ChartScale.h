#pragma once

#include "platform/Rect.h"

#include <algorithm>
#include <limits>

/// A stretch of an axis: values, numbers or days (see DateTicks.h).
struct ChartRange {
    double min = std::numeric_limits<double>::infinity(); // above max: holds nothing yet
    double max = -std::numeric_limits<double>::infinity();

    bool isEmpty() const { return min > max; }
    double length() const { return max - min; }
    bool operator==(const ChartRange&) const = default;
    void include(double value)
    {
        min = std::min(min, value);
        max = std::max(max, value);
    }
    void include(const ChartRange& range)
    {
        include(range.min);
        include(range.max);
    }
};

/// A place on a chart, in the units of its axes.
struct ChartPoint {
    double x = 0;
    double y = 0;
};

/// Maps a chart's two ranges onto a rectangle of the view, and back. Values grow upwards.
class ChartScale {
public:
    ChartScale() = default;
    /// Neither range has length 0.
    ChartScale(const ChartRange& x, const ChartRange& y, const BRect& area)
        : left_(area.left), bottom_(area.bottom), minX_(x.min), minY_(y.min),
          perX_(static_cast<double>(area.Width()) / x.length()), perY_(static_cast<double>(area.Height()) / y.length())
    {}

    float pixelX(double x) const { return static_cast<float>(left_ + (x - minX_) * perX_); }
    float pixelY(double y) const { return static_cast<float>(bottom_ - (y - minY_) * perY_); }
    BPoint pixel(const ChartPoint& p) const { return {pixelX(p.x), pixelY(p.y)}; }

    double x(float pixelX) const { return minX_ + (static_cast<double>(pixelX) - left_) / perX_; }
    double y(float pixelY) const { return minY_ + (bottom_ - static_cast<double>(pixelY)) / perY_; }

    /// Pixels to a unit of the x axis.
    double pixelsPerX() const { return perX_; }

private:
    double left_ = 0; // in pixels
    double bottom_ = 1;
    double minX_ = 0; // in units of the axes
    double minY_ = 0;
    double perX_ = 1; // pixels to a unit
    double perY_ = 1;
};
