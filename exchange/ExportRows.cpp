// The rows in common, and those of market data. ExportPortfolio.cpp has those of the portfolio.

#include "exchange/ExportRows.h"

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

void ExportRows::add(CsvWriter& table, const std::vector<std::string>& cells)
{
    if (!table.add(cells))
        leftOut_.push_back(table.path() + ": a line of " + cells.front() + " would be too long and is left out");
}

void ExportRows::addCurrencies(CsvWriter& table)
{
    for (const Currency* currency : catalogue_.getCurrencies()) {
        const std::string& symbol = names_.of(*currency);
        const bool isReference = currency == catalogue_.getReferenceCurrency();
        add(table, {symbol, escaped(currency->getName().bytes()), isReference ? kYes : "",
                    TableNames::original(currency->getRepresentation(), symbol)});
    }
}

void ExportRows::addMarkets(CsvWriter& table)
{
    for (const Currency* currency : catalogue_.getCurrencies())
        for (const Market* market : currency->markets()) {
            const std::string& name = names_.of(*market);
            add(table, {name, names_.of(*currency), TableNames::original(market->getName(), name)});
        }
}

void ExportRows::addCompanies(CsvWriter& table, const Market& market)
{
    for (const Company* company : market.companies()) {
        const std::string& ticker = names_.of(*company);
        add(table, {ticker, names_.of(market), names_.of(*market.currency()), escaped(company->getName().bytes()),
                    TableNames::original(company->getAbbreviation(), ticker)});
    }
}

void ExportRows::addRates(CsvWriter& table, const Currency& currency)
{
    eachQuote(currency, [&](const std::string& day, const std::string& rate) {
        add(table, {day, names_.of(currency), rate});
    });
}

void ExportRows::addQuotes(CsvWriter& table, const Company& company)
{
    const Market& market = *company.market();
    eachQuote(company, [&](const std::string& day, const std::string& close) {
        add(table, {day, names_.of(company), close, names_.of(market), names_.of(*market.currency())});
    });
}

void ExportRows::addEvents(CsvWriter& table, const Company& company)
{
    const Market& market = *company.market();
    for (const CompanyEvent* event : company.events()) {
        std::vector<std::string> cells{tableDate(event->getDate()), names_.of(company), names_.of(market),
                                       names_.of(*market.currency())};
        if (event->getType() == SplitCompanyEvent::kType) {
            const auto& split = static_cast<const SplitCompanyEvent&>(*event);
            cells.insert(cells.end(),
                         {kSplit, "", "", std::to_string(split.getNumerator()), std::to_string(split.getDivider())});
        } else {
            const auto& note = static_cast<const NoteCompanyEvent&>(*event);
            cells.insert(cells.end(),
                         {kNote, escaped(note.getTitle().bytes()), escaped(note.getText().bytes()), "", ""});
        }
        add(table, cells);
    }
}
