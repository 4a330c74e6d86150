#pragma once

#include "tests/support/SmallPortfolio.h"
#include "valuation/AccountState.h"
#include "valuation/ShareState.h"
#include "valuation/State.h"

#include <cmath>
#include <sstream>
#include <string>

/// All that a state tells, to the last bit; any two values that are not a number are the same.
inline std::string textOf(const State& state)
{
    const auto exact = [](float value) { return std::isnan(value) ? NAN : value; };
    std::ostringstream text;
    text << std::hexfloat << exact(state.getTotalDeposit()) << ' ' << state.getDate().toString().bytes() << ' '
         << state.getFirstOperationDate().toString().bytes();
    for (const AccountState* account : all(state, &State::getAllAccountStates))
        text << '\n' << exact(account->getCash());
    for (const ShareState* share : all(state, &State::getAllShareStates))
        text << '\n'
             << share->getQuantity() << ' ' << exact(share->getBuyQuote()) << ' ' << exact(share->getQuote()) << ' '
             << share->getEndDate().toString().bytes();
    return text.str();
}
