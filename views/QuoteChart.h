#pragma once

#include "chart/GraphLine.h"
#include "chart/GraphPolygon.h"
#include "chart/GraphView.h"
#include "foundation/Date.h"

#include <string>
#include <vector>

/// The chart of a series of quotes: a line through them, their trend over the same days, and, if asked for, a band
/// about the trend.
class QuoteChart final : public GraphView {
public:
    explicit QuoteChart(BRect frame);

    /// Shows the quotes of a `QuoteSeries` under `name`, in the unit `unit`. The band reaches one standard deviation
    /// of the quotes from the trend to both sides:
    ///     sqrt(sum((p - trend)^2) / n), in the unit of the quotes.
    /// What is shown already is not filled in again.
    template <class Series>
    void showSeries(const Series& series, const std::string& name, const std::string& unit, bool withBand)
    {
        std::vector<Day> days;
        unsigned n;
        const auto* quotes = series.getAllQuotes(&n);
        days.reserve(n);
        for (unsigned i = 0; i < n; ++i) {
            const Date& date = quotes[i]->getDate();
            days.push_back({date, quotes[i]->getValue(), series.getPrevisionQuote(date)});
        }
        showContent({std::move(days), name, unit, withBand});
    }
    /// Shows no quotes.
    void showNothing() { showContent({{}, "", "???", false}); }

private:
    struct Day {
        Date date;
        float value;
        float trend;
        bool operator==(const Day&) const = default;
    };
    struct Content {
        std::vector<Day> days;
        std::string name;
        std::string unit;
        bool withBand = false;
        bool operator==(const Content&) const = default;
    };

    void showContent(Content content);
    void fill();
    void fillBand();

    Content shown_;
    GraphPolygon band_; // these are in the chart, the last one in front
    GraphLine line_;
    GraphLine trend_;
};
