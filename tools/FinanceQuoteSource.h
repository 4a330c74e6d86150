#pragma once

#include "tools/QuoteSource.h"

/// The Perl library Finance::Quote, asked by a script that this program hands to `perl`.
class FinanceQuoteSource : public QuoteSource {
public:
    /// Needs no key of any provider.
    static constexpr const char* kUsualMethod = "yahoo_json";

    /// @param method of the library: lower case letters, digits and '_'. Throws std::runtime_error for any other text.
    /// @param limit of a name, so that one that hangs leaves the others of its run their time.
    FinanceQuoteSource(const std::string& method, std::chrono::seconds limit);

    /// Loading the library takes longer than asking it once.
    std::size_t mostNames() const override { return 20; }
    Run quotesOf(const std::vector<std::string>& tickers) const override;
    Run ratesOf(const std::vector<std::string>& currencies, const std::string& reference) const override;

private:
    Run run(const char* what, const std::string& how, const std::vector<std::string>& names) const;

    std::string method_;
    std::chrono::seconds limit_;
};
