#pragma once

#include "valuation/Evolution.h"
#include "valuation/WalletFigures.h"

#include <memory>
#include <optional>
#include <vector>

class Catalogue;
class State;
class Wallet;

/// A portfolio without what simulations have made up, valued as a program without a window values its file. A copy: the
/// portfolio itself, and its valuation, stay as they are.
class PlainPortfolio {
public:
    /// `day` is defined. The catalogue outlives this, and is as it was at the last look on the portfolio.
    PlainPortfolio(const Wallet& wallet, const Catalogue& catalogue, const Date& day);
    ~PlainPortfolio();

    const Wallet& wallet() const { return *wallet_; }
    /// Values it once more, with every day up to the same one, by ascending date; empty where that cannot be.
    std::vector<EvolutionPoint> evolve();
    /// Values it once more, with all that a report tells of. To be called last, and to go before this.
    WalletFigures figures();
    const State& state() const { return *state_; }

private:
    const Catalogue& catalogue_;
    std::unique_ptr<Wallet> wallet_;
    const State* state_; // in the wallet
};
