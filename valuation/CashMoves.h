#pragma once

#include "portfolio/CashMove.h"

class Currency;

/// How the moves of the operations add up. A balance is rounded to float after every move, so a replay gives the same
/// bits however it is organised, as long as the order is the same.

/// `balance` after a move of `amount`.
inline float addRounded(float balance, double amount)
{
    return static_cast<float>(balance + amount);
}

/// A deposit in the reference currency, at the rate of its own day. `currency` is the account's.
double depositInReference(const Operation& deposit, const Currency& currency);
