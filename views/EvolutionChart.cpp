#include "views/EvolutionChart.h"

#include "chart/DateTicks.h"
#include "chart/GraphPoint.h"
#include "valuation/Evolution.h"
#include "views/Look.h"

#include <cmath>

EvolutionChart::EvolutionChart(BRect frame, Medium medium) : GraphView(frame, "grvEvolution")
{
    SetAccessibleName("Evolution of the total value");
    setXDateBased(true);
    const struct {
        GraphLine& line;
        rgb_color color;
        const char* legend;
    } lines[] = {{value_, look::kSeries, "Value"}, {putIn_, look::kPutIn, "Put in"}};
    for (const auto& l : lines) {
        l.line.setDateBased(true);
        l.line.setColor(l.color);
        l.line.setLegend(l.legend);
        // Once and for all: from here on only the points change.
        addGraphElement(&l.line);
    }
    putIn_.setStepped(true); // what is put in on a day was not there the day before
    if (medium == Medium::kScreen)
        addRangeButtons();
}

void EvolutionChart::showPoints(const std::vector<EvolutionPoint>& points, const std::string& symbol)
{
    showNothing();
    setXLegend(("Value in " + symbol).c_str());
    // The lines own their points.
    for (const EvolutionPoint& point : points) {
        value_.addGraphPoint(new GraphPoint(point.date, point.totalValue));
        putIn_.addGraphPoint(new GraphPoint(point.date, point.totalDeposit));
    }
    if (!points.empty())
        setBounds({dayNumber(points.front().date), dayNumber(points.back().date)});
}

std::pair<Date, Date> EvolutionChart::daysInView() const
{
    if (value_.getNbrGraphPoints() == 0)
        return {};
    const ChartRange range = shownRange();
    return {dateOfDay(std::ceil(range.min)), dateOfDay(std::floor(range.max))};
}

void EvolutionChart::RangeChanged()
{
    if (rangeHook_)
        rangeHook_();
}

void EvolutionChart::showNothing()
{
    // The chart keeps its lines, which have no points now, and so shows that there is no data.
    value_.clearAll();
    putIn_.clearAll();
    removeAllGraphPoints();
    setXLegend(String());
    Invalidate();
}

void EvolutionChart::addReadOutRows(std::vector<ReadOutRow>& rows) const
{
    if (rows.size() != 2)
        return;
    // In `float`, as the profit beside the chart is.
    const float gain = static_cast<float>(rows[0].value) - static_cast<float>(rows[1].value);
    rows.push_back({gain < 0 ? "Loss" : "Gain", gain < 0 ? -gain : gain, std::nullopt});
}
