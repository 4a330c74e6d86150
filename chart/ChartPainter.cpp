#include "chart/ChartPainter.h"

#include "chart/ColumnReduction.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr float kTickLength = 4;
constexpr float kMarkRadius = 3;

rgb_color opaque(rgb_color color)
{
    return {color.red, color.green, color.blue, 255};
}

float discRadius(float penSize)
{
    return penSize + 1;
}

} // namespace

rgb_color ChartPainter::ink(rgb_color background, double share)
{
    constexpr double kHalfBright = 128;
    // How bright an eye finds it: green counts most, blue least.
    const double brightness = 0.299 * background.red + 0.587 * background.green + 0.114 * background.blue;
    const double target = brightness < kHalfBright ? 255 : 0;
    const auto mix = [&](std::uint8_t component) {
        return static_cast<std::uint8_t>(component + (target - component) * share + 0.5);
    };
    return {mix(background.red), mix(background.green), mix(background.blue), 255};
}

ChartPainter::ChartPainter(BView& view, rgb_color background)
    : view_(view), background_(opaque(background)), text_(ink(background, kTextInk)),
      label_(ink(background, kLabelInk)), axis_(ink(background, 0.45)), grid_(ink(background, 0.1))
{
    view_.SetDrawingMode(B_OP_COPY);
}

void ChartPainter::fillBackground()
{
    // The low colour is used for this only.
    view_.SetLowColor(background_);
    view_.FillRect(view_.Bounds(), B_SOLID_LOW);
}

void ChartPainter::drawNotice(const char* text, BPoint where, float size)
{
    view_.SetFontSize(size);
    view_.SetHighColor(label_);
    view_.DrawString(text, where);
}

void ChartPainter::drawChart(const ChartLayout& layout, const ChartContents& contents)
{
    const std::vector<ChartSeries>& series = contents.series;
    // The elements keep their order: a later one covers an earlier one, whatever the two are.
    const auto isPolygon = [](const ChartSeries& one) { return one.shape == ChartSeries::Shape::kPolygon; };
    const auto front = std::ranges::find_if_not(series, isPolygon);
    const auto draw = [&](const ChartSeries& one) { drawElement(one, layout.scale); };
    drawGrid(layout);
    std::for_each(series.begin(), front, draw);
    drawAxes(layout);
    std::for_each(front, series.end(), draw);
    for (const ChartMark& mark : layout.marks)
        // Above all lines, since they are about the values themselves. The texts come last: nothing covers them.
        drawMark(mark);
    for (const ChartFlagMark& flag : layout.flags) // the disc of an extreme would hide a diamond
        drawFlag(flag.shape, flag.where, contents.flagStyles[static_cast<std::size_t>(flag.shape)].color);
    for (const ChartText& label : layout.labels)
        drawText(label, label_);
    for (const ChartText& legend : layout.legends)
        drawText(legend, text_);
    for (const ChartKeyEntry& entry : layout.key)
        drawKeyEntry(entry);
}

void ChartPainter::drawFocus()
{
    view_.SetPenSize(1);
    view_.SetHighColor(axis_);
    view_.StrokeRect(view_.Bounds());
}

void ChartPainter::drawSelection(const BRect& plot, float left, float right)
{
    rgb_color shade = text_;
    shade.alpha = 32;
    const BRect area(left, plot.top, right, plot.bottom);
    setAreaColor(shade);
    view_.FillRect(area);
    view_.SetDrawingMode(B_OP_COPY);
    view_.SetPenSize(1);
    view_.SetHighColor(axis_);
    view_.StrokeRect(area);
}

void ChartPainter::drawReadOut(const ChartReadOut& readOut, const BRect& plot)
{
    view_.SetPenSize(1);
    view_.SetHighColor(axis_);
    view_.StrokeLine({readOut.x, plot.top}, {readOut.x, plot.bottom});
    for (const ChartReadOut::Disc& disc : readOut.discs)
        drawDisc(disc);
    view_.SetHighColor(background_);
    view_.FillRect(readOut.box);
    view_.SetHighColor(axis_);
    view_.StrokeRect(readOut.box);
    for (const ChartReadOut::Disc& sample : readOut.samples)
        fillDisc(sample.where, kMarkRadius, sample.color);
    for (const ChartText& text : readOut.texts)
        drawText(text, text_);
}

