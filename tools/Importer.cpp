#include "tools/Importer.h"

#include "market/Catalogue.h"
#include "market/Company.h"
#include "market/Currency.h"
#include "market/Market.h"
#include "tools/DateText.h"
#include "tools/TableReader.h"

#include <algorithm>
#include <limits>
#include <ostream>
#include <stdexcept>

namespace {

// Where several columns could be the price, the one as traded is better than one that the source has adjusted.
const std::vector<ColumnNames> kQuoteNames = {
    {Column::kDate, {"date", "tradedate"}},
    {Column::kTicker, {"ticker", "symbol", "abbreviation", "code"}},
    {Column::kValue,
     {"close", "closingprice", "closeprice", "price", "last", "quote", "value", "adjclose", "adjustedclose"}},
    {Column::kMarket, {"market", "exchange"}},
    {Column::kCurrency, {"currency", "currencycode", "ccy"}},
    {Column::kName, {"name", "company", "companyname"}},
};

const std::vector<ColumnNames> kRateNames = {
    {Column::kDate, {"date"}},
    {Column::kCurrency, {"currency", "currencycode", "ccy", "symbol", "code"}},
    {Column::kValue, {"unitsper*", "valuein*", "rate", "exchangerate", "value", "quote", "price"}},
};

const TableForm kQuotes = {
    kQuoteNames, {Column::kDate, Column::kTicker, Column::kValue}, {Column::kDate, Column::kTicker, Column::kValue}};
const TableForm kQuotesOfOneTicker = {kQuoteNames, {Column::kDate, Column::kValue}, {Column::kDate, Column::kValue}};
const TableForm kRates = {
    kRateNames, {Column::kDate, Column::kCurrency, Column::kValue}, {Column::kDate, Column::kCurrency, Column::kValue}};
const TableForm kListing = {
    kQuoteNames, {Column::kTicker, Column::kMarket, Column::kCurrency, Column::kName}, {Column::kTicker}};

constexpr char kKeyMark = '\n'; // between the parts of a key

/// A piece of the input for a message: no longer than a line bears, and without control characters.
std::string shown(std::string_view text)
{
    constexpr std::size_t kLongest = 40;
    std::string result(text.substr(0, kLongest));
    std::replace_if(
        result.begin(), result.end(), [](unsigned char c) { return c < ' ' || c == 0x7F; }, '?');
    return '"' + result + (text.size() > kLongest ? "...\"" : "\"");
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

/// Rounds to the 32 bits of a quote. @return false when they hold no positive finite number then.
bool roundPositive(double number, float* out)
{
    if (!(number > 0 && number <= static_cast<double>(std::numeric_limits<float>::max())))
        return false;
    *out = static_cast<float>(number);
    return *out > 0;
}

std::string dateReason(std::string_view text)
{
    return shown(text) + " is no date as YYYY-MM-DD or DD/MM/YYYY";
}

std::string numberReason(std::string_view text, char decimalMark)
{
    return shown(text) + " is no positive number with decimal '" + decimalMark + "'";
}

template <class Quoted, class Owner>
void addAll(DatedValues* values, Owner* owner)
{
    for (const DatedValues::Entry& entry : values->entries())
        new Quoted(owner, DatedValues::dateOf(entry.day), entry.value); // owned by the series it links itself into
    values->clear();
}

String toString(const std::string& text)
{
    return String(text.c_str());
}

} // namespace

Importer::Importer(const ImportOptions& options, std::ostream& log) : options_(options), log_(log)
{
    findCurrency(options_.reference);
}

void Importer::addListing(const std::string& path)
{
    TableReader table(path, kListing, log_);
    while (table.next())
        if (const std::string reason = takeListed(table); !reason.empty())
            table.reject(reason);
    counts_.skipped += table.rejected();
}

void Importer::addRates(const std::string& path)
{
    TableReader table(path, kRates, log_);
    const RateMeaning meaning = meaningOf(table, path);
    while (table.next())
        if (const std::string reason = takeRate(table, meaning); !reason.empty())
            table.reject(reason);
    counts_.skipped += table.rejected();
}

void Importer::addQuotes(const std::string& path)
{
    TableReader table(path, options_.tickerFromName ? kQuotesOfOneTicker : kQuotes, log_);
    const std::string tickerOfFile = table.columns().has(Column::kTicker) ? std::string() : tickerOf(path);
    while (table.next())
        if (const std::string reason = takeQuote(table, tickerOfFile); !reason.empty())
            table.reject(reason);
    counts_.skipped += table.rejected();
}

/// What the heading says, unless it contradicts the options: a rate taken the wrong way round would go unnoticed.
RateMeaning Importer::meaningOf(const TableReader& rates, const std::string& path) const
{
    const struct {
        std::string_view prefix;
        RateMeaning meaning;
    } kHeadings[] = {{"unitsper", RateMeaning::kUnitsPerReference}, {"valuein", RateMeaning::kValueInReference}};
    const std::string_view heading = rates.columns().valueHeading();
    for (const auto& known : kHeadings) {
        if (!heading.starts_with(known.prefix))
            continue;
        const std::string_view currency = heading.substr(known.prefix.size());
        if (currency != "reference" && currency != Columns::headingOf(options_.reference))
            throw std::runtime_error(path + ": its rates refer to " + shown(currency) + ", not to the reference " +
                                     options_.reference);
        if (options_.ratesAre.value_or(known.meaning) != known.meaning)
            throw std::runtime_error(path + ": its heading " + shown(heading) + " contradicts the option --rates-are");
        return known.meaning;
    }
    return options_.ratesAre.value_or(RateMeaning::kUnitsPerReference);
}

std::string Importer::takeListed(const TableReader& row)
{
    const std::string ticker(row.cell(Column::kTicker));
    if (ticker.empty())
        return "has no ticker";
    Listed listed{std::string(row.cell(Column::kMarket)), std::string(row.cell(Column::kCurrency)),
                  std::string(row.cell(Column::kName))};
    if (!listed.currency.empty()) {
        Index market;
        if (const std::string reason = findMarket(listed.market, listed.currency, &market); !reason.empty())
            return reason;
    }
    listing_[ticker] = std::move(listed);
    return {};
}

std::string Importer::takeRate(TableReader& row, RateMeaning meaning)
{
    const std::string_view symbol = row.cell(Column::kCurrency);
    if (symbol.empty())
        return "has no currency";
    const std::optional<Date> date = parseDate(row.cell(Column::kDate));
    if (!date)
        return dateReason(row.cell(Column::kDate));
    const std::string_view text = row.cell(Column::kValue);
    const double number = row.numbers().read(text).value_or(0);
    float rate;
    const bool inverted = meaning == RateMeaning::kUnitsPerReference && number != 0;
    if (!roundPositive(inverted ? 1 / number : number, &rate))
        return numberReason(text, row.numbers().mark());
    if (symbol == options_.reference && rate != 1)
        return "gives the reference currency a rate that is not 1";
    currencies_[findCurrency(symbol)].rates.add(DatedValues::dayOf(*date), rate);
    return {};
}

std::string Importer::takeQuote(TableReader& row, std::string_view tickerOfFile)
{
    const std::string_view cell = row.cell(Column::kTicker);
    const std::string_view ticker = cell.empty() ? tickerOfFile : cell;
    if (ticker.empty())
        return "has no ticker";
    const std::optional<Date> date = parseDate(row.cell(Column::kDate));
    if (!date)
        return dateReason(row.cell(Column::kDate));
    const std::string_view text = row.cell(Column::kValue);
    float close;
    if (!roundPositive(row.numbers().read(text).value_or(0), &close))
        return numberReason(text, row.numbers().mark());
    CompanyData* company;
    if (std::string reason = findCompany(row, ticker, &company); !reason.empty())
        return reason;
    company->quotes.add(DatedValues::dayOf(*date), close);
    return {};
}

/// Most rows are for the same company as the row before, or name it in the same words as an earlier one.
std::string Importer::findCompany(const TableReader& row, std::string_view ticker, CompanyData** out)
{
    std::string key(ticker);
    (key += kKeyMark) += row.cell(Column::kMarket);
    (key += kKeyMark) += row.cell(Column::kCurrency);
    if (key != rowKey_) {
        const auto known = rowIndex_.find(key);
        if (known != rowIndex_.end()) {
            rowCompany_ = known->second;
        } else {
            if (std::string reason = placeCompany(row, ticker, &rowCompany_); !reason.empty())
                return reason;
            rowIndex_.emplace(key, rowCompany_);
        }
        rowKey_ = key;
    }
    *out = &companies_[rowCompany_];
    const std::string_view name = row.cell(Column::kName);
    if (!name.empty() && name != (*out)->name)
        (*out)->name = name;
    return {};
}

/// Finds the company that a row is about or makes it. What the row says comes before what the listing says, and that
/// before the options.
std::string Importer::placeCompany(const TableReader& row, std::string_view ticker, Index* out)
{
    const auto found = listing_.find(std::string(ticker));
    const Listed listed = found != listing_.end() ? found->second : Listed();
    std::string marketName(row.cell(Column::kMarket));
    if (marketName.empty())
        marketName = listed.market;
    std::string currency(row.cell(Column::kCurrency));
    if (currency.empty() && marketName == listed.market)
        currency = listed.currency;
    Index market;
    if (std::string reason = findMarket(marketName, currency, &market); !reason.empty())
        return reason;

    const std::string key = std::string(ticker) + kKeyMark + markets_[market].name;
    const auto [company, isNew] = companyIndex_.try_emplace(key, companies_.size());
    if (isNew) {
        const std::string name = listed.name.empty() ? std::string(ticker) : listed.name;
        companies_.push_back({std::string(ticker), name, market, {}});
        currencies_[markets_[market].currency].hasCompanies = true;
    }
    *out = company->second;
    return {};
}

/// Finds a market or makes it. An empty name stands for the market of the options. An empty currency stands for that of
/// the market, or if it is new, for that of the options.
std::string Importer::findMarket(const std::string& nameOrNone, const std::string& currency, Index* out)
{
    // Else a first line like that would settle in what currency all tickers of unknown market are quoted.
    if (nameOrNone.empty() && !currency.empty() && currency != options_.currency)
        return "has the currency " + shown(currency) + " but no market";
    const std::string& name = nameOrNone.empty() ? options_.market : nameOrNone;
    const auto found = marketIndex_.find(name);
    if (found == marketIndex_.end()) {
        *out = markets_.size();
        markets_.push_back({name, findCurrency(currency.empty() ? options_.currency : currency)});
        marketIndex_.emplace(name, *out);
        return {};
    }
    *out = found->second;
    const std::string& known = currencies_[markets_[*out].currency].symbol;
    if (!currency.empty() && currency != known)
        return "has " + shown(currency) + " for the market " + shown(name) + ", which trades in " + shown(known);
    return {};
}

Importer::Index Importer::findCurrency(std::string_view symbol)
{
    const auto [currency, isNew] = currencyIndex_.try_emplace(std::string(symbol), currencies_.size());
    if (isNew)
        currencies_.push_back({std::string(symbol), {}});
    return currency->second;
}

Date Importer::fill(Catalogue* catalogue)
{
    settle();
    if (counts_.quotes == 0 && counts_.rates == 0)
        throw std::runtime_error("there is no usable quote or rate in the input");
    giveReferenceItsRates();
    tellDoubts();
    const Date latest = latestDay();
    const std::vector<Currency*> currencies = makeCurrencies(catalogue);
    makeCompanies(currencies);
    return latest;
}

/// Puts all series in date order and counts what is in them.
void Importer::settle()
{
    for (CurrencyData& currency : currencies_) {
        counts_.replaced += currency.rates.settle();
        counts_.rates += currency.rates.entries().size();
    }
    for (CompanyData& company : companies_) {
        counts_.replaced += company.quotes.settle();
        counts_.quotes += company.quotes.entries().size();
    }
    counts_.companies = companies_.size();
}

/// The reference is worth 1 on every day for which any rate is known. Without rates one day is enough, since a single
/// quote holds for ever.
void Importer::giveReferenceItsRates()
{
    DatedValues& ones = currencies_.front().rates;
    const std::size_t given = ones.entries().size();
    for (std::size_t i = 1; i < currencies_.size(); ++i)
        for (const DatedValues::Entry& entry : currencies_[i].rates.entries())
            ones.add(entry.day, 1);
    if (ones.entries().empty())
        ones.add(companies_.front().quotes.entries().front().day, 1);
    ones.settle();
    counts_.rates += ones.entries().size() - given;
}

/// Warns of what is probably not as the user thinks, without being an error.
void Importer::tellDoubts() const
{
    for (const CurrencyData& currency : currencies_)
        if (currency.hasCompanies && currency.rates.entries().empty())
            log_ << "warning: no rate of " << currency.symbol << ": its companies will be worth nothing in "
                 << options_.reference << '\n';
    for (const auto& [symbol, name] : options_.currencyNames)
        if (!currencyIndex_.contains(symbol))
            log_ << "warning: there is no currency " << symbol << " to be named " << name << '\n';
}

Date Importer::latestDay() const
{
    std::int32_t latest = currencies_.front().rates.entries().back().day;
    for (const CompanyData& company : companies_)
        latest = std::max(latest, company.quotes.entries().back().day);
    return DatedValues::dateOf(latest);
}

/// Adds the currencies with their rates to `catalogue`, except those that are only mentioned somewhere.
/// @return by our index; null for one that is left out.
std::vector<Currency*> Importer::makeCurrencies(Catalogue* catalogue)
{
    std::vector<Currency*> made;
    Currency* reference = nullptr;
    for (CurrencyData& data : currencies_) {
        if (data.rates.entries().empty() && !data.hasCompanies) {
            made.push_back(nullptr);
            continue;
        }
        const auto named = options_.currencyNames.find(data.symbol);
        const std::string& name = named != options_.currencyNames.end() ? named->second : data.symbol;
        auto* currency = new Currency(toString(name), toString(data.symbol), reference);
        catalogue->addCurrency(currency);
        addAll<CurrencyQuote>(&data.rates, currency);
        made.push_back(currency);
        reference = made.front();
    }
    catalogue->setReferenceCurrency(reference);
    counts_.currencies = catalogue->getNbrCurrencies();
    return made;
}

/// Makes the companies, and each market with its first company.
void Importer::makeCompanies(const std::vector<Currency*>& currencies)
{
    std::vector<Market*> markets(markets_.size());
    for (CompanyData& data : companies_) {
        Market*& market = markets[data.market];
        if (market == nullptr) {
            market = new Market(toString(markets_[data.market].name));
            market->setCurrency(currencies[markets_[data.market].currency]);
        }
        auto* company = new Company(market, toString(data.name), toString(data.ticker));
        addAll<CompanyQuote>(&data.quotes, company);
    }
}
