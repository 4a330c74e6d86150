#pragma once

#include "market/MarketDiagnosis.h"

#include <cstdio>
#include <string>
#include <vector>

class Catalogue;

/// Whether a portfolio file has neither holdings nor accounts, or is of no length at all. Rewinds it before.
bool isEmptyPortfolioFile(FILE* file);

/// Why a portfolio file could not be read, and what was lost of one that could.
///
/// A second look at the file goes over its records by their layout alone, without making a model. So it tells of all
/// names that are missing, where the reader stops at the first, and finds every transfer in its place, where the reader
/// goes on out of place.
class WalletDiagnosis {
public:
    /// Looks at `file` from its beginning. `catalogue` is what the file was read with.
    WalletDiagnosis(FILE* file, const Catalogue& catalogue, NameText shown);

    /// Whether the file names what the catalogue does not have.
    bool isNameMissing() const { return !missing_.empty(); }
    /// All in one line, with "; " between:
    /// * the missing names: "Mine needs NYSE / ABC (12 operations) and the currency Euro; the market file Sample has
    ///   neither";
    /// * what else is wrong: "this is a market file", "the file ends in the middle of account 3";
    /// * the transfers that have lost their recipients, which is no failure of the read: "the transfer of 200.00 from
    ///   Main to Savings on 02/01/1999 lost its recipient, ...".
    /// @param self how the portfolio is called, and `markets` the catalogue, empty when nothing is loaded.
    std::string text(const std::string& self, const std::string& markets) const;

private:
    std::string needs(const std::string& self, const std::string& markets) const;

    std::vector<std::string> missing_;
    std::string fault_;
    std::string losses_;
};
