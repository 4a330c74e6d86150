#pragma once

#include "foundation/Date.h"

#include <vector>

class Catalogue;
class Wallet;

/// What came into a portfolio from outside on a day, and what left it, in the reference currency at the rates of the
/// day. Neither is below zero.
struct CashFlow {
    Date date;
    double deposited = 0;
    double withdrawn = 0;
};

/// The deposits and withdrawals of the wallet up to and including `end`, gathered by day, by ascending date; what is of
/// a day that no calendar has counts on the next real one, as it does in the states. Transfers, and with them income
/// and charges, stay within the portfolio: they are none. Empty without a reference currency; on a day on which that
/// has a rate of 0, everything counts 0, as in an `Appraisal`.
std::vector<CashFlow> cashFlows(const Wallet& wallet, const Catalogue& catalogue, const Date& end);
