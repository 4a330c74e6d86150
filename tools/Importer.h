#pragma once

#include "foundation/Date.h"
#include "tools/DatedValues.h"

#include <cstddef>
#include <iosfwd>
#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

class Catalogue;
class Currency;
class TableReader;

/// How the numbers of a rates table are meant. The program keeps the second kind, so the first is inverted.
enum class RateMeaning {
    kUnitsPerReference, // how many units one unit of the reference currency buys, as central banks publish rates
    kValueInReference,  // the price of one unit in the reference currency
};

/// What the tables leave open.
struct ImportOptions {
    std::string reference = "EUR";       // symbol of the currency that the rates refer to
    std::string currency = "USD";        // symbol of the currency of a market for which no table tells it
    std::string market = "NYSE";         // of a ticker for which no table tells it
    std::optional<RateMeaning> ratesAre; // what the heading of the rates says (units_per_..., value_in_...), else units
    bool tickerFromName = false;         // a quotes file without a ticker column is named after its ticker
    std::map<std::string, std::string> currencyNames; // by symbol; a currency not in here is called by its symbol
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

/// Gathers tables of quotes and rates and makes market data of them.
///
/// Currencies come in the order of their first mention behind the reference, companies likewise. A company is a ticker
/// on a market, a market trades in a single currency. Unusable lines are told on the log and skipped. A file that
/// cannot be read throws std::runtime_error with one line for the user.
class Importer {
public:
    Importer(const ImportOptions& options, std::ostream& log);

    /// Takes market, currency and name of tickers. Has to come before the quotes, which it says how to place.
    void addListing(const std::string& path);
    void addRates(const std::string& path);
    void addQuotes(const std::string& path);

    /// Adds everything to `catalogue`, which is empty; nothing is left here. Throws std::runtime_error for nothing at
    /// all.
    /// @return the latest day that has a value.
    Date fill(Catalogue* catalogue);
    const ImportCounts& counts() const { return counts_; }

private:
    using Index = std::size_t;

    struct CurrencyData {
        std::string symbol;
        DatedValues rates;
        bool hasCompanies = false;
    };
    struct MarketData {
        std::string name;
        Index currency;
    };
    struct CompanyData {
        std::string ticker;
        std::string name;
        Index market;
        DatedValues quotes;
    };
    struct Listed {
        std::string market; // each empty when the listing leaves it open
        std::string currency;
        std::string name;
    };

    // These take one row each and return why they cannot, or an empty text.
    std::string takeListed(const TableReader& row);
    std::string takeRate(TableReader& row, RateMeaning meaning);
    std::string takeQuote(TableReader& row, std::string_view tickerOfFile);

    RateMeaning meaningOf(const TableReader& rates, const std::string& path) const;
    std::string findCompany(const TableReader& row, std::string_view ticker, CompanyData** out);
    std::string placeCompany(const TableReader& row, std::string_view ticker, Index* out);
    std::string findMarket(const std::string& nameOrNone, const std::string& currency, Index* out);
    Index findCurrency(std::string_view symbol);

    void settle();
    void giveReferenceItsRates();
    void tellDoubts() const;
    Date latestDay() const;
    std::vector<Currency*> makeCurrencies(Catalogue* catalogue);
    void makeCompanies(const std::vector<Currency*>& currencies);

    ImportOptions options_;
    std::ostream& log_;
    ImportCounts counts_;

    std::vector<CurrencyData> currencies_; // the reference first
    std::vector<MarketData> markets_;
    std::vector<CompanyData> companies_;
    std::unordered_map<std::string, Listed> listing_;      // by ticker
    std::unordered_map<std::string, Index> currencyIndex_; // by symbol
    std::unordered_map<std::string, Index> marketIndex_;   // by name
    std::unordered_map<std::string, Index> companyIndex_;  // by ticker and market
    std::unordered_map<std::string, Index> rowIndex_;      // by all cells that tell a row's company

    std::string rowKey_;   // of the latest row,
    Index rowCompany_ = 0; // and its company
};
