#include "chart/ColumnReduction.h"

#include <cmath>

namespace {

/// Neighbours in one column.
class Run {
public:
    explicit Run(std::size_t first) : first_(first), lowest_(first), highest_(first), last_(first) {}

    void add(std::size_t i, const std::vector<BPoint>& pixels)
    {
        if (pixels[i].y > pixels[lowest_].y)
            lowest_ = i;
        if (pixels[i].y < pixels[highest_].y)
            highest_ = i;
        last_ = i;
    }

    /// Moves what stays to the places from `end` on, which are none behind its own. @return the end of these.
    std::size_t moveTo(std::size_t end, std::vector<BPoint>& pixels) const
    {
        std::size_t previous = first_;
        // In the order of the line. One point may be first, lowest and last at once, and then stays once.
        pixels[end++] = pixels[first_];
        for (const std::size_t i : {std::min(lowest_, highest_), std::max(lowest_, highest_), last_}) {
            if (i != previous)
                pixels[end++] = pixels[i];
            previous = i;
        }
        return end;
    }

private:
    std::size_t first_;
    std::size_t lowest_;
    std::size_t highest_;
    std::size_t last_;
};

} // namespace

std::vector<BPoint> reduceByColumn(std::span<const ChartPoint> points, const ChartScale& scale)
{
    std::vector<BPoint> pixels;
    pixels.reserve(points.size());
    for (const ChartPoint& point : points)
        pixels.push_back(scale.pixel(point));
    std::size_t end = 0;
    for (std::size_t i = 0; i < pixels.size();) {
        Run run(i);
        const float left = std::floor(pixels[i].x);
        const float right = left + 1;
        for (++i; i < pixels.size() && pixels[i].x >= left && pixels[i].x < right; ++i)
            run.add(i, pixels);
        // What stays moves to the front of `pixels`: `end` never passes the points still to be looked at.
        end = run.moveTo(end, pixels);
    }
    // Behind `end` stand points that have been dropped or moved.
    pixels.resize(end);
    return pixels;
}
