#pragma once

#include "tools/QuoteSource.h"

/// A program of the user's own, which prints "date,close" for the ticker in its arguments.
class CommandSource : public QuoteSource {
public:
    /// @param command words with blanks between, which single or double quotes keep together; no shell reads them.
    /// "{ticker}" in any of them but the first stands for the ticker. Throws std::runtime_error with the reason when it
    /// is no such command.
    explicit CommandSource(const std::string& command);

    std::size_t mostNames() const override { return 1; }
    Run quotesOf(const std::vector<std::string>& tickers) const override;
    /// Asks for the ticker that such a rate usually has: "USDEUR=X".
    Run ratesOf(const std::vector<std::string>& currencies, const std::string& reference) const override;

private:
    std::vector<std::string> argumentsFor(const std::string& ticker) const;

    std::vector<std::string> words_;
};
