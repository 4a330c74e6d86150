#include "views/QuoteChart.h"

#include "chart/GraphPoint.h"
#include "views/Look.h"

#include <cmath>

namespace {

void add(GraphPolyElement& element, const Date& date, double value)
{
    element.addGraphPoint(new GraphPoint(date, static_cast<float>(value)));
}

} // namespace

QuoteChart::QuoteChart(BRect frame) : GraphView(frame, "grvQuotes")
{
    SetAccessibleName("Quotes");
    setXDateBased(true);
    // In this order they lie above one another: the band at the back, the trend in front.
    const struct {
        GraphPolyElement& element;
        rgb_color color;
        const char* legend;
    } elements[] = {
        {band_, look::kBand, "Trend \u00B1 one standard deviation"},
        {line_, look::kSeries, ""}, // named after what it shows; the first line, whose extremes the chart marks
        {trend_, look::kTrend, "Trend"},
    };
    for (const auto& e : elements) {
        e.element.setDateBased(true);
        e.element.setColor(e.color);
        e.element.setLegend(e.legend);
        addGraphElement(&e.element);
    }
    addRangeButtons();
    showNothing();
}

bool QuoteChart::changeTo(const Content& content)
{
    if (content == shown_)
        return false;
    // From here on the caller owes the points that belong to this content.
    shown_ = content;
    // From here on there are no points at all, in the chart or in its elements.
    band_.clearAll();
    trend_.clearAll();
    line_.clearAll();
    removeAllGraphPoints();
    setXLegend(("Value in " + shown_.unit).c_str());
    setFlags(shown_.flags);
    line_.setLegend(shown_.name.empty() ? "Quotes" : shown_.name.c_str());
    Invalidate(); // what the caller fills in now shows with the next drawing
    return true;
}

void QuoteChart::fill(const std::vector<Day>& days)
{
    if (days.empty())
        return;
    if (days.front().date == days.back().date) {                           // no line, and no trend
        auto* point = new GraphPoint(days.back().date, days.back().value); // the chart's own
        point->setColor(look::kSeries);
        addGraphElement(point);
        return;
    }
    for (const Day& day : days)
        // The line owns its points; they come in order of their dates, and so need no sorting.
        add(line_, day.date, day.value);
    // The trend is a straight line: its ends are enough.
    for (const Day& day : {days.front(), days.back()})
        add(trend_, day.date, day.trend);
    if (shown_.withBand)
        fillBand(days);
}

void QuoteChart::fillBand(const std::vector<Day>& days)
{
    // In `double`, as a sum of thousands of squares in `float` would lose its last terms.
    double squares = 0;
    for (const Day& day : days) {
        const double distance = static_cast<double>(day.value) - day.trend;
        squares += distance * distance;
    }
    const double deviation = std::sqrt(squares / static_cast<double>(days.size()));
    // Round the trend: above it from the first day to the last, and below it back again.
    const Day& first = days.front();
    const Day& last = days.back();
    add(band_, first.date, first.trend + deviation);
    add(band_, last.date, last.trend + deviation);
    add(band_, last.date, last.trend - deviation);
    add(band_, first.date, first.trend - deviation);
}
