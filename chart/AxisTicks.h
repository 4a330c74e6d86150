#pragma once

#include "chart/ChartScale.h"

#include <functional>
#include <string>
#include <vector>

/// A round value of an axis and what is written beside it.
struct AxisTick {
    double value;
    std::string label;
};

/// The width of a text, in pixels.
using TextWidth = std::function<float(const std::string&)>;

/// The values of `range` that are multiples of 1, 2 or 5 times a power of ten: of the smallest such step that is at
/// least `minStep`, which is above 0.
std::vector<AxisTick> numberTicks(const ChartRange& range, double minStep);

/// As many of these as stand side by side on a level axis of `pixelsPerUnit`, each label centred below its value with
/// at least `gap` pixels to the next.
std::vector<AxisTick> levelNumberTicks(const ChartRange& range, double pixelsPerUnit, const TextWidth& width,
                                       float gap);

/// Whether labels centred below the ticks keep `gap` pixels between them.
bool areLabelsApart(const std::vector<AxisTick>& ticks, double pixelsPerUnit, const TextWidth& width, float gap);
