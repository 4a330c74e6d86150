#include "tools/Valuation.h"

#include "foundation/PrintableText.h"
#include "portfolio/WalletDiagnosis.h"
#include "storage/InputFile.h"
#include "valuation/State.h"
#include "valuation/WalletFigures.h"

#include <stdexcept>

namespace {

[[noreturn]] void failFor(const std::string& path, const std::string& reason)
{
    throw std::runtime_error(path + ": " + reason);
}

} // namespace

Valuation::Valuation(const std::string& marketPath, const std::string& portfolioPath)
    : marketPath_(marketPath), portfolioPath_(portfolioPath)
{
    // In this order: the portfolio's names are looked up in the market data.
    readMarket();
    if (!portfolioPath.empty())
        readPortfolio();
}

void Valuation::readMarket()
{
    const InputFile file(marketPath_);
    if (catalogue_.rd(file.stream()) != 0)
        failFor(marketPath_, faultOfMarketFile(file.stream(), printable));
    // The wallet keeps copies of the lists, so they are set when the catalogue is whole.
    wallet_.setCatalogue(catalogue_);
}

void Valuation::readPortfolio()
{
    const InputFile file(portfolioPath_);
    const bool isRead = wallet_.rd(file.stream(), nullptr) == 0;
    if (isRead && !wallet_.hasLostRecipient())
        return;
    const WalletDiagnosis diagnosis(file.stream(), catalogue_, printable);
    const std::string reason = diagnosis.text("the portfolio", "the market file " + marketPath_);
    if (!isRead)
        failFor(portfolioPath_, reason);
    doubt_ = portfolioPath_ + ": " + reason;
}

void Valuation::compute(const Date& date, bool previsions, bool evolution)
{
    hasEvolution_ = evolution;
    EvolutionOutcome outcome = EvolutionOutcome::kBuilt;
    // The wallet owns the states and has destroyed those of an earlier computation: `state_` is good until the next
    // one.
    state_ = refreshStates(wallet_, date, previsions, evolution ? &outcome : nullptr);
    checkOutcome(outcome);
    // Of an earlier computation.
    evolution_.clear();
    if (evolution)
        evolution_ = evolutionByDate(wallet_, catalogue_);
}

void Valuation::computeReturns(const Date& date, const Date& from, bool previsions, bool evolution)
{
    // Before anything is simulated. An evolution that is refused leaves the day alone, which is told only to those who
    // have asked for the days.
    const WalletFigures figures(wallet_, catalogue_, date, from);
    hasEvolution_ = evolution;
    state_ = &figures.state();
    evolution_ = figures.evolution();
    returns_ = figures.returns();
    figures_ = figures.holdings();
    if (previsions)
        compute(date, previsions, evolution);
    else if (evolution)
        checkOutcome(figures.outcome());
}

void Valuation::checkOutcome(EvolutionOutcome outcome) const
{
    if (outcome == EvolutionOutcome::kBuilt)
        return;
    const std::string first = state_->getFirstOperationDate().toString().getCharacterArray();
    const std::string start = "no evolution, since its first operation is of " + first;
    if (outcome == EvolutionOutcome::kBadFirstDay)
        failFor(portfolioPath_, start + ", which is no day of the calendar");
    const std::string days = std::to_string(state_->getDate() - state_->getFirstOperationDate());
    failFor(portfolioPath_, start + ": too many days (" + days + ") for its accounts and holdings");
}
