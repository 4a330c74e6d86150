#include "app/PlainPortfolio.h"

#include "history/WalletImage.h"
#include "portfolio/Operation.h"
#include "valuation/State.h"

PlainPortfolio::PlainPortfolio(const Wallet& wallet, const Catalogue& catalogue, const Date& day)
    : catalogue_(catalogue),
      wallet_(WalletImage::of(wallet, catalogue, [](const Operation&) { return true; }).make(catalogue)),
      state_(refreshStates(*wallet_, day, false, nullptr))
{}

PlainPortfolio::~PlainPortfolio() = default;

std::vector<EvolutionPoint> PlainPortfolio::evolve()
{
    EvolutionOutcome outcome;
    state_ = refreshStates(*wallet_, state_->getDate(), false, &outcome);
    return outcome == EvolutionOutcome::kBuilt ? evolutionByDate(*wallet_, catalogue_) : std::vector<EvolutionPoint>();
}

WalletFigures PlainPortfolio::figures()
{
    const Date day = state_->getDate(); // of a state that goes
    state_ = nullptr;
    return {*wallet_, catalogue_, day, {}};
}
