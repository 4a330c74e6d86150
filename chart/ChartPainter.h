#pragma once

#include "chart/ChartLayout.h"
#include "chart/ChartReadOut.h"
#include "platform/View.h"

/// Draws what a layout has found a place for.
class ChartPainter {
public:
    // What names and values are written in, and what the axes are labelled in.
    static constexpr double kTextInk = 0.85;
    static constexpr double kLabelInk = 0.65;
    /// `background` moved by `share` towards black, or towards white when it is dark.
    static rgb_color ink(rgb_color background, double share);

    /// Draws on `view`, in colours that can be read on `background`. Leaves the view's drawing mode at B_OP_COPY.
    ChartPainter(BView& view, rgb_color background);

    void fillBackground();
    /// A text in place of a chart.
    void drawNotice(const char* text, BPoint where, float size);
    /// From back to front: grid, the elements in the order of their series, lowest and highest value, flags, texts. The
    /// axes come before the first element that is no polygon: areas behind all else lie below them.
    void drawChart(const ChartLayout& layout, const ChartContents& contents);
    /// A frame around the chart that has the keyboard.
    void drawFocus();
    /// What is being selected, from `left` to `right`.
    void drawSelection(const BRect& plot, float left, float right);
    void drawReadOut(const ChartReadOut& readOut, const BRect& plot);

private:
    void drawGrid(const ChartLayout& layout);
    void drawAxes(const ChartLayout& layout);
    void drawElement(const ChartSeries& series, const ChartScale& scale);
    void drawPolygon(const ChartSeries& series, const ChartScale& scale);
    void drawLine(const ChartSeries& series, const ChartScale& scale);
    void drawFlag(ChartFlag::Shape shape, BPoint where, rgb_color color);
    void drawMark(const ChartMark& mark);
    void drawDisc(const ChartReadOut::Disc& disc);
    void drawKeyEntry(const ChartKeyEntry& entry);
    void drawText(const ChartText& text, rgb_color color);
    void drawOutlinedText(const ChartText& text);
    void fillDisc(BPoint center, float radius, rgb_color color);
    void setAreaColor(rgb_color color);

    BView& view_;
    rgb_color background_;
    rgb_color text_;
    rgb_color label_;
    rgb_color axis_;
    rgb_color grid_;
};
