#include "tools/Valuation.h"

#include "foundation/FieldIO.h"
#include "portfolio/Account.h"
#include "portfolio/TransferAccountOperation.h"
#include "storage/InputFile.h"
#include "tools/TextTable.h"
#include "valuation/State.h"

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <stdexcept>

namespace {

[[noreturn]] void failFor(const std::string& path, const std::string& reason)
{
    throw std::runtime_error(path + ": " + reason);
}

/// For a file whose reading has failed: by itself, at its end, or else for `otherwise`.
[[noreturn]] void failReading(const InputFile& file, const char* kind, const std::string& otherwise)
{
    // The order matters: an error of the disk also counts as an end. Only when there was neither is it the contents
    // that the reader has refused.
    if (std::ferror(file.stream()) != 0)
        failFor(file.path(), std::string("cannot be read: ") + std::strerror(errno));
    if (reachedEnd(file.stream()))
        failFor(file.path(), std::string("ends too early; it is cut short or not a ") + kind + " file");
    failFor(file.path(), otherwise);
}

std::string quoted(const String& name)
{
    return '"' + printable(name.bytes()) + '"';
}

} // namespace

Valuation::Valuation(const std::string& marketPath, const std::string& portfolioPath)
    : marketPath_(marketPath), portfolioPath_(portfolioPath)
{
    // In this order: the portfolio's names are looked up in the market data.
    readMarket();
    readPortfolio();
}

void Valuation::readMarket()
{
    const InputFile file(marketPath_);
    if (catalogue_.rd(file.stream()) != 0)
        failReading(file, "market", "is damaged: it has the reference currency over and over");
    // The wallet keeps copies of the lists, so they are set when the catalogue is whole.
    wallet_.setCatalogue(catalogue_);
}

void Valuation::readPortfolio()
{
    const InputFile file(portfolioPath_);
    if (wallet_.rd(file.stream(), nullptr) == 0)
        return;
    // A transfer that leads nowhere puts what follows out of place, so that the failure lies there and not where it
    // showed.
    if (!doubt().empty())
        throw std::runtime_error(doubt());
    failReading(file, "portfolio",
                "names " + quoted(wallet_.getUnknownName()) +
                    ", which is no company or currency of the market file, or none of its own holdings");
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
    if (!evolution)
        return;
    evolution_ = evolutionPoints(wallet_, catalogue_);
    // The current state comes first in the wallet's list, before the days that lead to it.
    const auto isEarlier = [](const EvolutionPoint& a, const EvolutionPoint& b) { return a.date < b.date; };
    std::stable_sort(evolution_.begin(), evolution_.end(), isEarlier);
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

/// The account of a transfer without recipient. No wallet has such a transfer but by an unknown name in its file.
const Account* Valuation::senderToNowhere() const
{
    for (const Account* account : wallet_.accounts())
        for (const Operation* operation : account->operations()) {
            const auto* transfer = dynamic_cast<const TransferAccountOperation*>(operation);
            if (transfer != nullptr && transfer->recipient() == nullptr)
                return account;
        }
    return nullptr;
}

std::string Valuation::doubt() const
{
    const Account* sender = senderToNowhere();
    if (sender == nullptr)
        return {};
    return portfolioPath_ + ": a transfer from " + quoted(sender->getName()) +
           " goes to an account that the file does not have; what follows it is read out of place";
}
