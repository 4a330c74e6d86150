#pragma once

#include "exchange/CsvWriter.h"
#include "exchange/ExportTables.h"
#include "exchange/TableNames.h"

#include <span>
#include <string>
#include <vector>

class Catalogue;
class Operation;
class ShareState;
class State;
class String;
class Wallet;
struct EvolutionPoint;

/// Writes the rows of tables, each of the part of the model that it is given. A table has the headings that
/// `export_tables` has for what is written into it.
class ExportRows {
public:
    /// The catalogue, and `wallet` if there is one, stay as they are while this object is there. Everything that is
    /// written is of them.
    ExportRows(const Catalogue& catalogue, const Wallet* wallet)
        : catalogue_(catalogue), wallet_(wallet), names_(catalogue, wallet)
    {}

    void addCurrencies(CsvWriter& table);
    void addMarkets(CsvWriter& table);
    void addCompanies(CsvWriter& table, const Market& market);
    void addRates(CsvWriter& table, const Currency& currency);
    void addQuotes(CsvWriter& table, const Company& company);
    void addEvents(CsvWriter& table, const Company& company);

    // Of the portfolio. What is held, and when, is of one of the wallet's states.
    void addAccounts(CsvWriter& table, const State& state);
    void addHoldings(CsvWriter& table, std::span<const ShareState* const> holdings);
    /// Those of `operations` that are not automatic, in their order.
    void addOperations(CsvWriter& table, const std::vector<const Operation*>& operations);
    void addParameters(CsvWriter& table);
    void addEvolution(CsvWriter& table, const std::vector<EvolutionPoint>& points);

    const TableNames& names() const { return names_; }
    /// A line for each thing that the tables cannot hold.
    const std::vector<std::string>& leftOut() const { return leftOut_; }

private:
    void add(CsvWriter& table, const std::vector<std::string>& cells);
    void addHolding(CsvWriter& table, const ShareState& holding);
    void addOperation(CsvWriter& table, const Operation& operation);
    std::string value(double amount, const String& symbol, const State& state) const;

    const Catalogue& catalogue_;
    const Wallet* wallet_;
    TableNames names_;
    std::vector<std::string> leftOut_;
};
