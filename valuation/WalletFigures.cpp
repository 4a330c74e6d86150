#include "valuation/WalletFigures.h"

#include "valuation/State.h"

WalletFigures::WalletFigures(Wallet& wallet, const Catalogue& catalogue, const Date& day, const Date& from)
    : wallet_(wallet), catalogue_(catalogue), day_(day), from_(from),
      state_(refreshStates(wallet, day, false, &outcome_)), evolution_(evolutionByDate(wallet, catalogue)),
      returns_(wallet, catalogue, evolution_, state_->getFirstOperationDate(), from),
      // One range for both: it begins behind a day only when that is later than the first one.
      holdings_(holdingFigures(*state_, catalogue, from > state_->getFirstOperationDate() ? from : Date()))
{
    // The states of the days have been summed up, and can take a gigabyte: only that of the day stays.
    state_ = refreshStates(wallet, day, false, nullptr);
}

std::vector<HoldingFigures> WalletFigures::holdingsWithin(const Date& from, const Date& to) const
{
    // Nothing is automatic here, so a further state changes nothing of the wallet. It leaves the wallet's list when it
    // goes.
    const State end(&wallet_, to, false);
    return holdingFigures(end, catalogue_, from);
}
