#pragma once

#include "market/NameIndex.h"

#include <cstdint>
#include <optional>

class BTextControl;
class BView;
class PLWindow;

/// What the fields for markets, tickers and currencies offer while a person types, from the market data.
///
/// The names are gathered when they are asked for the first time after a change by a command.
class Completions {
public:
    explicit Completions(PLWindow& window) : window_(window) {}
    Completions(const Completions&) = delete;
    Completions& operator=(const Completions&) = delete;

    // Each gives the field `name` of `page` its offers. All outlive this.
    void offerCurrencies(BView& page, const char* name);
    void offerMarkets(BView& page, const char* name);
    /// Choosing a company also puts its market into the field `market`.
    void offerCompanies(BView& page, const char* name, const char* market);

private:
    struct Names {
        std::uint64_t serial; // of the change that they are younger than
        NameIndex currencies, markets, companies;
    };
    const Names& names();

    PLWindow& window_;
    std::optional<Names> names_;
};
