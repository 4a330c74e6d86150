#include "exchange/ExportFolder.h"

#include "market/Catalogue.h"
#include "market/Currency.h"
#include "market/Market.h"
#include "valuation/ShareState.h"
#include "valuation/State.h"

using namespace export_tables;

ExportFolder::ExportFolder(const std::string& folder, const Catalogue& catalogue, const Wallet* wallet)
    : folder_(folder), catalogue_(catalogue), wallet_(wallet), rows_(catalogue, wallet)
{}

ExportFolder::~ExportFolder() = default;

CsvWriter& ExportFolder::begin(const ExportTable& table)
{
    tables_.push_back(std::make_unique<CsvWriter>(folder_ + '/' + table.file, table.headings));
    return *tables_.back();
}

std::vector<ExportFolder::Made> ExportFolder::commit()
{
    std::vector<Made> made;
    for (const auto& table : tables_) {
        table->commit();
        made.push_back({table->path(), table->rows()});
    }
    tables_.clear();
    return made;
}

std::vector<std::string> ExportFolder::remarks() const
{
    std::vector<std::string> remarks = rows_.names().changes();
    remarks.insert(remarks.end(), rows_.leftOut().begin(), rows_.leftOut().end());
    return remarks;
}

void ExportFolder::addMarketData()
{
    rows_.addCurrencies(begin(kCurrencies));
    rows_.addMarkets(begin(kMarkets));
    CsvWriter& listing = begin(kListing);
    CsvWriter& rates = begin(kRates);
    for (const Currency* currency : catalogue_.getCurrencies())
        rows_.addRates(rates, *currency);
    CsvWriter& quotes = begin(kQuotes);
    CsvWriter& events = begin(kEvents);
    for (const Market* market : catalogue_.getMarkets()) {
        rows_.addCompanies(listing, *market);
        for (const Company* company : market->companies()) {
            rows_.addQuotes(quotes, *company);
            rows_.addEvents(events, *company);
        }
    }
}

void ExportFolder::addPortfolio(const State& state, const std::vector<EvolutionPoint>& evolution)
{
    rows_.addAccounts(begin(kAccounts), state);
    // Those that are sold, too: the order of all of them is part of a value.
    rows_.addHoldings(begin(kHoldings), state.shareStates());
    rows_.addOperations(begin(kOperations), operationsByDate(*wallet_));
    rows_.addParameters(begin(kParameters));
    rows_.addEvolution(begin(kEvolution), evolution);
}
