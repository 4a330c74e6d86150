#pragma once

#include <string>
#include <unordered_map>
#include <vector>

class Account;
class Catalogue;
class Company;
class Currency;
class Market;
class String;
class Wallet;

/// What currencies, markets, companies and accounts are called in the tables of an export.
///
/// The symbol, the name or the ticker that the file has, unless somebody else is called so already: two accounts "Main"
/// are "Main" and "Main #2". Currencies and accounts are told apart among all, companies among those of their market.
/// Markets are told apart among those of their currency, and from all of other names. What is no line of text is made
/// one. Which are called otherwise is told.
class TableNames {
public:
    /// `wallet` may be null. Both stay as they are, as long as this object is there.
    TableNames(const Catalogue& catalogue, const Wallet* wallet);

    const std::string& of(const Currency& currency) const { return names_.at(&currency); }
    const std::string& of(const Market& market) const { return names_.at(&market); }
    const std::string& of(const Company& company) const { return names_.at(&company); }
    const std::string& of(const Account& account) const { return names_.at(&account); }

    /// The cell under "Original": `name` escaped, or empty when that is what the tables call it.
    static std::string original(const String& name, const std::string& inTables);
    /// The text that the two cells stand for.
    static std::string originalOf(const std::string& cell, const std::string& inTables);

    /// A line for each that is not called as in its file.
    const std::vector<std::string>& changes() const { return changes_; }

private:
    class Taker;

    std::unordered_map<const void*, std::string> names_;
    std::vector<std::string> changes_;
};
