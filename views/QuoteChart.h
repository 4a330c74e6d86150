#pragma once

#include "chart/GraphLine.h"
#include "chart/GraphPolygon.h"
#include "chart/GraphView.h"
#include "foundation/Date.h"

#include <cstdint>
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
    /// `flags` are marked on the quotes. What is shown already is not filled in again.
    template <class Series>
    void showSeries(const Series& series, const std::string& name, const std::string& unit, bool withBand,
                    std::vector<ChartFlag> flags)
    {
        if (!changeTo({series.revision(), name, unit, withBand, std::move(flags)}))
            return;
        std::vector<Day> days;
        days.reserve(series.getNbrQuotes());
        for (const auto* quote : series.quotes()) {
            const Date date = quote->getDate();
            days.push_back({date, quote->getValue(), series.getPrevisionQuote(date)});
        }
        fill(days);
    }
    /// Shows no quotes.
    void showNothing() { changeTo({0, "", "???", false, {}}); }

private:
    struct Day {
        Date date;
        float value;
        float trend;
    };
    /// What a picture is made of. The revision stands for the quotes, and with them for the trend.
    struct Content {
        std::uint64_t revision = 0; // that of no series
        std::string name;
        std::string unit;
        bool withBand = false;
        std::vector<ChartFlag> flags;
        bool operator==(const Content&) const = default;
    };

    /// Empties the chart and takes over name and unit; the caller then fills it. @return false, with nothing done,
    /// when it shows this content already.
    bool changeTo(const Content& content);
    void fill(const std::vector<Day>& days);
    void fillBand(const std::vector<Day>& days);

    Content shown_;
    GraphPolygon band_; // these are in the chart, the last one in front
    GraphLine line_;
    GraphLine trend_;
};
