#include "exchange/Importer.h"

#include "market/Catalogue.h"
#include "market/Company.h"
#include "market/Currency.h"
#include "market/Market.h"

#include <algorithm>
#include <ostream>
#include <stdexcept>

namespace {

// Where several columns could be the price, the one as traded is better than one that the source has adjusted.
const std::vector<TableForm::Headings> kQuoteHeadings = {
    {Column::kDate, {"date", "tradedate"}},
    {Column::kTicker, {"ticker", "symbol", "abbreviation", "code"}},
    {Column::kValue,
     {"close", "closingprice", "closeprice", "price", "last", "quote", "value", "adjclose", "adjustedclose"}},
    {Column::kMarket, {"market", "exchange"}},
    {Column::kCurrency, {"currency", "currencycode", "ccy"}},
    {Column::kName, {"name", "company", "companyname"}},
};

const std::vector<TableForm::Headings> kRateHeadings = {
    {Column::kDate, {"date"}},
    {Column::kCurrency, {"currency", "currencycode", "ccy", "symbol", "code"}},
    {Column::kValue, {"unitsper*", "valuein*", "rate", "exchangerate", "value", "quote", "price"}},
};

// Of each: the headings, the columns of a table without a header line, and how many of these must be there. A listing
// needs the ticker only, since all else in it may be left open.
const TableForm kQuotes = {kQuoteHeadings, {Column::kDate, Column::kTicker, Column::kValue}, 3};
const TableForm kRates = {kRateHeadings, {Column::kDate, Column::kCurrency, Column::kValue}, 3};
const TableForm kListing = {kQuoteHeadings, {Column::kTicker, Column::kMarket, Column::kCurrency, Column::kName}, 1};

/// "folder/BRK.B.csv.gz" holds the quotes of BRK.B.
std::string tickerOf(const std::string& path)
{
    std::string name = path.substr(path.find_last_of('/') + 1);
    for (const std::string_view ending : {".gz", ".csv", ".tsv", ".txt"})
        if (name.ends_with(ending))
            name.resize(name.size() - ending.size());
    return name;
}

String toString(const std::string& text)
{
    return String(text.c_str());
}

/// Links the values to their owners. @return how many.
template <class Quoted, class Map>
std::size_t addAll(Map& valuesByOwner, Date* latest)
{
    std::size_t count = 0;
    for (auto& [owner, values] : valuesByOwner) {
        for (const auto& [date, value] : values)
            new Quoted(owner, date, value); // owned by the series it links itself into
        *latest = std::max(*latest, values.rbegin()->first);
        count += values.size();
        // They are in the series now.
        values.clear();
    }
    return count;
}

} // namespace

const TableForm kQuotesOfOneTicker = {kQuoteHeadings, {Column::kDate, Column::kValue}, 2};

Importer::Importer(const ImportOptions& options, Catalogue& catalogue, std::ostream& log)
    : options_(options), catalogue_(catalogue), log_(log)
{
    // The reference exists from here on, so that every other currency is made with it.
    // `findCurrency` adds it to the catalogue, as the first one: the file lists the reference before all others.
    catalogue.setReferenceCurrency(findCurrency(options_.reference));
}

void Importer::addListing(const std::string& path)
{
    Table table(path, kListing);
    counts_.skipped += table.forEach([&] { takeListed(table); }, log_);
}

void Importer::addRates(const std::string& path)
{
    Table table(path, kRates);
    const bool units = areUnits(table, path);
    counts_.skipped += table.forEach([&] { takeRate(table, units); }, log_);
}

void Importer::addQuotes(const std::string& path)
{
    Table table(path, options_.tickerFromName ? kQuotesOfOneTicker : kQuotes);
    // A table that has a ticker column goes by it, whatever its file is called.
    const std::string tickerOfFile = table.has(Column::kTicker) ? std::string() : tickerOf(path);
    counts_.skipped += table.forEach([&] { takeQuote(table, tickerOfFile); }, log_);
}

