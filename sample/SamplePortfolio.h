#pragma once

#include "foundation/Date.h"

#include <vector>

class Catalogue;
class Wallet;

/// Fills `wallet`, which is empty, with five years of a made-up saver's operations on the companies of `catalogue`, as
/// `fillSampleMarket` has made it for `days`. Trades are at the quotes of their day, transfers at its rates; no account
/// is ever overdrawn and nothing is sold that is not held.
void fillSamplePortfolio(Wallet& wallet, const Catalogue& catalogue, const std::vector<Date>& days);
