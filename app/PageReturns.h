#pragma once

#include "foundation/Date.h"
#include "valuation/Evolution.h"

#include <vector>

class PLWindow;
class State;
class WalletView;

/// The returns on the page of the portfolio: of the days that its chart shows, and without a chart of all days.
class PageReturns {
public:
    /// Both outlive this.
    PageReturns(PLWindow& window, WalletView& page);

    /// Shows them behind a valuation. `state` and `days` are without what simulations have made up. `days` come by date
    /// up to that of the state, and are empty where there are no daily values.
    void show(const State& state, std::vector<EvolutionPoint> days);
    /// The portfolio is valued anew, or goes: there is nothing to show until the next `show`.
    void forget() { days_.clear(); }

private:
    void showRange();

    PLWindow& window_;
    WalletView& page_;
    std::vector<EvolutionPoint> days_; // the last one at least, while returns are shown
    Date firstOperation_;
    bool hasDays_ = false;
};
