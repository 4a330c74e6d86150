#pragma once

#include "foundation/Date.h"
#include "valuation/Evolution.h"
#include "valuation/HoldingFigures.h"
#include "valuation/Returns.h"
#include "valuation/Totals.h"

#include <vector>

class Catalogue;
class State;
class Wallet;

/// A wallet valued on a day without simulations, with every day up to it, and what it has come to.
///
/// Wallet and catalogue stay as they are while this object is there, and so do the wallet's states.
class WalletFigures {
public:
    /// Destroys the wallet's states and makes new ones. `day` is defined. The returns and the figures of the holdings
    /// begin with the first operation, or later when `from` is later.
    WalletFigures(Wallet& wallet, const Catalogue& catalogue, const Date& day, const Date& from);

    const Wallet& wallet() const { return wallet_; }
    const Catalogue& catalogue() const { return catalogue_; }
    const Date& day() const { return day_; }
    const Date& from() const { return from_; }
    const State& state() const { return *state_; }
    Totals totals() const { return {*state_, catalogue_}; }
    /// Whether `evolution` has the days: without a reference currency it is empty nevertheless.
    EvolutionOutcome outcome() const { return outcome_; }
    /// By ascending date; only the day itself where there are no others.
    const std::vector<EvolutionPoint>& evolution() const { return evolution_; }
    const Returns& returns() const { return returns_; }
    /// Of each holding of the state, in its order.
    const std::vector<HoldingFigures>& holdings() const { return holdings_; }
    /// The same for the days after `from` up to `to`, which is defined.
    std::vector<HoldingFigures> holdingsWithin(const Date& from, const Date& to) const;

private:
    Wallet& wallet_;
    const Catalogue& catalogue_;
    Date day_;
    Date from_;
    EvolutionOutcome outcome_ = EvolutionOutcome::kBuilt;
    const State* state_; // in the wallet
    std::vector<EvolutionPoint> evolution_;
    Returns returns_;
    std::vector<HoldingFigures> holdings_;
};
