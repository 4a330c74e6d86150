#pragma once

#include <chrono>
#include <cstddef>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

/// Where closes and rates of today come from: a program that is run, and prints them. What it prints is read by
/// `readAnswer`.
class QuoteSource {
public:
    /// A program to be run, and what it is asked for.
    struct Run {
        std::vector<std::string> names; // tickers, or symbols of currencies; one at least
        std::vector<std::string> arguments;
        bool tellsNames; // each line begins with the name it is about; else there is one name only
    };

    virtual ~QuoteSource() = default;

    /// How many names one run may be about.
    virtual std::size_t mostNames() const = 0;
    /// Each of `tickers` is one by `isTicker`.
    virtual Run quotesOf(const std::vector<std::string>& tickers) const = 0;
    /// The price of a unit of each currency in the reference; all are symbols by `isTicker`.
    virtual Run ratesOf(const std::vector<std::string>& currencies, const std::string& reference) const = 0;
};

/// The source that `text` names, "finance-quote:METHOD" or "command:PROGRAM {ticker}". Throws std::runtime_error with
/// the reason when there is none of that name.
/// @param limit of a name, for a source that is asked for several in one run.
std::unique_ptr<QuoteSource> quoteSource(const std::string& text, std::chrono::seconds limit);

/// Whether a program may be asked for `text`: letters, digits, and ".-^=_", of which neither '-' nor '.' comes first.
/// Anything else might mean something to a program, as an option or a path does.
bool isTicker(std::string_view text);
