#pragma once

#include "chart/GraphLine.h"
#include "chart/GraphView.h"

#include <functional>
#include <string>
#include <utility>
#include <vector>

struct EvolutionPoint;

/// The chart of a portfolio's total value from day to day, and of what was put into it: deposits make both rise, and
/// what lies between the two is gained or lost. The read-out says how much.
class EvolutionChart final : public GraphView {
public:
    enum class Medium { kScreen, kPaper };

    /// On paper there is nothing to press.
    explicit EvolutionChart(BRect frame, Medium medium = Medium::kScreen);

    /// Shows these days, which come by date, in the currency of that symbol.
    void showPoints(const std::vector<EvolutionPoint>& points, const std::string& symbol);
    /// Shows no days.
    void showNothing();
    /// The first and the last of the days that are in view; undefined while it shows no days.
    std::pair<Date, Date> daysInView() const;
    /// `hook` is called when a person has changed which.
    void setRangeHook(const std::function<void()>& hook) { rangeHook_ = hook; }

private:
    void addReadOutRows(std::vector<ReadOutRow>& rows) const override;
    void RangeChanged() override;

    GraphLine value_; // these are in the chart; the first one is marked with its extremes
    GraphLine putIn_;
    std::function<void()> rangeHook_;
};
