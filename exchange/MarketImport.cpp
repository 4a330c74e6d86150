#include "exchange/MarketImport.h"

#include "foundation/DateText.h"
#include "market/Catalogue.h"

#include <algorithm>
#include <utility>

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
const TableForm kQuotes = {kQuoteHeadings, {Column::kDate, Column::kTicker, Column::kValue}, 3, true};
const TableForm kRates = {kRateHeadings, {Column::kDate, Column::kCurrency, Column::kValue}, 3, true};
const TableForm kListing = {kQuoteHeadings, {Column::kTicker, Column::kMarket, Column::kCurrency, Column::kName}, 1};

/// `form` with the columns where a person has told them to be.
TableForm formWith(TableForm form, const std::map<Column, std::string>& keys)
{
    for (auto& [column, names] : form.headings) {
        for (const auto& [told, key] : keys)
            std::erase(names, key); // it means what it was told to mean, and nothing else
        if (const auto told = keys.find(column); told != keys.end())
            names.assign(told->second.empty() ? 0 : 1, told->second);
    }
    return form;
}

/// As `Table` compares them.
std::map<Column, std::string> keysOf(const std::map<Column, std::string>& columns)
{
    std::map<Column, std::string> keys;
    for (const auto& [column, heading] : columns)
        keys[column] = Table::headingOf(heading);
    return keys;
}

/// The fields of the first line, unless that has a date, and so values. None of them means anything yet.
std::vector<std::string> unknownHeadings(const std::string& path)
{
    CsvReader reader(path);
    const auto isDate = [](const std::string& field) { return parseDate(field).has_value(); };
    const bool hasValues = !reader.next() || std::ranges::any_of(reader.fields(), isDate);
    return hasValues ? std::vector<std::string>() : reader.fields();
}

/// "folder/BRK.B.csv.gz" holds the quotes of BRK.B.
std::string tickerOf(const std::string& path)
{
    std::string name = path.substr(path.find_last_of('/') + 1);
    for (const std::string_view ending : {".gz", ".csv", ".tsv", ".txt"})
        if (name.ends_with(ending))
            name.resize(name.size() - ending.size());
    return name;
}

template <class Series>
bool hasValues(const Series& all)
{
    return std::ranges::any_of(all, [](const auto& series) { return !series.values.empty(); });
}

} // namespace

const TableForm kQuotesOfOneTicker = {kQuoteHeadings, {Column::kDate, Column::kValue}, 2};

MarketImport::MarketImport(const ImportOptions& options, const Catalogue& catalogue, TableWatch watch)
    : options_(options), watch_(std::move(watch)), places_(catalogue, plan_, {options.market, options.currency})
{
    // The reference exists from here on, so that every other new currency is made with it, and stands behind it.
    plan_.reference = catalogue.getReferenceCurrency();
    if (plan_.reference == nullptr || plan_.reference->getRepresentation() != options_.reference.c_str())
        plan_.reference = places_.currency(options_.reference);
}

MarketTableHead MarketImport::headOf(const std::string& path, bool areRates, const std::map<Column, std::string>& told)
{
    const auto keys = keysOf(told);
    // Nothing is required, so that whatever the first line says can be told.
    TableForm form = formWith(areRates ? kRates : kQuotes, keys);
    form.required = 0;
    const Table table(path, form);
    MarketTableHead head{table.headings(), {}, {}};
    if (head.headings.empty())
        head.headings = unknownHeadings(path);
    for (const auto& entry : form.headings)
        if (std::string heading = table.heading(entry.column); !heading.empty())
            head.columns[entry.column] = std::move(heading);
    for (const Table::WideColumn& column : table.wideColumns())
        head.wide.push_back(column.name);
    return head;
}

void MarketImport::addListing(const std::string& path)
{
    Table table(path, kListing);
    plan_.refused += table.forEach([&] { takeListed(table); }, watch_);
}

