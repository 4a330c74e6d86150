#pragma once

#include "exchange/CsvWriter.h"
#include "exchange/ExportRows.h"

#include <cstddef>
#include <memory>
#include <string>
#include <vector>

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
    std::vector<std::string> remarks() const;

private:
    CsvWriter& begin(const ExportTable& table);

    std::string folder_;
    const Catalogue& catalogue_;
    const Wallet* wallet_;
    ExportRows rows_;
    std::vector<std::unique_ptr<CsvWriter>> tables_;
};
