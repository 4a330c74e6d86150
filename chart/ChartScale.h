#pragma once

#include "platform/Rect.h"

#include <algorithm>
#include <limits>

/// A stretch of an axis: values, numbers or days (see ChartDays.h).
struct ChartRange {
    double min = std::numeric_limits<double>::infinity(); // above max: holds nothing yet
    double max = -std::numeric_limits<double>::infinity();

    bool isEmpty() const { return min > max; }
    double length() const { return max - min; }
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
    /// Neither range nor the area has length 0.
    ChartScale(const ChartRange& x, const ChartRange& y, const BRect& area) : x_(x), y_(y), area_(area) {}

    float pixelX(double x) const
    {
        return static_cast<float>(area_.left + (x - x_.min) / x_.length() * static_cast<double>(area_.Width()));
    }
    float pixelY(double y) const
    {
        return static_cast<float>(area_.bottom - (y - y_.min) / y_.length() * static_cast<double>(area_.Height()));
    }
    BPoint pixel(const ChartPoint& p) const { return {pixelX(p.x), pixelY(p.y)}; }

    double x(float pixelX) const
    {
        return x_.min + static_cast<double>(pixelX - area_.left) / static_cast<double>(area_.Width()) * x_.length();
    }
    double y(float pixelY) const
    {
        return y_.min + static_cast<double>(area_.bottom - pixelY) / static_cast<double>(area_.Height()) * y_.length();
    }

    /// Pixels to a unit of the x axis.
    double pixelsPerX() const { return static_cast<double>(area_.Width()) / x_.length(); }

private:
    ChartRange x_{0, 1};
    ChartRange y_{0, 1};
    BRect area_{0, 0, 1, 1};
};
