#pragma once

#include "tools/QuotePages.h"

#include <filesystem>
#include <iosfwd>
#include <string>
#include <string_view>

/// A folder of closing prices, one file TICKER.csv for each ticker, as a quote server shows it.
class QuoteFolder {
public:
    /// Throws std::runtime_error when there is no such folder. What is wrong with a file is told on `log`.
    QuoteFolder(const std::filesystem::path& folder, std::ostream& log);

    /// The page for a request line. Files are read anew every time. Whatever is not a request for a ticker that the
    /// folder has a price of gets `noQuotesPage`.
    std::string answer(std::string_view request) const;

private:
    Closes closesOf(std::string_view ticker) const;

    std::filesystem::path folder_;
    std::ostream& log_;
};
