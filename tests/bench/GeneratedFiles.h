#pragma once

#include "market/Catalogue.h"
#include "portfolio/Wallet.h"
#include "tests/support/ToolRun.h"

#include <map>

/// How much is in a pair of generated files: a market data file with a quote of each company for every weekday and a
/// rate of each of four currencies for every day, and a portfolio on it.
struct DataSize {
    int companies;
    int years;
    int holdings;
    int accounts;
    int operations; // a tenth deposits, a tenth transfers, half of them purchases, the rest sales

    auto operator<=>(const DataSize&) const = default;
};

/// A wallet on its market data.
struct Portfolio {
    Catalogue catalogue;
    Wallet wallet; // destroyed first

    /// The last day with quotes, on which the portfolio is valued.
    static Date lastDay() { return {20, 11, 2026}; }
};

/// A temporary folder with generated files, which are the same in every run. It is removed in the end.
class GeneratedFiles {
public:
    struct Files {
        std::filesystem::path market;
        std::filesystem::path wallet;
    };

    static constexpr int kCurrencies = 4; // with a market each

    /// Generates the files when they are asked for the first time.
    const Files& files(const DataSize& size);

private:
    const TemporaryFolder folder_{"pelorin-bench"};
    std::map<DataSize, Files> files_;
};