void ChartPainter::drawDisc(const ChartReadOut::Disc& disc)
{
    // Three discs of falling size: a dark ring, a light one, and the point in its colour.
    fillDisc(disc.where, kMarkRadius + 2, text_);
    fillDisc(disc.where, kMarkRadius + 1, background_);
    fillDisc(disc.where, kMarkRadius, disc.color);
}

void ChartPainter::drawGrid(const ChartLayout& layout)
{
    const BRect& plot = layout.plot;
    view_.SetPenSize(1);
    view_.BeginLineArray(static_cast<int32>(layout.columns.size() + layout.rows.size()));
    for (const float x : layout.columns)
        view_.AddLine({x, plot.top}, {x, plot.bottom}, grid_);
    for (const float y : layout.rows)
        view_.AddLine({plot.left, y}, {plot.right, y}, grid_);
    view_.EndLineArray();
}

void ChartPainter::drawAxes(const ChartLayout& layout)
{
    if (!layout.hasAxes())
        return;
    const BRect& plot = layout.plot;
    view_.SetPenSize(1);
    view_.BeginLineArray(static_cast<int32>(layout.columns.size() + layout.rows.size() + layout.zero.size() + 2));
    // The two axes, the line of value 0, and a stroke outwards at each labelled value.
    view_.AddLine({plot.left, plot.top}, {plot.left, plot.bottom}, axis_);
    view_.AddLine({plot.left, plot.bottom}, {plot.right, plot.bottom}, axis_);
    for (const float y : layout.zero)
        view_.AddLine({plot.left, y}, {plot.right, y}, axis_);
    for (const float x : layout.columns)
        view_.AddLine({x, plot.bottom}, {x, plot.bottom + kTickLength}, axis_);
    for (const float y : layout.rows)
        view_.AddLine({plot.left - kTickLength, y}, {plot.left, y}, axis_);
    view_.EndLineArray();
}

void ChartPainter::drawElement(const ChartSeries& series, const ChartScale& scale)
{
    switch (series.shape) {
    case ChartSeries::Shape::kLine:
        return drawLine(series, scale);
    case ChartSeries::Shape::kPolygon:
        return drawPolygon(series, scale);
    case ChartSeries::Shape::kPoint:
        return fillDisc(scale.pixel(series.points.front()), discRadius(series.penSize), series.color);
    }
}

void ChartPainter::drawPolygon(const ChartSeries& series, const ChartScale& scale)
{
    // An outline has as many points as it has days. Of those in one column of pixels the extremes are enough.
    const std::vector<BPoint> corners = reduceByColumn(series.points, scale);
    setAreaColor(series.color);
    // The drawing mode is B_OP_ALPHA for a translucent polygon, and B_OP_COPY again after it.
    view_.FillPolygon(corners.data(), static_cast<int32>(corners.size()));
    view_.SetDrawingMode(B_OP_COPY);
}

void ChartPainter::drawLine(const ChartSeries& series, const ChartScale& scale)
{
    // The same for the line, so that drawing ten thousand days costs as much as drawing what is seen of them.
    const std::vector<BPoint> points = reduceByColumn(series.points, scale);
    if (points.size() == 1) { // the others have no place, or the same
        fillDisc(points.front(), discRadius(series.penSize), series.color);
        return;
    }
    view_.SetPenSize(series.penSize);
    view_.BeginLineArray(static_cast<int32>(points.size() - 1));
    for (std::size_t i = 1; i < points.size(); ++i) {
        const BPoint from = points[i - 1];
        // A level stretch in one piece: many short ones would be smoothed where they meet.
        while (i + 1 < points.size() && points[i].y == from.y && points[i + 1].y == from.y)
            ++i;
        view_.AddLine(from, points[i], opaque(series.color));
    }
    view_.EndLineArray();
}