/// What the heading says, unless it contradicts the options: a rate taken the wrong way round would go unnoticed.
bool Importer::areUnits(const Table& rates, const std::string& path) const
{
    const std::string& heading = rates.valueHeading();
    for (const std::string prefix : {"unitsper", "valuein"}) {
        if (!heading.starts_with(prefix))
            continue;
        const std::string currency = heading.substr(prefix.size());
        if (currency != "reference" && currency != Table::headingOf(options_.reference))
            throw std::runtime_error(path + ": its rates refer to " + shown(currency) + ", not to the reference " +
                                     options_.reference);
        // The heading names the reference, so it can be trusted; an option that says the opposite is a mistake of the
        // user's.
        const bool units = prefix == "unitsper";
        if (options_.ratesAreUnits.value_or(units) != units)
            throw std::runtime_error(path + ": its heading " + shown(heading) + " contradicts the option --rates-are");
        return units;
    }
    return options_.ratesAreUnits.value_or(true);
}

void Importer::takeListed(const Table& row)
{
    const std::string ticker(row.cell(Column::kTicker));
    if (ticker.empty())
        throw UnusableRow("has no ticker");
    Listed listed{std::string(row.cell(Column::kMarket)), std::string(row.cell(Column::kCurrency)),
                  std::string(row.cell(Column::kName))};
    // Settles the market's currency before the quotes come, or throws when an earlier line has settled another one.
    if (!listed.currency.empty())
        findMarket(listed.market, listed.currency);
    listing_[ticker] = std::move(listed);
}

void Importer::takeRate(Table& row, bool units)
{
    const std::string symbol(row.cell(Column::kCurrency));
    if (symbol.empty())
        throw UnusableRow("has no currency");
    const Date date = row.date();
    const float rate = row.value(units);
    // 1 is what `giveReferenceItsRates` gives the reference, so such a line is taken like any other.
    // All else is relative to it: a file that gives it another rate means another reference.
    if (symbol == options_.reference && rate != 1)
        throw UnusableRow("gives the reference currency a rate that is not 1");
    addValue(rates_[findCurrency(symbol)], date, rate);
}

void Importer::takeQuote(Table& row, const std::string& tickerOfFile)
{
    const std::string_view cell = row.cell(Column::kTicker);
    const std::string ticker = cell.empty() ? tickerOfFile : std::string(cell);
    if (ticker.empty())
        throw UnusableRow("has no ticker");
    const Date date = row.date();
    const float close = row.value(false);
    auto& [company, quotes] = *findCompany(row, ticker);
    const std::string name(row.cell(Column::kName));
    if (!name.empty() && company->getName().bytes() != name)
        company->setName(toString(name));
    addValue(quotes, date, close);
}

void Importer::addValue(Values& values, const Date& date, float value)
{
    // Nothing is in the series yet: `finish` moves the values there. So the later of two lines can simply win here.
    const std::size_t before = values.size();
    values.insert_or_assign(values.end(), date, value); // most tables are in date order
    counts_.replaced += values.size() == before;
}

/// Most rows name their company in the same words as an earlier one.
Importer::CompanyValues* Importer::findCompany(const Table& row, const std::string& ticker)
{
    constexpr char kMark = '\n'; // is in no cell
    std::string key = ticker + kMark;
    (key += row.cell(Column::kMarket)) += kMark;
    key += row.cell(Column::kCurrency);
    const auto known = rows_.find(key);
    // The pointer stays good: a map that grows moves no entry.
    return known != rows_.end() ? known->second : rows_[key] = placeCompany(row, ticker);
}

