#pragma once

#include "platform/PaperDocument.h"
#include "valuation/HoldingFigures.h"

#include <string>
#include <vector>

class Currency;
class ShareState;
class WalletFigures;

/// The tables of the portfolio's accounts and holdings on the day of a report. One without anything in it has no rows.
class HoldingTables {
public:
    /// Outlives this.
    explicit HoldingTables(const WalletFigures& figures);

    PaperTable accounts() const;
    /// What is held, at its quotes.
    PaperTable holdings() const;
    /// What the holdings have brought: `sums` are those of each. Without `hasRest` nothing stands there that is not
    /// realised.
    PaperTable gains(const std::string& title, const std::vector<HoldingFigures>& sums, bool hasRest) const;

private:
    bool isRateEstimate(const Currency* currency) const;
    void addGains(const ShareState& state, const HoldingFigures& sums, bool hasRest, PaperTable* table) const;

    const WalletFigures& figures_;
    std::string reference_; // symbol of the reference currency; empty without one
};
