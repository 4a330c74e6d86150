#pragma once

#include "market/Catalogue.h"
#include "portfolio/Wallet.h"
#include "valuation/Evolution.h"
#include "valuation/HoldingFigures.h"
#include "valuation/Returns.h"
#include "valuation/Totals.h"

#include <string>
#include <vector>

class State;

/// A portfolio file valued on a day with a market file: what the reports show.
///
/// Whatever fails throws std::runtime_error with one line for the user that names the file and what is wrong with it.
class Valuation {
public:
    /// Reads both files; an empty path stands for a portfolio without anything in it.
    Valuation(const std::string& marketPath, const std::string& portfolioPath);

    /// Values the portfolio on `date`, a valid one: with automatic sales when `previsions` is set, with every day from
    /// the first operation on when `evolution` is set. Comes before the queries below.
    void compute(const Date& date, bool previsions, bool evolution);
    /// The same, with the returns and the figures of the holdings, which begin later than the first operation when
    /// `from` is later. What the search for automatic sales makes up is no part of these: as it changes nothing in the
    /// totals of the day, it changes no return.
    void computeReturns(const Date& date, const Date& from, bool previsions, bool evolution);

    const Catalogue& catalogue() const { return catalogue_; }
    const Wallet& wallet() const { return wallet_; }
    /// To be changed; what was computed before is of no use then.
    Wallet& wallet() { return wallet_; }
    const State& state() const { return *state_; }
    Totals totals() const { return {*state_, catalogue_}; }
    bool hasEvolution() const { return hasEvolution_; }
    /// By ascending date; empty without a reference currency.
    const std::vector<EvolutionPoint>& evolution() const { return evolution_; }

    /// Empty without a reference currency, and when they have not been asked for.
    const Returns& returns() const { return returns_; }
    /// Of each holding of the state; none when they have not been asked for.
    const std::vector<HoldingFigures>& figures() const { return figures_; }

    /// One line on a portfolio file that could be read but cannot be right; empty without a doubt.
    const std::string& doubt() const { return doubt_; }

private:
    void readMarket();
    void readPortfolio();
    void checkOutcome(EvolutionOutcome outcome) const;

    std::string marketPath_;
    std::string portfolioPath_;
    std::string doubt_;
    Catalogue catalogue_; // outlives the wallet, which refers to it
    Wallet wallet_;
    const State* state_ = nullptr; // owned by the wallet
    bool hasEvolution_ = false;
    std::vector<EvolutionPoint> evolution_;
    Returns returns_;
    std::vector<HoldingFigures> figures_;
};
