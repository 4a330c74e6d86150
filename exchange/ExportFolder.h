#pragma once

#include "exchange/CsvWriter.h"
#include "exchange/ExportTables.h"
#include "exchange/TableNames.h"

#include <cstddef>
#include <memory>
#include <string>
#include <vector>

class Catalogue;
class Operation;
class ShareState;
class State;
class String;
class Wallet;
struct EvolutionPoint;

/// Writes market data and a portfolio as tables into a folder, from which FolderImport makes files that value to the
/// same bits.
///
/// First every table is made, then all appear. Whatever fails throws std::runtime_error with one line for the user.
class ExportFolder {
public:
    /// `folder` is there. The catalogue, and `wallet` if there is one, stay as they are in the meantime.
    ExportFolder(const std::string& folder, const Catalogue& catalogue, const Wallet* wallet);
    ~ExportFolder();

    /// Currencies, markets, companies, rates, quotes and events.
    void addMarketData();
    /// Accounts, holdings and operations, with what `state` has of them, parameters and the evolution.
    void addPortfolio(const State& state, const std::vector<EvolutionPoint>& evolution);

    struct Made {
        std::string path;
        std::size_t rows;
    };
    /// Lets all tables appear. Comes last. @return them.
    std::vector<Made> commit();

    /// A line for each thing that the tables cannot hold, or hold otherwise.
    const std::vector<std::string>& remarks() const { return remarks_; }

private:
    CsvWriter& begin(const ExportTable& table);
    void add(CsvWriter& table, const std::vector<std::string>& cells);

    void addCurrencies();
    void addListing();
    void addSeries();
    void addEvents();
    void addAccounts(const State& state);
    void addHoldings(const State& state);
    void addHolding(CsvWriter& table, const ShareState& holding);
    void addOperations();
    void addOperation(CsvWriter& table, const Operation& operation);
    std::string value(double amount, const String& symbol, const State& state) const;

    std::string folder_;
    const Catalogue& catalogue_;
    const Wallet* wallet_;
    TableNames names_;
    std::vector<std::unique_ptr<CsvWriter>> tables_;
    std::vector<std::string> remarks_;
};