/// Finds the company that a row is about or makes it. What the row says comes before what the listing says, and that
/// before the options.
Importer::CompanyValues* Importer::placeCompany(const Table& row, const std::string& ticker)
{
    const auto found = listing_.find(ticker);
    const Listed listed = found != listing_.end() ? found->second : Listed();
    std::string marketName(row.cell(Column::kMarket));
    if (marketName.empty())
        marketName = listed.market;
    std::string currency(row.cell(Column::kCurrency));
    // The listing's currency is that of the listing's market. A row that names another market has to be told of its
    // currency by itself, or takes the one that the market already has.
    if (currency.empty() && marketName == listed.market)
        currency = listed.currency;
    // Throws for a row that contradicts what is known of the market. Nothing has been made for the row by then.
    Market* market = findMarket(marketName, currency);
    Company*& company = companies_[{market, ticker.c_str()}];
    if (company == nullptr)
        // The market owns it. Names that come later in the file replace the ticker that stands in for one.
        company = new Company(market, toString(listed.name.empty() ? ticker : listed.name), toString(ticker));
    return &*quotes_.try_emplace(company).first;
}

/// Finds a market or makes it. An empty name stands for the market of the options. An empty currency stands for that of
/// the market, or if it is new, for that of the options.
Market* Importer::findMarket(const std::string& nameOrNone, const std::string& currency)
{
    // Else a first line like that would settle in what currency all tickers of unknown market are quoted.
    if (nameOrNone.empty() && !currency.empty() && currency != options_.currency)
        throw UnusableRow("has the currency " + shown(currency) + " but no market");
    const std::string& name = nameOrNone.empty() ? options_.market : nameOrNone;
    Market*& market = markets_[name.c_str()];
    if (market == nullptr) {
        market = new Market(toString(name)); // owned by its currency
        market->setCurrency(findCurrency(currency.empty() ? options_.currency : currency));
        return market;
    }
    const std::string known(market->getCurrencyRepresentation().bytes());
    if (!currency.empty() && currency != known)
        throw UnusableRow("has " + shown(currency) + " for the market " + shown(name) + ", which trades in " +
                          shown(known));
    return market;
}

Currency* Importer::findCurrency(const std::string& symbol)
{
    Currency*& currency = currencies_[symbol.c_str()];
    if (currency == nullptr) {
        currency = new Currency(toString(symbol), toString(symbol), catalogue_.getReferenceCurrency());
        catalogue_.addCurrency(currency);
    }
    return currency;
}

Date Importer::finish()
{
    if (quotes_.empty() && rates_.empty())
        throw std::runtime_error("there is no usable quote or rate in the input");
    // Until here rates and quotes are only gathered. Each series is filled once, and in order.
    giveReferenceItsRates();
    tellDoubts();
    counts_.companies = quotes_.size();
    counts_.currencies = catalogue_.getNbrCurrencies();
    // The reference has a rate on every day of a rate, so its last one is the latest of all rates.
    Date latest = rates_[catalogue_.getReferenceCurrency()].rbegin()->first;
    counts_.rates = addAll<CurrencyQuote>(rates_, &latest);
    counts_.quotes = addAll<CompanyQuote>(quotes_, &latest);
    return latest;
}

/// The reference is worth 1 on every day for which any rate is known. Without rates one day is enough, the first of the
/// quotes, since a single quote holds for ever.
void Importer::giveReferenceItsRates()
{
    Values& ones = rates_[catalogue_.getReferenceCurrency()];
    for (const auto& [currency, values] : rates_)
        for (const auto& [date, rate] : values)
            ones.try_emplace(date, 1.0F);
    if (!ones.empty())
        return;
    const auto firstDay = [](const CompanyValues& quotes) { return quotes.second.begin()->first; };
    ones[firstDay(*std::ranges::min_element(quotes_, {}, firstDay))] = 1;
}

/// Warns of what is probably not as the user thinks, without being an error.
void Importer::tellDoubts() const
{
    for (Currency* currency : catalogue_.getCurrencies())
        if (currency->getNbrMarkets() > 0 && !rates_.contains(currency))
            log_ << "warning: no rate of " << currency->getRepresentation().bytes()
                 << ": its companies will be worth nothing in " << options_.reference << '\n';
}
