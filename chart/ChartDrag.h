#pragma once

#include "chart/ChartScale.h"

#include <optional>

class ChartZoom;

/// What the pointer does to a chart's range while the left button is held: it selects a part of it, or moves it.
class ChartDrag {
public:
    enum class Kind { kSelect, kPan };

    /// `scale` is that of the chart as it was drawn last, `shown` its range.
    ChartDrag(Kind kind, BPoint where, const ChartScale& scale, const ChartRange& shown);

    /// Moves the range of `zoom` at once when that is what the drag is for.
    void moveTo(BPoint where, ChartZoom& zoom);
    /// What the pointer has passed over, the smaller end first; nothing as long as that may still be meant as a click.
    std::optional<ChartRange> selection() const;

private:
    Kind kind_;
    ChartScale scale_; // at the beginning: that of the chart moves along with it
    ChartRange shown_; // at the beginning
    float from_;
    float to_;
};
