#include "chart/ChartLayout.h"

#include "chart/DateTicks.h"

#include <cmath>

namespace {

constexpr float kMargin = 8;        // between the bounds and anything
constexpr float kRightMargin = 12;  // between the plot and the right side
constexpr float kLabelGap = 7;      // between an axis and its labels
constexpr float kLegendGap = 6;     // between a legend and what is next to it
constexpr float kTickGap = 18;      // between the labels of the x axis
constexpr float kDataInset = 6;     // between the plot's sides and the first and last point
constexpr float kSampleWidth = 16;  // in the key
constexpr float kSampleGap = 5;     // between a sample and its name
constexpr float kEntryGap = 16;     // between entries of the key
constexpr float kSmallestPlot = 30; // in either direction
constexpr float kKeyShare = 0.3F;   // of the height, at most

/// The steps of a layout, in their order. Each narrows the plot, beginning with the bounds.
///
/// `out_` fills from step to step, and each relies on what stands there: its plot begins as the bounds and only ever
/// becomes smaller. A chart that proves too small for axes drops all of it and begins again with a bare one.
class Layouter {
public:
    explicit Layouter(const ChartContents& contents) : in_(contents) {}

    ChartLayout run()
    {
        findRanges();
        placeHeader();
        placeFooter();
        if (!isLargeEnough())
            return bareChart();
        placeValueAxis();
        // The axis has taken room from the width.
        if (!isLargeEnough())
            return bareChart();
        // The top, the bottom and the left side of the plot are settled; the x axis may still move its sides inwards.
        placeXAxis();
        placeYLegend();
        out_.flags = placeFlagMarks(in_, out_.scale);
        out_.marks = placeMarks(in_, out_.plot, out_.scale, out_.flags);
        return out_;
    }

private:
    void findRanges()
    {
        for (const ChartSeries& series : in_.series)
            for (const ChartPoint& point : series.points) {
                x_.include(point.x);
                values_.include(point.y);
            }
        if (!in_.x.isEmpty())
            x_ = in_.x;
        // `values_` stays as found; `x_` and `y_` have a length above 0 from here on, as a scale needs.
        y_ = values_;
        widenEmpty(x_, in_.isDateBased ? 1 : std::abs(x_.min) / 10);
        widenEmpty(y_, std::abs(y_.min) / 20);
        out_.plot = {std::ceil(in_.bounds.left), std::ceil(in_.bounds.top), std::floor(in_.bounds.right),
                     std::floor(in_.bounds.bottom)};
    }

    /// A single value stands in the middle.
    static void widenEmpty(ChartRange& range, double by)
    {
        if (range.length() > 0)
            return;
        range.include({range.min - (by > 0 ? by : 1), range.max + (by > 0 ? by : 1)});
    }

    /// The x legend, and the key beside it or, where there is no room, below.
    void placeHeader()
    {
        // At the height of the controls' labels, where there are any.
        const float spare = in_.controls.bottom - in_.bounds.top - kLegendGap - in_.legendFont.height();
        const float top = in_.bounds.top + kLegendGap + std::max(std::floor(spare / 2), 0.0F);
        float bottom = top;
        float left = in_.bounds.left + kMargin;
        // It names the values although it is called after x. Intended: the pages set it to the unit of the values,
        // so it stands above the value axis, where a reader looks for that.
        const std::string legend = fitText(in_.xLegend, in_.legendFont.width, headerEnd() - left);
        if (!legend.empty()) {
            const ChartText text = textAt(legend, in_.legendFont, left, top);
            out_.legends.push_back(text);
            bottom = text.box.bottom;
            left = text.box.right + kEntryGap;
        }
        bottom = std::max({bottom, placeKey(left, top, bottom), in_.controls.bottom});
        out_.plot.top = std::ceil(bottom + kLegendGap);
    }

    float rightEnd() const { return in_.bounds.right - kMargin; }
    /// In the uppermost row, which ends at the controls.
    float headerEnd() const { return in_.controls.Width() > 0 ? in_.controls.left - kEntryGap : rightEnd(); }

    float entryWidth(const std::string& name) const
    {
        return std::ceil(kSampleWidth + kSampleGap + in_.legendFont.width(name));
    }

    /// An entry that has no place yet.
    struct Named {
        std::string name;
        ChartKeyEntry entry;
    };

