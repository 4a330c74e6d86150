#pragma once

#include "exchange/MarketPlan.h"

#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>

/// Finds the currencies, markets and companies that the rows of tables name: among those of a catalogue, where the
/// first in the order of the file counts, and behind them those that a plan adds. Makes for the plan what is missing.
///
/// Texts are compared up to a zero byte, as `String` does.
class MarketPlaces {
public:
    /// What a row, or a listing, tells of the place of its company; each empty when it is left open.
    struct Named {
        std::string market;
        std::string currency;
    };

    /// What stands for what a row leaves open: the name of the market, and the currency of a market that is new.
    MarketPlaces(const Catalogue& catalogue, MarketPlan& plan, const Named& usual);

    Currency* currency(const std::string& symbol);
    /// The company that is meant by `ticker` and what is told of its place. Throws an UnusableRow for what contradicts
    /// the markets; then nothing has been made.
    /// @param name of the company if it has to be made.
    SeriesValues<Company>* company(const std::string& ticker, const Named& named, const std::string& name);
    /// Settles the currency of a market that is new, before any company in it is mentioned. Throws as `company` does.
    void mention(const std::string& ticker, const Named& named);

    SeriesValues<Currency>* ratesOf(Currency* currency);

private:
    /// A market, and in it the company, when there is one; without a market the one of that name is to be made.
    struct Place {
        std::string name; // of the market
        Market* market = nullptr;
        Company* company = nullptr;
    };

    Place find(const std::string& ticker, const Named& named) const;
    Market* makeMarket(const std::string& name, const std::string& currencyOrNone);
    void enrol(Market* market, Currency* currency);
    void enrol(Company* company, Market* market);
    std::string tradedIn(const Market* market) const;

    MarketPlan& plan_;
    Named usual_;
    // Of each name the first. The keys are made of all that a row may tell; where it leaves the currency open, that
    // part is empty.
    std::unordered_map<std::string, Currency*> currencies_; // symbol
    std::unordered_map<std::string, Market*> markets_;      // name, currency
    std::unordered_map<std::string, Company*> companies_;   // market's name, currency, ticker
    std::unordered_map<std::string, Company*> sole_;        // ticker; null where the catalogue has several
    std::unordered_map<const Market*, Currency*> tradedIn_; // of all markets
    std::unordered_map<const Company*, Market*> listedOn_;  // of all companies
    std::unordered_map<const Company*, SeriesValues<Company>*> quotes_;
    std::unordered_map<const Currency*, SeriesValues<Currency>*> rates_;
};
