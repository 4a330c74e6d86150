#pragma once

#include "platform/PaperDocument.h"

#include <memory>
#include <optional>
#include <string>
#include <vector>

class WalletFigures;

/// The report of a portfolio on a day, to be read on paper: what it is worth and what it has brought, its accounts and
/// holdings, and the operations of a year with the sums that a tax adviser asks for. What there is nothing of is left
/// out.
class PortfolioReport {
public:
    /// `figures` outlives this; `name` is what the portfolio is called.
    PortfolioReport(const WalletFigures& figures, const std::string& name) : figures_(figures), name_(name) {}

    /// Those that there are operations of, the latest first.
    std::vector<int> years() const;
    /// With the operations of `year`, or with all.
    std::unique_ptr<PaperDocument> make(std::optional<int> year, PaperSize size) const;

private:
    void addTotals(PaperDocument& paper) const;
    void addChart(PaperDocument& paper) const;
    void addYear(PaperDocument& paper, std::optional<int> year) const;
    /// Whether returns and gains begin behind the first operation.
    bool isLater() const;
    bool hasEstimates() const { return !estimates().empty(); }
    /// What the totals rest on that is older than the day; empty where nothing is.
    std::string estimates() const;

    const WalletFigures& figures_;
    std::string name_;
};