    /// The series that have a name, one of each, and the flags.
    std::vector<Named> keyEntries() const
    {
        constexpr std::size_t kMostEntries = 12;
        std::vector<Named> named;
        for (const ChartSeries& series : in_.series)
            if (!series.name.empty() && named.size() < kMostEntries &&
                std::ranges::find(named, series.name, &Named::name) == named.end())
                named.push_back({series.name, {series.shape, {}, series.color, series.penSize, {}, {}}});
        for (std::size_t i = 0; i < in_.flagStyles.size(); ++i)
            if (const auto& [color, name] = in_.flagStyles[i]; !name.empty())
                named.push_back({name, {{}, static_cast<ChartFlag::Shape>(i), color, 1, {}, {}}});
        return named;
    }

    /// @return the lower end of the key.
    float placeKey(float left, float top, float below)
    {
        const std::vector<Named> named = keyEntries();
        if (named.empty())
            return top;
        // There is no gap behind the last entry.
        float width = -kEntryGap;
        for (const Named& one : named)
            width += entryWidth(one.name) + kEntryGap;
        // Beside the legend where all of it has room in one row; otherwise below, in as many rows as it takes.
        if (left + width <= headerEnd())
            return placeKeyRows(named, headerEnd() - width, top);
        below = std::max(below, in_.controls.bottom);
        return placeKeyRows(named, in_.bounds.left + kMargin, below > top ? below + kLegendGap / 2 : top);
    }

    float placeKeyRows(const std::vector<Named>& named, float left, float top)
    {
        const float height = std::ceil(in_.legendFont.height());
        float x = left;
        for (const Named& one : named) {
            const std::string name =
                fitText(one.name, in_.legendFont.width, rightEnd() - left - kSampleWidth - kSampleGap);
            // An entry that is alone in its row and still too long has been cut above.
            if (x > left && x + entryWidth(name) > rightEnd()) {
                x = left;
                top += height;
            }
            // The key never takes the room of the plot: what is left of it is dropped.
            if (name.empty() || top + height > in_.bounds.top + in_.bounds.Height() * kKeyShare)
                break;
            ChartKeyEntry entry = one.entry;
            entry.sample = BRect(x, top, x + kSampleWidth, top + height);
            entry.name = textAt(name, in_.legendFont, x + kSampleWidth + kSampleGap, top);
            out_.key.push_back(entry);
            x += entryWidth(name) + kEntryGap;
        }
        return out_.key.empty() ? top : out_.key.back().sample.bottom;
    }

    void placeFooter()
    {
        // Room for the labels in any case: whether there are any is known only when the width is.
        out_.plot.bottom -= std::ceil(kLabelGap + in_.labelFont.height() + kLegendGap / 2);
        if (!in_.yLegend.empty())
            out_.plot.bottom -= std::ceil(in_.legendFont.height() + kLegendGap / 2);
    }

    bool isLargeEnough() const { return out_.plot.Width() >= kSmallestPlot && out_.plot.Height() >= kSmallestPlot; }

    ChartLayout bareChart() const
    {
        ChartLayout bare;
        // What was placed so far is dropped: a new layout has neither legends nor key.
        bare.plot = in_.bounds;
        const float inset = std::min({2.0F, in_.bounds.Width() / 4, in_.bounds.Height() / 4});
        const BRect area = in_.bounds.InsetByCopy(inset, inset);
        bare.scale = ChartScale(x_, y_, area);
        return bare;
    }

    /// Where the data goes: within the plot, so that neither a line nor the numbers of its extremes touch an axis.
    /// Where there is more of it beyond a side, it reaches up to there.
    BRect dataArea() const
    {
        BRect area = out_.plot.InsetByCopy(0, marksInset(in_, out_.plot));
        area.left += in_.goesOnBefore ? 0 : kDataInset;
        area.right -= in_.goesOnBehind ? 0 : kDataInset;
        return area;
    }

    /// Finds the round values and makes room for the widest at the left.
    void placeValueAxis()
    {
        const ChartScale scale(x_, y_, dataArea());
        // The axis is as long as the plot, beyond the lowest and the highest value.
        ChartRange shown{scale.y(out_.plot.bottom), scale.y(out_.plot.top)};
        if (values_.min >= 0) // no labels below 0 where nothing can be
            shown.min = std::max(shown.min, 0.0);
        else if (values_.max <= 0)
            shown.max = std::min(shown.max, 0.0);
        const double valuePerPixel = scale.y(0) - scale.y(1);
        std::vector<AxisTick> ticks;
        for (const double spread : {2.6, 1.8, 1.2}) { // labels stand closer where there would be only one
            ticks = numberTicks(shown, spread * static_cast<double>(in_.labelFont.height()) * valuePerPixel);
            if (ticks.size() > 1)
                break;
        }
        float widest = 0;
        for (const AxisTick& tick : ticks)
            widest = std::max(widest, in_.labelFont.width(tick.label));
        // The labels have their room now, but their places depend on the left side, which may still move:
        // `placeValueLabels` puts them.
        out_.plot.left = std::ceil(out_.plot.left + kMargin + widest + kLabelGap);
        out_.plot.right = std::floor(out_.plot.right - kRightMargin);
        for (const AxisTick& tick : ticks)
            placeValueLabel(tick, scale.pixelY(tick.value));
        if (values_.min < 0 && values_.max > 0)
            out_.zero.push_back(scale.pixelY(0));
    }

