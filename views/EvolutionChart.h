#pragma once

#include "chart/GraphLine.h"
#include "chart/GraphView.h"

#include <string>
#include <vector>

struct EvolutionPoint;

/// The chart of a portfolio's total value from day to day, and of what was put into it: deposits make both rise, and
/// what lies between the two is gained or lost. The read-out says how much.
class EvolutionChart final : public GraphView {
public:
    enum class Medium { kScreen, kPaper };

    /// On paper there is nothing to press.
    explicit EvolutionChart(BRect frame, Medium medium = Medium::kScreen);

    /// Shows these days, in the currency of that symbol.
    void showPoints(const std::vector<EvolutionPoint>& points, const std::string& symbol);
    /// Shows no days.
    void showNothing();

private:
    void addReadOutRows(std::vector<ReadOutRow>& rows) const override;

    GraphLine value_; // these are in the chart; the first one is marked with its extremes
    GraphLine putIn_;
};