void MarketImport::addRates(const std::string& path)
{
    const auto told = keysOf(options_.columns);
    Table table(path, formWith(kRates, told));
    const bool units = areUnits(table, path);
    const bool isWide = !table.wideColumns().empty();
    for (const Table::WideColumn& column : table.wideColumns())
        (void)places_.currency(column.name); // the heading is its first mention, whichever has the first value
    plan_.refused += table.forEach([&] { isWide ? takeRates(table, units) : takeRate(table, units); }, watch_);
}

void MarketImport::addQuotes(const std::string& path)
{
    const auto told = keysOf(options_.columns);
    Table table(path, formWith(options_.tickerFromName ? kQuotesOfOneTicker : kQuotes, told));
    // A table that has a ticker column goes by it, whatever its file is called.
    const std::string tickerOfFile = table.has(Column::kTicker) ? std::string() : tickerOf(path);
    const bool isWide = !table.wideColumns().empty();
    mentionCompanies(table);
    plan_.refused += table.forEach([&] { isWide ? takeQuotes(table) : takeQuote(table, tickerOfFile); }, watch_);
}

/// The headings of a wide table are the first mention of its companies, whichever has the first value.
void MarketImport::mentionCompanies(const Table& table)
{
    // Where the rows tell something of the place, a company is mentioned by its first row.
    if (table.has(Column::kMarket) || table.has(Column::kCurrency))
        return;
    for (const Table::WideColumn& column : table.wideColumns())
        try {
            companyOf(table, column.name);
        } catch (const UnusableRow&) {
            // It is told with each of its values.
        }
}

/// What the heading says, unless it contradicts the options: a rate taken the wrong way round would go unnoticed.
bool MarketImport::areUnits(const Table& rates, const std::string& path) const
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

void MarketImport::takeListed(const Table& row)
{
    const std::string ticker(row.cell(Column::kTicker));
    if (ticker.empty())
        throw UnusableRow("has no ticker");
    Listed listed{{std::string(row.cell(Column::kMarket)), std::string(row.cell(Column::kCurrency))},
                  std::string(row.cell(Column::kName))};
    // Settles the market's currency before the quotes come, or throws when an earlier line has settled another one.
    if (!listed.named.currency.empty())
        places_.mention(ticker, listed.named);
    listing_[ticker] = std::move(listed);
}

void MarketImport::takeRate(Table& row, bool units)
{
    const std::string symbol(row.cell(Column::kCurrency));
    if (symbol.empty())
        throw UnusableRow("has no currency");
    const Date date = row.date();
    addRate(symbol, {date, row.value(units)});
}

void MarketImport::takeRates(Table& row, bool units)
{
    takeWide(row, units, [&](const std::string& symbol, const DatedValue& value) { addRate(symbol, value); });
}

void MarketImport::takeQuote(Table& row, const std::string& tickerOfFile)
{
    const std::string_view cell = row.cell(Column::kTicker);
    const std::string ticker = cell.empty() ? tickerOfFile : std::string(cell);
    if (ticker.empty())
        throw UnusableRow("has no ticker");
    const Date date = row.date();
    addQuote(row, ticker, {date, row.value(false)});
}

void MarketImport::takeQuotes(Table& row)
{
    takeWide(row, false, [&](const std::string& ticker, const DatedValue& value) { addQuote(row, ticker, value); });
}

/// Takes the values of a row of a wide table: `take(name, value)`. Throws an UnusableRow in the end, when all that
/// could be used has been taken, for the cells that could not.
template <class Take>
void MarketImport::takeWide(Table& row, bool inverted, const Take& take)
{
    const Date date = row.date();
    std::string reasons;
    std::size_t unusable = 0;
    for (const Table::WideColumn& column : row.wideColumns()) {
        const std::string_view cell = row.cell(column);
        if (cell.empty())
            continue;
        try {
            take(column.name, DatedValue{date, row.value(cell, inverted)});
        } catch (const UnusableRow& reason) {
            constexpr std::size_t kTold = 3;
            if (++unusable <= kTold)
                reasons += (reasons.empty() ? "" : "; ") + column.name + ": " + reason.what();
            else if (unusable == kTold + 1)
                reasons += "; and more";
        }
    }
    if (unusable > 0)
        throw UnusableRow(reasons);
}

