#pragma once

#include "chart/AxisTicks.h"
#include "platform/Rect.h"

#include <string>

/// The measures of one of a chart's two fonts, in pixels.
struct ChartFont {
    float size;
    float ascent;
    float descent;
    TextWidth width;

    float height() const { return ascent + descent; }
};

/// A text that has its place on a chart.
struct ChartText {
    std::string text;
    float size = 0; // of its font
    BPoint where;   // left end of the base line
    BRect box;      // what it takes
};

/// `text` with its upper left corner at (`left`, `top`).
ChartText textAt(const std::string& text, const ChartFont& font, float left, float top);

/// `text`, or as much of its beginning as fits into `width` with an ellipsis behind it; empty when nothing does.
/// Does not cut a UTF-8 character in two.
std::string fitText(const std::string& text, const TextWidth& widthOf, float width);
