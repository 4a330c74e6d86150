#pragma once

#include "exchange/MarketPlaces.h"
#include "exchange/Table.h"

#include <map>
#include <stdexcept>
#include <string>
#include <vector>

/// The form of a table of one ticker's closing prices: date, close.
extern const TableForm kQuotesOfOneTicker;

/// What the tables leave open.
struct ImportOptions {
    std::string reference = "EUR";     // symbol of the currency that the rates refer to
    std::string currency = "USD";      // symbol of the currency of a market for which no table tells it
    std::string market = "NYSE";       // of a ticker for which neither a table tells it nor the catalogue
    std::optional<bool> ratesAreUnits; // per unit of the reference, else prices in it; without it as the heading says
    bool tickerFromName = false;       // a quotes file without a ticker column is named after its ticker
    /// Under which headings columns stand that are not recognised; an empty one says that there is no such column.
    std::map<Column, std::string> columns = {};
};

/// What the first line of a table says of its columns, to be shown and corrected.
struct MarketTableHead {
    std::vector<std::string> headings;     // known or not; none when the first line has values already
    std::map<Column, std::string> columns; // the headings of those that are recognised
    std::vector<std::string> wide;         // tickers or currencies of a wide table
};

/// Quotes are in currencies of which no rate is known: all that they say would count for nothing.
struct MissingRate : std::runtime_error {
    using std::runtime_error::runtime_error;
};

/// Makes of tables of quotes and rates a plan of what they bring into a catalogue, which may be empty.
///
/// A company is a ticker on a market. Rows find what they name in the catalogue (`MarketPlaces`); a row that tells no
/// market means the only company of its ticker there is, if it is one. What is new comes behind what is there, in the
/// order of its first mention. Unusable lines are told and skipped. A file that cannot be read throws
/// std::runtime_error with one line for the user.
class MarketImport {
public:
    /// Throws std::runtime_error for a file that cannot be read, and for nothing else.
    static MarketTableHead headOf(const std::string& path, bool areRates, const std::map<Column, std::string>& told);

    /// `catalogue` stays as it is until the plan is carried out. `options.reference` is its reference, where it has
    /// one.
    MarketImport(const ImportOptions& options, const Catalogue& catalogue, TableWatch watch);
    MarketImport(const MarketImport&) = delete;
    MarketImport& operator=(const MarketImport&) = delete;

    /// Takes market, currency and name of tickers. Has to come before the quotes, which it says how to place.
    void addListing(const std::string& path);
    void addRates(const std::string& path);
    void addQuotes(const std::string& path);

    /// The plan, which the import has no more afterwards. Throws MissingRate, and std::runtime_error when there is no
    /// quote and no rate at all.
    MarketPlan plan();
    /// The latest day of all values that have come, those of the reference included; once there is a plan.
    Date latestDay() const { return latestDay_; }

private:
    struct Listed {
        MarketPlaces::Named named;
        std::string name;
    };

    void mentionCompanies(const Table& table);
    void takeListed(const Table& row);
    void takeRate(Table& row, bool units);
    void takeRates(Table& row, bool units);
    void takeQuote(Table& row, const std::string& tickerOfFile);
    void takeQuotes(Table& row);
    void addRate(const std::string& symbol, const DatedValue& value);
    void addQuote(const Table& row, const std::string& ticker, const DatedValue& value);
    template <class Take>
    void takeWide(Table& row, bool inverted, const Take& take);

    bool areUnits(const Table& rates, const std::string& path) const;
    SeriesValues<Company>* companyOf(const Table& row, const std::string& ticker);
    void checkRates() const;

    ImportOptions options_;
    TableWatch watch_;
    MarketPlan plan_;
    MarketPlaces places_;
    Date latestDay_;
    std::unordered_map<std::string, Listed> listing_;              // by ticker
    std::unordered_map<std::string, SeriesValues<Company>*> rows_; // by all cells that tell a row's company
};
