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

    /// The ticker that a request line asks for; empty when it is of no kind that is answered.
    static std::string_view tickerOf(std::string_view request);
    /// Whether there is a close of `day`, or of a later one.
    bool reaches(std::string_view ticker, const Date& day) const;
    /// Adds to the ticker's table what it does not have, or makes the table. Throws std::runtime_error with the reason
    /// when that fails, and leaves the table as it was.
    void add(const std::string& ticker, const Closes& closes) const;

private:
    std::filesystem::path fileOf(std::string_view ticker) const;
    Closes closesOf(std::string_view ticker, std::ostream& log) const;

    std::filesystem::path folder_;
    std::ostream& log_;
};
