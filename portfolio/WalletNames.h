#pragma once

#include "foundation/String.h"

#include <string_view>
#include <unordered_map>
#include <utility>
#include <vector>

class Account;
class Company;
class Currency;
class Market;
class Share;

/// The names that a portfolio file refers to, found without searching while it is read.
///
/// Gives the same answers as the wallet's own look-ups: the first match in list order, compared as `String` does. It
/// refers to the names where they stand, so none may change during its life.
class WalletNames {
public:
    /// Takes in every company of `markets` and the currencies.
    WalletNames(const std::vector<Market*>& markets, const std::vector<Currency*>& currencies);

    void add(Share* share);
    void add(Account* account);

    /// @return 0; -1 and a null `*out` when there is none.
    int getCurrency(const String& name, Currency** out) const;
    int getCompany(const String& market, const String& abbreviation, Company** out) const;
    int getShare(const String& market, const String& abbreviation, Share** out) const;
    /// Null when there is none.
    Account* getAccount(const String& name) const;

private:
    /// Market and ticker; of what stands in no market only the name.
    using Key = std::pair<std::string_view, std::string_view>;
    struct KeyHash {
        std::size_t operator()(const Key& key) const;
    };
    template <class T>
    using Map = std::unordered_map<Key, T*, KeyHash>;

    static Key keyOf(const Market& market, const Company& company);
    template <class T>
    static int find(const Map<T>& map, const String& market, const String& name, T** out);

    Map<Company> companies_;
    Map<Share> shares_;
    Map<Currency> currencies_;
    Map<Account> accounts_;
};
