// The tables of market data. FolderPortfolio.cpp has those of the portfolio.

#include "exchange/FolderImport.h"

#include "exchange/Table.h"
#include "exchange/TableNames.h"
#include "exchange/TableText.h"
#include "market/Catalogue.h"
#include "market/Currency.h"
#include "market/Market.h"
#include "market/NoteCompanyEvent.h"
#include "market/SplitCompanyEvent.h"

#include <algorithm>
#include <set>
#include <stdexcept>
#include <tuple>

using namespace export_tables;

namespace {

String toString(const std::string& text)
{
    return String(text.c_str());
}

template <class Map>
auto* found(const Map& map, const typename Map::key_type& key)
{
    const auto place = map.find(key);
    return place != map.end() ? place->second : nullptr;
}

/// What tells an event from others of its company.
using EventText = std::tuple<PackedDate, short, std::string, std::string, short, short>;

EventText textOf(const CompanyEvent& event)
{
    if (event.getType() == SplitCompanyEvent::kType) {
        const auto& split = static_cast<const SplitCompanyEvent&>(event);
        return {event.getDate(), event.getType(), "", "", split.getNumerator(), split.getDivider()};
    }
    const auto& note = static_cast<const NoteCompanyEvent&>(event);
    return {event.getDate(),
            event.getType(),
            std::string(note.getTitle().comparedBytes()),
            std::string(note.getText().comparedBytes()),
            short{0},
            short{0}};
}

} // namespace

void FolderImport::readMarketData(Catalogue& catalogue)
{
    // Each table names what those before it have brought.
    readCurrencies(catalogue);
    readMarkets(catalogue);
    readListing(catalogue);
    readRates(catalogue);
    readQuotes();
    readEvents();
}

void FolderImport::readCurrencies(Catalogue& catalogue)
{
    enum { kSymbol, kName, kReference, kOriginal };
    Before<Currency> before;
    for (Currency* currency : catalogue.getCurrencies())
        before.emplace(Key{nullptr, currency->getRepresentation().comparedBytes()}, currency);
    for (ExportedTable row(folder_, kCurrencies); row.next();) {
        const std::string symbol = TableNames::originalOf(row.cell(kOriginal), row.cell(kSymbol));
        Currency* currency = take(before, {nullptr, symbol});
        if (currency == nullptr) {
            currency = new Currency(toString(unescaped(row.cell(kName))), toString(symbol), nullptr);
            catalogue.addCurrency(currency);
        }
        if (!currencies_.try_emplace(row.cell(kSymbol), currency).second)
            row.refuse("names the currency " + shown(row.cell(kSymbol)) + " once more");
        if (row.cell(kReference) != kYes)
            continue;
        if (catalogue.getReferenceCurrency() != nullptr && catalogue.getReferenceCurrency() != currency)
            row.refuse("has the reference currency " + shown(symbol) + ", and the market file has " +
                       shown(catalogue.getReferenceCurrency()->getRepresentation().bytes()) +
                       ": change it there, or name a file that is new");
        // No rate is divided: they come as they are in this currency.
        catalogue.setReferenceCurrency(currency);
    }
    for (Currency* currency : catalogue.getCurrencies())
        if (currency->storedReference() == nullptr)
            currency->setReferenceCurrency(catalogue.getReferenceCurrency());
}

void FolderImport::readMarkets(const Catalogue& catalogue)
{
    enum { kMarket, kCurrency, kOriginal };
    Before<Market> before;
    for (Market* market : catalogue.getMarkets())
        before.emplace(Key{market->currency(), market->getName().comparedBytes()}, market);
    for (ExportedTable row(folder_, kMarkets); row.next();) {
        Currency* currency = currencyOf(row, kCurrency);
        const std::string name = TableNames::originalOf(row.cell(kOriginal), row.cell(kMarket));
        Market* market = take(before, {currency, name});
        if (market == nullptr) {
            market = new Market(toString(name)); // owned by its currency
            market->setCurrency(currency);
        }
        if (!markets_.try_emplace({currency, row.cell(kMarket)}, market).second)
            row.refuse("names the market " + shown(row.cell(kMarket)) + " once more");
    }
}

