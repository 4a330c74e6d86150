#pragma once

#include "exchange/JournalForm.h"

#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

class Account;
class Catalogue;
class Company;
class Currency;
class String;
class Wallet;

/// What currencies, companies and accounts are called in a journal, each otherwise than all others.
///
/// The symbols of currencies come first, the reference currency's before all, then the tickers: of two equal ones the
/// second gets "-2" behind it. Currencies of one symbol are one commodity, as they are for a valuation.
class JournalNames {
public:
    /// All stay as they are, as long as this object is there.
    JournalNames(const Catalogue& catalogue, const Wallet& wallet, const std::vector<const Company*>& companies,
                 const JournalForm& form);

    /// Commodities.
    const std::string& ofCurrency(const String& symbol) const;
    const std::string& of(const Company& company) const { return commodities_.at(&company); }
    /// "Assets:Cash:Main", "Assets:Shares:AC"
    const std::string& of(const Account& account) const { return accounts_.at(&account); }
    const std::string& holdingOf(const Company& company) const { return accounts_.at(&company); }

private:
    std::unordered_map<std::string_view, std::string> currencies_; // by symbol
    std::unordered_map<const void*, std::string> commodities_, accounts_;
};