    void placeValueLabel(const AxisTick& tick, float y)
    {
        const float top = y - in_.labelFont.height() / 2;
        const ChartText text = textAt(tick.label, in_.labelFont, 0, top);
        if (text.box.top < out_.plot.top || text.box.bottom > out_.plot.bottom)
            return;
        // A grid line stands only where its value is written.
        out_.rows.push_back(y);
        // Placed from left to right when the left side is settled.
        valueLabels_.push_back({tick.label, top});
    }

    std::vector<AxisTick> xTicks(const ChartScale& scale) const
    {
        const ChartRange shown{scale.x(out_.plot.left), scale.x(out_.plot.right)};
        return in_.isDateBased ? levelDateTicks(shown, scale.pixelsPerX(), in_.labelFont.width, kTickGap)
                               : levelNumberTicks(shown, scale.pixelsPerX(), in_.labelFont.width, kTickGap);
    }

    /// Finds the round days or numbers, with so much room at the sides that the outer labels are not cut.
    void placeXAxis()
    {
        constexpr int kTries = 3; // other sides may mean other labels
        std::vector<AxisTick> ticks;
        for (int i = 0; i < kTries; ++i) {
            // Sides that have moved mean another scale, and with it other ticks.
            out_.scale = ChartScale(x_, y_, dataArea());
            ticks = xTicks(out_.scale);
            if (!widenMargins(ticks))
                break;
        }
        // The sides are settled now.
        placeValueLabels();
        const float top = out_.plot.bottom + kLabelGap;
        for (const AxisTick& tick : ticks) {
            const float x = out_.scale.pixelX(tick.value);
            const ChartText text = textAt(tick.label, in_.labelFont, x - in_.labelFont.width(tick.label) / 2, top);
            // Where the sides could not move far enough, the grid line goes with its label.
            if (text.box.left < in_.bounds.left || text.box.right > in_.bounds.right)
                continue;
            out_.columns.push_back(x);
            out_.labels.push_back(text);
        }
    }

    /// Moves the plot's sides inwards so that the outer labels stay within the bounds. @return whether it had to.
    bool widenMargins(const std::vector<AxisTick>& ticks)
    {
        if (ticks.empty())
            return false;
        const auto end = [this](const AxisTick& tick, float sign) {
            return out_.scale.pixelX(tick.value) + sign * in_.labelFont.width(tick.label) / 2;
        };
        const float left = std::ceil(in_.bounds.left + kMargin / 2 - end(ticks.front(), -1));
        const float right = std::ceil(end(ticks.back(), 1) + kMargin / 2 - in_.bounds.right);
        if (left <= 0 && right <= 0)
            return false;
        // Either both sides move, or the plot would become too small and stays as it was.
        const BRect before = out_.plot;
        out_.plot.left += std::max(left, 0.0F);
        out_.plot.right -= std::max(right, 0.0F);
        if (isLargeEnough())
            return true;
        out_.plot = before;
        return false;
    }

    void placeValueLabels()
    {
        for (const auto& [label, top] : valueLabels_)
            out_.labels.push_back(
                textAt(label, in_.labelFont, out_.plot.left - kLabelGap - in_.labelFont.width(label), top));
    }

    void placeYLegend()
    {
        const ChartFont& font = in_.legendFont;
        const std::string legend = fitText(in_.yLegend, font.width, out_.plot.right - in_.bounds.left - kMargin);
        if (legend.empty())
            return;
        // Below the labels of the axis, in the room that `placeFooter` has kept.
        const float top = out_.plot.bottom + kLabelGap + std::ceil(in_.labelFont.height());
        out_.legends.push_back(textAt(legend, font, out_.plot.right - font.width(legend), top + kLegendGap / 2));
    }

    struct ValueLabel {
        std::string text;
        float top;
    };

    const ChartContents& in_;
    ChartLayout out_;
    ChartRange x_;
    ChartRange y_;
    ChartRange values_; // without what a single one is widened by
    std::vector<ValueLabel> valueLabels_;
};

} // namespace

ChartLayout layOutChart(const ChartContents& contents)
{
    return Layouter(contents).run();
}
