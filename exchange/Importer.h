#pragma once

#include "exchange/Table.h"
#include "foundation/Date.h"

#include <cstddef>
#include <iosfwd>
#include <map>
#include <optional>
#include <string>
#include <unordered_map>
#include <utility>

class Catalogue;
class Company;
class Currency;
class Market;

/// The form of a table of one ticker's closing prices: date, close.
extern const TableForm kQuotesOfOneTicker;

/// What the tables leave open.
struct ImportOptions {
    std::string reference = "EUR";     // symbol of the currency that the rates refer to
    std::string currency = "USD";      // symbol of the currency of a market for which no table tells it
    std::string market = "NYSE";       // of a ticker for which no table tells it
    std::optional<bool> ratesAreUnits; // per unit of the reference, else prices in it; without it as the heading says
    bool tickerFromName = false;       // a quotes file without a ticker column is named after its ticker
};

/// What has come in; the rates include those of 1 that the reference currency gets.
struct ImportCounts {
    std::size_t companies = 0;
    std::size_t quotes = 0;
    std::size_t currencies = 0;
    std::size_t rates = 0;
    std::size_t skipped = 0;  // lines
    std::size_t replaced = 0; // values given up for a later line of the same day
};

/// Makes market data of tables of quotes and rates.
///
/// Currencies come in the order of their first mention behind the reference, companies likewise. A company is a ticker
/// on a market, a market trades in a single currency. Unusable lines are told on the log and skipped. A file that
/// cannot be read throws std::runtime_error with one line for the user.
class Importer {
public:
    /// `catalogue` is empty; the currencies and companies come into it with the tables, their quotes with `finish`.
    Importer(const ImportOptions& options, Catalogue& catalogue, std::ostream& log);

    /// Takes market, currency and name of tickers. Has to come before the quotes, which it says how to place.
    void addListing(const std::string& path);
    void addRates(const std::string& path);
    void addQuotes(const std::string& path);

    /// Throws std::runtime_error when there is no quote and no rate at all.
    /// @return the latest day that has a value.
    Date finish();
    const ImportCounts& counts() const { return counts_; }

private:
    // A series finds the place of a quote in time only when quotes come in date order, which tables need not have.
    using Values = std::map<Date, float>;
    using CompanyValues = std::pair<Company* const, Values>;
    struct Listed {
        std::string market; // each empty when the listing leaves it open
        std::string currency;
        std::string name;
    };

    void takeListed(const Table& row);
    void takeRate(Table& row, bool units);
    void takeQuote(Table& row, const std::string& tickerOfFile);

    bool areUnits(const Table& rates, const std::string& path) const;
    CompanyValues* findCompany(const Table& row, const std::string& ticker);
    CompanyValues* placeCompany(const Table& row, const std::string& ticker);
    Market* findMarket(const std::string& nameOrNone, const std::string& currency);
    Currency* findCurrency(const std::string& symbol);
    void addValue(Values& values, const Date& date, float value);

    void giveReferenceItsRates();
    void tellDoubts() const;

    ImportOptions options_;
    Catalogue& catalogue_;
    std::ostream& log_;
    ImportCounts counts_;

    std::unordered_map<std::string, Listed> listing_;      // by ticker
    std::unordered_map<std::string, CompanyValues*> rows_; // by all cells that tell a row's company

    // What is in the catalogue, found without a search. The keys are cut at a zero byte, as a String cuts its text.
    std::unordered_map<std::string, Currency*> currencies_;               // by symbol
    std::unordered_map<std::string, Market*> markets_;                    // by name
    std::map<std::pair<const Market*, std::string>, Company*> companies_; // by market and ticker

    std::unordered_map<Company*, Values> quotes_;
    std::unordered_map<Currency*, Values> rates_;
};
