#include "chart/ChartReadOut.h"

#include "chart/DateTicks.h"
#include "chart/ValueFormat.h"
#include "foundation/DateText.h"
#include "foundation/NumberText.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr float kPadding = 6;
constexpr float kDistance = 10; // from the line to the box
constexpr float kSample = 12;   // what the sample before a name takes
constexpr float kColumnGap = 14;
constexpr float kLeading = 2;
constexpr std::size_t kMostFlags = 5; // of one day

/// Cents where they matter, and more digits of what is small.
std::string valueText(double value)
{
    constexpr double kCents = 10;
    const bool isAmount = std::abs(value) >= kCents || value == 0;
    return isAmount ? amountText(value) : ValueFormat::forValues({value, value})(value);
}

/// Takes `x` into `nearest` when it is nearer to `to`.
void takeNearer(std::optional<double>& nearest, double x, double to)
{
    if (!nearest || std::abs(x - to) < std::abs(*nearest - to))
        nearest = x;
}

/// Of x in ascending order the one that is nearest to `to`.
template <class Places, class XOf>
std::optional<double> nearestOf(const Places& places, double to, XOf xOf)
{
    std::optional<double> nearest;
    const auto behind = std::ranges::lower_bound(places, to, {}, xOf);
    if (behind != places.end())
        takeNearer(nearest, xOf(*behind), to);
    if (behind != places.begin())
        takeNearer(nearest, xOf(*std::prev(behind)), to);
    return nearest;
}

/// The one next to `from`, if there is one.
template <class Places, class XOf>
std::optional<double> nextOf(const Places& places, double from, bool isBack, XOf xOf)
{
    const auto end =
        isBack ? std::ranges::lower_bound(places, from, {}, xOf) : std::ranges::upper_bound(places, from, {}, xOf);
    if (end == (isBack ? places.begin() : places.end()))
        return std::nullopt;
    return xOf(isBack ? *std::prev(end) : *end);
}

double xOfPoint(const ChartPoint& point)
{
    return point.x;
}

double xOfFlag(const PlacedFlag& flag)
{
    return flag.where.x;
}

std::span<const ChartPoint> placesOf(const ChartContents& contents)
{
    const ChartSeries* series = mainSeries(contents.series);
    return series != nullptr ? series->ownPoints() : std::span<const ChartPoint>();
}

/// What has happened at `x`; of much, the beginning and a number.
std::vector<std::string> flagTexts(const std::vector<PlacedFlag>& flags, double x)
{
    const auto here = std::ranges::equal_range(flags, x, {}, xOfFlag);
    std::vector<std::string> texts;
    for (const PlacedFlag& flag : here)
        if (texts.size() < kMostFlags)
            texts.push_back(flag.text);
    if (here.size() > kMostFlags)
        texts.push_back("and " + std::to_string(here.size() - kMostFlags) + " more");
    return texts;
}

/// Puts texts into a box, from top to bottom; the box gets its place at the end.
class BoxLayouter {
public:
    BoxLayouter(const ChartFont& font, float widest) : font_(font), widest_(widest - 2 * kPadding) {}

    void addLine(const std::string& text) { lines_.push_back({fitText(text, font_.width, widest_), "", {}}); }
    void addRow(const ReadOutRow& row)
    {
        const std::string value = valueText(row.value);
        const float room = widest_ - kSample - kColumnGap - font_.width(value);
        lines_.push_back({fitText(row.name, font_.width, room), value, row.color});
    }

    float width() const
    {
        float width = 0;
        for (const Line& line : lines_)
            width = std::max(width, widthOf(line));
        return std::ceil(width) + 2 * kPadding;
    }
    float height() const
    {
        return static_cast<float>(lines_.size()) * (rowHeight() + kLeading) - kLeading + 2 * kPadding;
    }

    void placeAt(float left, float top, ChartReadOut& out) const
    {
        out.box = {left, top, left + width(), top + height()};
        top += kPadding;
        for (const Line& line : lines_) {
            const bool isRow = !line.value.empty();
            const float nameLeft = left + kPadding + (isRow ? kSample : 0);
            if (line.color)
                out.samples.push_back({{left + kPadding + 3, std::round(top + rowHeight() / 2)}, *line.color});
            out.texts.push_back(textAt(line.name, font_, nameLeft, top));
            if (isRow)
                out.texts.push_back(textAt(line.value, font_, out.box.right - kPadding - font_.width(line.value), top));
            top += rowHeight() + kLeading;
        }
    }

private:
    struct Line {
        std::string name;
        std::string value; // at the right; empty for a text that stands alone
        std::optional<rgb_color> color;
    };
    float rowHeight() const { return std::ceil(font_.height()); }
    float widthOf(const Line& line) const
    {
        const float name = font_.width(line.name);
        return line.value.empty() ? name : kSample + name + kColumnGap + font_.width(line.value);
    }

    const ChartFont& font_;
    float widest_;
    std::vector<Line> lines_;
};

} // namespace

std::optional<double> readOutPlace(const ChartContents& contents, double x, double reach)
{
    const std::optional<double> flag = nearestOf(contents.flags, x, xOfFlag);
    if (flag && std::abs(*flag - x) <= reach)
        return flag;
    std::optional<double> point = nearestOf(placesOf(contents), x, xOfPoint);
    return point ? point : flag;
}

double nextReadOutPlace(const ChartContents& contents, double x, bool isBack)
{
    const std::optional<double> point = nextOf(placesOf(contents), x, isBack, xOfPoint);
    const std::optional<double> flag = nextOf(contents.flags, x, isBack, xOfFlag);
    if (point && flag)
        return isBack ? std::max(*point, *flag) : std::min(*point, *flag);
    return point.value_or(flag.value_or(x));
}

std::vector<ReadOutRow> readOutRows(const ChartContents& contents, double x)
{
    std::vector<ReadOutRow> rows;
    for (const ChartSeries& series : contents.series)
        if (const std::optional<double> value = valueAt(series, x))
            rows.push_back({series.name, *value, series.color});
    return rows;
}

ChartReadOut layOutReadOut(const ChartContents& contents, const ChartLayout& layout, double x,
                           const std::vector<ReadOutRow>& rows)
{
    ChartReadOut out;
    out.x = layout.scale.pixelX(x);
    BoxLayouter box(contents.legendFont, contents.bounds.Width());
    box.addLine(contents.isDateBased ? dateText(dateOfDay(x)) : valueText(x));
    for (const ReadOutRow& row : rows) {
        box.addRow(row);
        if (row.color)
            out.discs.push_back({layout.scale.pixel({x, row.value}), *row.color});
    }
    for (const std::string& text : flagTexts(contents.flags, x))
        box.addLine(text);
    // At the right of the line, unless the chart ends there; on a chart that is too small for it, at the left edge.
    float left = out.x + kDistance;
    if (left + box.width() > contents.bounds.right)
        left = out.x - kDistance - box.width();
    // In the half of the plot where the first line does not go, and higher where the box would not end within the
    // chart.
    const bool isLineLow = !out.discs.empty() && out.discs.front().where.y > (layout.plot.top + layout.plot.bottom) / 2;
    float top = isLineLow ? layout.plot.top + kPadding : layout.plot.bottom - kPadding - box.height();
    top = std::min(std::max(top, layout.plot.top + kPadding), contents.bounds.bottom - box.height());
    box.placeAt(std::floor(std::max(left, contents.bounds.left)), std::floor(top), out);
    return out;
}