void FolderImport::readListing(const Catalogue& catalogue)
{
    enum { kTicker, kMarket, kCurrency, kName, kOriginal };
    Before<Company> before;
    for (Market* market : catalogue.getMarkets())
        for (Company* company : market->companies())
            before.emplace(Key{market, company->getAbbreviation().comparedBytes()}, company);
    for (ExportedTable row(folder_, kListing); row.next();) {
        Market* market = marketOf(row, kMarket, kCurrency);
        const std::string ticker = TableNames::originalOf(row.cell(kOriginal), row.cell(kTicker));
        Company* company = take(before, {market, ticker});
        if (company == nullptr)
            company = new Company(market, toString(unescaped(row.cell(kName))), toString(ticker));
        if (!companies_.try_emplace({market, row.cell(kTicker)}, company).second)
            row.refuse("names the company " + shown(row.cell(kTicker)) + " once more");
    }
}

void FolderImport::readRates(const Catalogue& catalogue)
{
    enum { kDate, kCurrency, kValue };
    std::unordered_map<Currency*, std::vector<DatedValue>> values;
    for (ExportedTable row(folder_, kRates); row.next();)
        values[currencyOf(row, kCurrency)].push_back({row.date(kDate), row.number(kValue)});
    ValueCounts ofReference;
    for (auto& [currency, dated] : values)
        updateSeries(*currency, std::move(dated),
                     currency == catalogue.getReferenceCurrency() ? &ofReference : &rates_);
}

void FolderImport::readQuotes()
{
    enum { kDate, kTicker, kClose, kMarket, kCurrency };
    // An export has those of a company one behind the other, so that most rows need no look-up.
    std::unordered_map<Company*, std::vector<DatedValue>> values;
    std::vector<DatedValue>* ofLast = nullptr;
    std::string ticker, market, currency;
    for (ExportedTable row(folder_, kQuotes); row.next();) {
        const bool isLast =
            row.cell(kTicker) == ticker && row.cell(kMarket) == market && row.cell(kCurrency) == currency;
        if (ofLast == nullptr || !isLast) {
            ofLast = &values[companyOf(row, kTicker, kMarket, kCurrency)];
            ticker = row.cell(kTicker);
            market = row.cell(kMarket);
            currency = row.cell(kCurrency);
        }
        ofLast->push_back({row.date(kDate), row.number(kClose)});
    }
    for (auto& [company, dated] : values)
        updateSeries(*company, std::move(dated), &quotes_);
}

void FolderImport::readEvents()
{
    enum { kDate, kTicker, kMarket, kCurrency, kType, kTitle, kText, kNumerator, kDivider };
    // Of each company those that were there before, of which one stands for one row.
    std::unordered_map<const Company*, std::multiset<EventText>> before;
    for (ExportedTable row(folder_, kEvents); row.next();) {
        Company* company = companyOf(row, kTicker, kMarket, kCurrency);
        const auto [known, isFirst] = before.try_emplace(company);
        if (isFirst)
            for (const CompanyEvent* event : company->events())
                known->second.insert(textOf(*event));
        CompanyEvent* event; // owned by the company
        if (row.cell(kType) == kSplit)
            event =
                new SplitCompanyEvent(company, row.date(kDate), row.smallCount(kNumerator), row.smallCount(kDivider));
        else if (row.cell(kType) == kNote)
            event = new NoteCompanyEvent(company, row.date(kDate), toString(unescaped(row.cell(kTitle))),
                                         toString(unescaped(row.cell(kText))));
        else
            row.refuse(shown(row.cell(kType)) + " is no type of event");
        const auto same = known->second.find(textOf(*event));
        if (same == known->second.end())
            continue;
        known->second.erase(same);
        delete event;
    }
}

Currency* FolderImport::currencyOf(const ExportedTable& row, std::size_t column) const
{
    Currency* currency = found(currencies_, row.cell(column));
    if (currency == nullptr)
        row.refuseUnknown(column);
    return currency;
}

Market* FolderImport::marketOf(const ExportedTable& row, std::size_t market, std::size_t currency) const
{
    Market* named = found(markets_, {currencyOf(row, currency), row.cell(market)});
    if (named == nullptr)
        row.refuseUnknown(market);
    return named;
}

Company* FolderImport::companyOf(const ExportedTable& row, std::size_t ticker, std::size_t market,
                                 std::size_t currency) const
{
    Company* named = found(companies_, {marketOf(row, market, currency), row.cell(ticker)});
    if (named == nullptr)
        row.refuseUnknown(ticker);
    return named;
}
