#pragma once

#include "exchange/BookedOperations.h"
#include "exchange/ExportedTable.h"
#include "exchange/SeriesUpdate.h"

#include <cstddef>
#include <map>
#include <string>
#include <unordered_map>
#include <utility>

class Account;
class Catalogue;
class Company;
class Currency;
class Market;
class Operation;
class Share;
class Wallet;

/// Reads back the tables of an export.
///
/// Into an empty catalogue and wallet they bring what values to the same bits. Where something is there already, they
/// are matched with it by symbol, market name and ticker, and by the accounts' names: nothing that is there is renamed,
/// removed or put in another order; a day that has a value gets the new one; events and operations that are there are
/// passed over; and the parameters and the reference currency stay. What cannot be read throws std::runtime_error with
/// one line for the user; catalogue and wallet are then of no use.
class FolderImport {
public:
    explicit FolderImport(const std::string& folder) : folder_(folder) {}

    /// Throws, too, when the catalogue has another reference currency than the tables.
    void readMarketData(Catalogue& catalogue);
    /// Comes behind `readMarketData`; the wallet has been read with that catalogue as it was before, or is new, and
    /// knows it as it is now afterwards. Throws, too, when a file of the wallet would refer to something else than it.
    void readPortfolio(Wallet& wallet, const Catalogue& catalogue);

    const ValueCounts& quotes() const { return quotes_; }
    /// Without those of the reference currency.
    const ValueCounts& rates() const { return rates_; }
    /// Of operations; one that is booked already is equal.
    const ValueCounts& operations() const { return operations_; }

private:
    /// A name, and what it is a name in.
    using Key = std::pair<const void*, std::string>;
    /// What the row of a table names.
    template <class T>
    using Named = std::map<Key, T*>;
    /// What was there before, those of one name in their order.
    template <class T>
    using Before = std::multimap<Key, T*>;
    /// Takes the first of that name, so that the next row of it, which the table calls otherwise, gets the second.
    /// @return null when there is none left.
    template <class T>
    static T* take(Before<T>& before, const Key& key)
    {
        const auto first = before.extract(key);
        return first ? first.mapped() : nullptr;
    }

    void readCurrencies(Catalogue& catalogue);
    void readMarkets(const Catalogue& catalogue);
    void readListing(const Catalogue& catalogue);
    void readRates(const Catalogue& catalogue);
    void readQuotes();
    void readEvents();

    void readAccounts(Wallet& wallet);
    void readHoldings(Wallet& wallet);
    void readOperation(const ExportedTable& row, BookedOperations& before);
    Operation* makeTrade(const ExportedTable& row, Account* account, bool isBuy) const;
    Operation* makeTransfer(const ExportedTable& row, Account* account) const;
    void readParameters(Wallet& wallet);
    static void checkNames(const Wallet& wallet);

    Currency* currencyOf(const ExportedTable& row, std::size_t column) const;
    Market* marketOf(const ExportedTable& row, std::size_t market, std::size_t currency) const;
    Company* companyOf(const ExportedTable& row, std::size_t ticker, std::size_t market, std::size_t currency) const;
    Account* accountOf(const ExportedTable& row, std::size_t column) const;

    std::string folder_;
    ValueCounts quotes_, rates_, operations_;

    // What the tables call so; a market within its currency, a company within its market.
    std::unordered_map<std::string, Currency*> currencies_;
    Named<Market> markets_;
    Named<Company> companies_;
    std::unordered_map<std::string, Account*> accounts_;
    std::map<std::pair<std::string, std::string>, Share*> shares_; // by market and ticker
};
