#pragma once

#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

class Catalogue;
class Company;
class Currency;

/// Finds the company that a line of a statement means, by what it has of market, ticker and name. Case and accents do
/// not matter, but between two that differ in them the one that is written alike is meant.
///
/// Only companies that a portfolio file can name are found: a second one of the same market and ticker is not.
class CompanyFinder {
public:
    explicit CompanyFinder(const Catalogue& catalogue);

    /// @param market may be empty; `name` counts only when `ticker` is empty.
    /// @param currency settles between companies of several markets when `market` is empty; may be null.
    /// Throws UnusableRow when there is none, or more than one.
    Company* find(std::string_view market, std::string_view ticker, std::string_view name,
                  const Currency* currency) const;

private:
    using Companies = std::vector<Company*>; // in the order of the file

    std::unordered_map<std::string, Companies> byTicker_; // folded, both
    std::unordered_map<std::string, Companies> byName_;
};