void MarketImport::addRate(const std::string& symbol, const DatedValue& value)
{
    // 1 is what `giveReferenceItsRates` gives the reference, so such a line is taken like any other.
    // All else is relative to it: a file that gives it another rate means another reference.
    if (symbol == options_.reference && value.value != 1)
        throw UnusableRow("gives the reference currency a rate that is not 1");
    places_.ratesOf(places_.currency(symbol))->values.push_back(value);
}

void MarketImport::addQuote(const Table& row, const std::string& ticker, const DatedValue& value)
{
    SeriesValues<Company>& quotes = *companyOf(row, ticker);
    // What is there keeps its name. Of a wide table the row is not about a single company.
    if (quotes.isNew && row.wideColumns().empty())
        if (const std::string name(row.cell(Column::kName)); !name.empty() && quotes.owner->getName().bytes() != name)
            quotes.owner->setName(name.c_str());
    quotes.values.push_back(value);
}

/// Most rows name their company in the same words as an earlier one.
SeriesValues<Company>* MarketImport::companyOf(const Table& row, const std::string& ticker)
{
    constexpr char kMark = '\0'; // is in no cell
    std::string key = ticker + kMark;
    (key += row.cell(Column::kMarket)) += kMark;
    key += row.cell(Column::kCurrency);
    if (const auto known = rows_.find(key); known != rows_.end())
        return known->second;
    // What the row says comes before what the listing says, and that before the options.
    const auto found = listing_.find(ticker);
    const Listed listed = found != listing_.end() ? found->second : Listed();
    MarketPlaces::Named named{std::string(row.cell(Column::kMarket)), std::string(row.cell(Column::kCurrency))};
    if (named.market.empty())
        named.market = listed.named.market;
    // The listing's currency is that of the listing's market. A row that names another market has to be told of its
    // currency by itself, or takes the one that the market already has.
    if (named.currency.empty() && named.market == listed.named.market)
        named.currency = listed.named.currency;
    return rows_[key] = places_.company(ticker, named, listed.name.empty() ? ticker : listed.name);
}

MarketPlan MarketImport::plan()
{
    if (!hasValues(plan_.quotes) && !hasValues(plan_.rates))
        throw std::runtime_error("there is no usable quote or rate in the input");
    // Until here the values are only gathered, in the order of the lines.
    plan_.giveReferenceItsRates(places_.ratesOf(plan_.reference)->values);
    checkRates();
    latestDay_ = plan_.lastDay().date();
    plan_.settle();
    plan_.dropUnused();
    return std::move(plan_);
}

void MarketImport::checkRates() const
{
    std::unordered_set<const Currency*> rated;
    for (const auto& rates : plan_.rates)
        if (!rates.values.empty())
            rated.insert(rates.owner);
    // A currency whose rates are all 0 leaves a total at 0 as well.
    const auto hasRate = [](const Currency& currency) {
        return std::ranges::any_of(currency.quotes(), [](const auto* rate) { return rate->getValue() > 0; });
    };
    std::string missing;
    for (const auto& quotes : plan_.quotes)
        if (!quotes.values.empty() && !hasRate(*quotes.currency) && rated.insert(quotes.currency).second)
            missing += (missing.empty() ? "" : "; ") + std::string("no rate of ") +
                       shown(quotes.currency->getRepresentation().bytes()) + ", in which " +
                       shown(quotes.owner->getAbbreviation().bytes()) + " is quoted";
    if (!missing.empty())
        throw MissingRate(missing);
}
