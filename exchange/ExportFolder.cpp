// The tables in common, and those of market data. ExportPortfolio.cpp has those of the portfolio.

#include "exchange/ExportFolder.h"

#include "exchange/TableText.h"
#include "market/Catalogue.h"
#include "market/Currency.h"
#include "market/Market.h"
#include "market/NoteCompanyEvent.h"
#include "market/SplitCompanyEvent.h"

using namespace export_tables;

namespace {

template <class Series, class Put>
void eachQuote(const Series& series, const Put& put)
{
    for (const auto* quote : series.quotes())
        put(tableDate(quote->getDate()), numberText(quote->getValue()));
}

} // namespace

ExportFolder::ExportFolder(const std::string& folder, const Catalogue& catalogue, const Wallet* wallet)
    : folder_(folder), catalogue_(catalogue), wallet_(wallet), names_(catalogue, wallet), remarks_(names_.changes())
{}

ExportFolder::~ExportFolder() = default;

CsvWriter& ExportFolder::begin(const ExportTable& table)
{
    tables_.push_back(std::make_unique<CsvWriter>(folder_ + '/' + table.file, table.headings));
    return *tables_.back();
}

void ExportFolder::add(CsvWriter& table, const std::vector<std::string>& cells)
{
    if (!table.add(cells))
        remarks_.push_back(table.path() + ": a line of " + cells.front() + " would be too long and is left out");
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

void ExportFolder::addMarketData()
{
    addCurrencies();
    addListing();
    addSeries();
    addEvents();
}

void ExportFolder::addCurrencies()
{
    CsvWriter& currencies = begin(kCurrencies);
    CsvWriter& markets = begin(kMarkets);
    for (const Currency* currency : catalogue_.getCurrencies()) {
        const std::string& symbol = names_.of(*currency);
        const bool isReference = currency == catalogue_.getReferenceCurrency();
        add(currencies, {symbol, escaped(currency->getName().bytes()), isReference ? kYes : "",
                         TableNames::original(currency->getRepresentation(), symbol)});
        for (const Market* market : currency->markets()) {
            const std::string& name = names_.of(*market);
            add(markets, {name, symbol, TableNames::original(market->getName(), name)});
        }
    }
}

void ExportFolder::addListing()
{
    CsvWriter& listing = begin(kListing);
    for (const Market* market : catalogue_.getMarkets())
        for (const Company* company : market->companies()) {
            const std::string& ticker = names_.of(*company);
            add(listing,
                {ticker, names_.of(*market), names_.of(*market->currency()), escaped(company->getName().bytes()),
                 TableNames::original(company->getAbbreviation(), ticker)});
        }
}

void ExportFolder::addSeries()
{
    CsvWriter& rates = begin(kRates);
    for (const Currency* currency : catalogue_.getCurrencies())
        eachQuote(*currency, [&](const std::string& day, const std::string& rate) {
            add(rates, {day, names_.of(*currency), rate});
        });
    CsvWriter& quotes = begin(kQuotes);
    for (const Market* market : catalogue_.getMarkets())
        for (const Company* company : market->companies())
            eachQuote(*company, [&](const std::string& day, const std::string& close) {
                add(quotes, {day, names_.of(*company), close, names_.of(*market), names_.of(*market->currency())});
            });
}

void ExportFolder::addEvents()
{
    CsvWriter& events = begin(kEvents);
    for (const Market* market : catalogue_.getMarkets())
        for (const Company* company : market->companies())
            for (const CompanyEvent* event : company->events()) {
                std::vector<std::string> cells{tableDate(event->getDate()), names_.of(*company), names_.of(*market),
                                               names_.of(*market->currency())};
                if (event->getType() == SplitCompanyEvent::kType) {
                    const auto& split = static_cast<const SplitCompanyEvent&>(*event);
                    cells.insert(cells.end(), {kSplit, "", "", std::to_string(split.getNumerator()),
                                               std::to_string(split.getDivider())});
                } else {
                    const auto& note = static_cast<const NoteCompanyEvent&>(*event);
                    cells.insert(cells.end(),
                                 {kNote, escaped(note.getTitle().bytes()), escaped(note.getText().bytes()), "", ""});
                }
                add(events, cells);
            }
}