void ChartPainter::drawFlag(ChartFlag::Shape shape, BPoint where, rgb_color color)
{
    // A shape of background below it, larger by a pixel or two, parts it from the lines that it is on.
    for (const float ring : {1.5F, 0.0F}) {
        std::vector<BPoint> corners;
        if (shape == ChartFlag::Shape::kDiamond) {
            const float half = 5 + ring;
            corners = {{0, -half}, {half, 0}, {0, half}, {-half, 0}};
        } else {
            constexpr float kTip = 4; // off the line
            constexpr float kFoot = 12;
            const float half = 4.5F + ring;
            corners = {{0, kTip - ring}, {half, kFoot + ring / 2}, {-half, kFoot + ring / 2}};
        }
        for (BPoint& corner : corners)
            corner = {where.x + corner.x, where.y + (shape == ChartFlag::Shape::kDown ? -corner.y : corner.y)};
        view_.SetHighColor(ring > 0 ? background_ : opaque(color));
        view_.FillPolygon(corners.data(), static_cast<int32>(corners.size()));
    }
}

void ChartPainter::drawMark(const ChartMark& mark)
{
    // A ring of background parts the point from the line that it is on.
    fillDisc(mark.where, kMarkRadius + 1, background_);
    fillDisc(mark.where, kMarkRadius, mark.color);
    if (!mark.label.text.empty())
        drawOutlinedText(mark.label);
}

/// Other lines may pass below a mark's label.
void ChartPainter::drawOutlinedText(const ChartText& text)
{
    if (view_.IsPrinting()) { // as text it would stand there five times
        view_.SetFontSize(text.size);
        view_.SetHighColor(background_);
        const float width = view_.StringWidth(text.text.c_str());
        view_.FillRect({text.where.x - 1, text.where.y - text.size, text.where.x + width + 1, text.where.y + 1});
        return drawText(text, text_);
    }
    for (const BPoint& shift : {BPoint(-1, -1), BPoint(1, -1), BPoint(-1, 1), BPoint(1, 1)}) {
        ChartText outline = text;
        outline.where = text.where + shift;
        drawText(outline, background_);
    }
    drawText(text, text_);
}

void ChartPainter::drawKeyEntry(const ChartKeyEntry& entry)
{
    const BRect& box = entry.sample;
    const float middle = std::round((box.top + box.bottom) / 2);
    if (entry.flag) {
        // A triangle stands off its line: the line would be above or below the sample.
        constexpr float kHalfTriangle = 8;
        const float line = *entry.flag == ChartFlag::Shape::kUp     ? middle - kHalfTriangle
                           : *entry.flag == ChartFlag::Shape::kDown ? middle + kHalfTriangle
                                                                    : middle;
        drawFlag(*entry.flag, {(box.left + box.right) / 2, line}, entry.color);
        return drawText(entry.name, text_);
    }
    switch (entry.shape) {
    case ChartSeries::Shape::kLine:
        view_.SetPenSize(entry.penSize);
        view_.SetHighColor(opaque(entry.color));
        view_.StrokeLine({box.left, middle}, {box.right, middle});
        break;
    case ChartSeries::Shape::kPolygon: {
        constexpr float kHalfHeight = 5;
        setAreaColor(entry.color);
        view_.FillRect({box.left, middle - kHalfHeight, box.right, middle + kHalfHeight});
        view_.SetDrawingMode(B_OP_COPY);
        break;
    }
    case ChartSeries::Shape::kPoint:
        fillDisc({(box.left + box.right) / 2, middle}, discRadius(entry.penSize), entry.color);
        break;
    }
    drawText(entry.name, text_);
}

void ChartPainter::drawText(const ChartText& text, rgb_color color)
{
    view_.SetFontSize(text.size);
    view_.SetHighColor(color);
    view_.DrawString(text.text.c_str(), text.where);
}

void ChartPainter::fillDisc(BPoint center, float radius, rgb_color color)
{
    view_.SetHighColor(opaque(color));
    view_.FillArc(center, radius, radius, 0, 360);
}

void ChartPainter::setAreaColor(rgb_color color)
{
    // Alpha 0 covers as 255 does: elements have it from the start.
    view_.SetDrawingMode(color.alpha == 0 || color.alpha == 255 ? B_OP_COPY : B_OP_ALPHA);
    view_.SetHighColor(color);
}
