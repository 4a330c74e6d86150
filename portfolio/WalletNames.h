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
    using Pair = std::pair<std::string_view, std::string_view>;
    struct PairHash {
        std::size_t operator()(const Pair& pair) const;
    };
    template <class T>
    using PairMap = std::unordered_map<Pair, T*, PairHash>;
    template <class T>
    using Map = std::unordered_map<std::string_view, T*>;

    static Pair pairOf(const Market& market, const Company& company);
    template <class T>
    static int find(const PairMap<T>& map, const String& market, const String& abbreviation, T** out);
    template <class T>
    static T* find(const Map<T>& map, const String& name);

    PairMap<Company> companies_;
    PairMap<Share> shares_;
    Map<Currency> currencies_;
    Map<Account> accounts_;
};
