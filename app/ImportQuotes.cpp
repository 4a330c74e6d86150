#include "app/ImportQuotes.h"

#include "app/Holds.h"
#include "foundation/DateText.h"
#include "foundation/NumberText.h"
#include "views/CompanyView.h"
#include "views/CurrencyView.h"
#include "views/Look.h"

#include <algorithm>
#include <array>
#include <cctype>
#include <span>
#include <stdexcept>
#include <unordered_map>
#include <unordered_set>

namespace {

constexpr const char* kNone = "(none)";
constexpr std::size_t kMostRefused = 2000; // lines that are told one by one

struct NamedColumn {
    Column column;
    const char* name;
};
constexpr NamedColumn kQuoteColumns[] = {{Column::kDate, "Date"},         {Column::kTicker, "Ticker"},
                                         {Column::kValue, "Price"},       {Column::kMarket, "Market"},
                                         {Column::kCurrency, "Currency"}, {Column::kName, "Name"}};
constexpr NamedColumn kRateColumns[] = {
    {Column::kDate, "Date"}, {Column::kCurrency, "Currency"}, {Column::kValue, "Rate"}};

std::span<const NamedColumn> columnsOf(bool areRates)
{
    return areRates ? std::span<const NamedColumn>(kRateColumns) : kQuoteColumns;
}

const std::vector<ListColumn> kListColumns = {{"Becomes", 72},
                                              {"Line", 56, B_ALIGN_RIGHT},
                                              {"Of", 66},
                                              {"Name", 78},
                                              {"Market", 90},
                                              {"New", 50, B_ALIGN_RIGHT},
                                              {"Changed", 68, B_ALIGN_RIGHT},
                                              {"Equal", 50, B_ALIGN_RIGHT},
                                              {"Note", kRemainingWidth}};

Cell countCell(std::size_t n, rgb_color color)
{
    return {countText(static_cast<int>(n)), color, static_cast<double>(n)};
}

std::vector<Cell> rowOf(const char* becomes, const char* what, const std::string& name, const std::string& place,
                        const MarketPlan::Counts* counts, const std::string& note = {})
{
    const bool isSame = counts != nullptr && counts->added + counts->changed == 0;
    const rgb_color color = isSame ? look::kFaint : look::kText;
    std::vector<Cell> row = {{becomes, color}, {}, {what, color}, {name, color}, {place, color}};
    for (const auto count : {&MarketPlan::Counts::added, &MarketPlan::Counts::changed, &MarketPlan::Counts::equal})
        row.push_back(counts != nullptr ? countCell(counts->*count, color) : Cell{});
    row.push_back({note, color});
    return row;
}

const char* becomesOf(const MarketPlan::Counts& counts, bool isNew)
{
    return isNew ? "New" : counts.added + counts.changed > 0 ? "Changed" : "Equal";
}

/// Of each series the last value that it gets, by which a person sees how days and values were read.
template <class Owner>
std::unordered_map<const Owner*, std::string> lastValues(const std::deque<SeriesValues<Owner>>& all)
{
    std::unordered_map<const Owner*, std::string> texts;
    for (const auto& series : all)
        if (!series.values.empty()) {
            const DatedValue& last = series.values.back();
            texts.emplace(series.owner, "last: " + exactText(last.value) + " on " + dateText(last.day.date()));
        }
    return texts;
}

std::vector<Cell> refusedRow(const std::string& line, double number, const std::string& reason)
{
    std::vector<Cell> row(kListColumns.size());
    row[0] = {"Refused", look::kWarning};
    row[1] = {line, look::kText, number};
    row.back() = {reason, look::kWarning};
    return row;
}

/// Three capitals, as the codes of currencies are.
bool isCode(const std::string& text)
{
    constexpr std::size_t kLength = 3;
    return text.size() == kLength && std::ranges::all_of(text, [](char c) { return c >= 'A' && c <= 'Z'; });
}

std::string countsText(const char* what, const MarketPlan::Counts& counts)
{
    const auto text = [](std::size_t n) { return countText(static_cast<int>(n)); };
    return text(counts.added) + " new, " + text(counts.changed) + " changed, " + text(counts.equal) + " equal " + what;
}

} // namespace

ImportQuotes::ImportQuotes(PLWindow& window, CompanyView& companies, CurrencyView& currencies, const std::string& path,
                           bool areRates)
    : PendingImport(window), companies_(companies), currencies_(currencies), path_(path)
{
    chooseDefaults();
    areRates_ = looksLikeRates(areRates);
    head_ = MarketImport::headOf(path_, areRates_, {});
    setProgress([&window](const std::string& text) { window.showProgress(text); });
    read();
    setProgress(nullptr);
    window.showProgress("");
    if (!plan_ && head_.headings.empty() && refusedCount_ == 0)
        throw std::runtime_error(path + ": is no table of prices or rates");
}

/// What a person who imports beside what is on the pages would say.
void ImportQuotes::chooseDefaults()
{
    const Catalogue& catalogue = window().catalogue();
    if (const Currency* reference = catalogue.getReferenceCurrency())
        options_.reference = reference->getRepresentation().comparedBytes();
    const Market* market = companies_.GetSelectedMarket();
    const auto markets = catalogue.getMarkets();
    if (market == nullptr && !markets.empty())
        market = markets.front();
    if (market == nullptr || market->currency() == nullptr)
        return;
    options_.market = market->getName().comparedBytes();
    options_.currency = market->currency()->getRepresentation().comparedBytes();
}

bool ImportQuotes::looksLikeRates(bool otherwise) const
{
    const MarketTableHead quotes = MarketImport::headOf(path_, false, {});
    const MarketTableHead rates = MarketImport::headOf(path_, true, {});
    const auto keyOf = [](const MarketTableHead& head, Column column) {
        const auto found = head.columns.find(column);
        return found != head.columns.end() ? Table::headingOf(found->second) : std::string();
    };
    // Of a wide table the codes of currencies tell.
    if (!rates.wide.empty() && !quotes.wide.empty()) {
        const auto codes = std::ranges::count_if(rates.wide, isCode);
        const bool areCodes = codes == static_cast<std::ptrdiff_t>(rates.wide.size());
        const bool areKnown = std::ranges::any_of(rates.wide, [](const auto& name) {
            return name == "USD" || name == "EUR" || name == "GBP" || name == "JPY" || name == "CHF";
        });
        return areCodes && (areKnown || otherwise);
    }
    const std::string value = keyOf(rates, Column::kValue);
    for (const std::string_view prefix : {"unitsper", "valuein", "rate", "exchangerate"})
        if (value.starts_with(prefix))
            return true;
    if (keyOf(quotes, Column::kTicker).empty() != rates.columns.contains(Column::kCurrency))
        return otherwise;
    return keyOf(quotes, Column::kTicker).empty();
}

void ImportQuotes::read()
{
    plan_.reset();
    problem_.clear();
    refused_.clear();
    refusedCount_ = 0;
    const std::string name = importedName(path_);
    TableWatch watch;
    watch.progress = [&](const std::string&, double part) {
        tellProgress("Reading " + name + ": " + std::to_string(static_cast<int>(part * 100)) + " %");
    };
    watch.refused = [&](const std::string&, unsigned long line, const std::string& reason) {
        if (++refusedCount_ <= kMostRefused)
            refused_.push_back({line, reason});
    };
    options_.columns = headingsTold(columnsTold_);
    try {
        head_ = MarketImport::headOf(path_, areRates_, options_.columns);
        // A table of one company is named after it.
        options_.tickerFromName = !areRates_ && head_.wide.empty() && !head_.columns.contains(Column::kTicker) &&
                                  head_.columns.contains(Column::kValue);
        // Else prices would be taken for tickers, whatever the headings say.
        if (!head_.headings.empty() && head_.columns.empty())
            throw std::runtime_error("no heading is known: choose below where the date stands, and the other columns");
        MarketImport import(options_, window().catalogue(), watch);
        areRates_ ? import.addRates(path_) : import.addQuotes(path_);
        plan_ = import.plan();
    } catch (const MissingRate& missing) {
        problem_ = withoutPath(missing.what());
        problem_.back() = ':';
        problem_ += std::string(" import its rates first") +
                    (window().getReferenceCurrency() == nullptr ? ", or make it the reference currency." : ".");
    } catch (const std::runtime_error& error) {
        problem_ = withoutPath(error.what());
    }
}

/// The window shows the file's name by itself.
std::string ImportQuotes::withoutPath(const std::string& error) const
{
    std::string text = error.starts_with(path_ + ": ") ? error.substr(path_.size() + 2) : error;
    text[0] = static_cast<char>(std::toupper(static_cast<unsigned char>(text[0])));
    return text + '.';
}

std::string ImportQuotes::problem() const
{
    if (isStale())
        return kStale;
    if (!plan_)
        return problem_;
    return plan_->isEmpty() ? "The market data have all of it." : "";
}

ImportSheet ImportQuotes::sheet()
{
    ImportSheet sheet;
    sheet.title = std::string(areRates_ ? "Rates" : "Prices") + " in " + importedName(path_);
    sheet.columns = kListColumns;
    sheet.headline = importedName(path_);
    sheet.problem = problem();
    if (isStale())
        return sheet;
    sheet.hasRefused = refusedCount_ > 0;
    askForKind(sheet);
    askForColumns(sheet);
    askForPlaces(sheet);
    if (plan_)
        sheet.headline +=
            ":  " + (areRates_ ? countsText("rates", plan_->rateCounts) : countsText("quotes", plan_->quoteCounts));
    if (plan_ || refusedCount_ > 0)
        sheet.headline += std::string(plan_ ? ", " : ":  ") + importedCount(refusedCount_, "line") + " refused";
    if (refusedCount_ > 0)
        sheet.note = "Lines that are refused are left out.";
    if (options_.tickerFromName)
        sheet.note = "The table names no ticker: it is taken for that of the company the file is named after.";
    fillRows(sheet);
    return sheet;
}

void ImportQuotes::askForKind(ImportSheet& sheet) const
{
    sheet.questions.push_back({"importKind",
                               "The table has",
                               true,
                               {"closing prices", "exchange rates"},
                               areRates_ ? 1 : 0,
                               "",
                               "What kind of table it is"});
    const auto value = head_.columns.find(Column::kValue);
    const std::string heading = value != head_.columns.end() ? Table::headingOf(value->second) : "";
    // Where the heading says it, nobody needs to be asked.
    if (areRates_ && !heading.starts_with("unitsper") && !heading.starts_with("valuein"))
        sheet.questions.push_back(
            {"importRates",
             "Rates are",
             false,
             {"units for 1 " + options_.reference, options_.reference + " for one unit"},
             options_.ratesAreUnits.value_or(true) ? 0 : 1,
             "",
             "Central banks and newspapers as a rule print how many units one of the reference currency buys"});
}

void ImportQuotes::askForColumns(ImportSheet& sheet) const
{
    if (head_.headings.empty())
        return;
    const auto columns = columnsOf(areRates_);
    const auto headingOf = [this](Column column) {
        const auto found = head_.columns.find(column);
        return found != head_.columns.end() ? found->second : std::string();
    };
    ImportSheet::Question column{"importColumn", "Column", true};
    for (const NamedColumn& each : columns)
        column.items.push_back(std::string(each.name) + ": " +
                               (headingOf(each.column).empty() ? kNone : headingOf(each.column)));
    column.marked = static_cast<int>(column_);
    column.toolTip = "A column of prices or rates, with the heading under which it stands in the table";
    ImportSheet::Question heading{"importHeading", "stands under", false, {kNone}};
    heading.items.insert(heading.items.end(), head_.headings.begin(), head_.headings.end());
    const auto found = std::ranges::find(heading.items, headingOf(columns[column_].column));
    heading.marked = found != heading.items.end() ? static_cast<int>(found - heading.items.begin()) : 0;
    heading.toolTip = "The heading of that column in the table";
    sheet.questions.push_back(std::move(column));
    sheet.questions.push_back(std::move(heading));
}

void ImportQuotes::askForPlaces(ImportSheet& sheet) const
{
    const auto ask = [&](const char* name, const char* label, bool isFirst, const std::string& text, const char* tip) {
        sheet.questions.push_back({name, label, isFirst, {}, 0, text, tip});
    };
    if (!areRates_) {
        ask("txtImportMarket", "New tickers are at", true, options_.market,
            "The market of tickers that are new and for which the table names none; Enter takes what is typed");
        ask("txtImportCurrency", "in", false, options_.currency,
            "The currency of markets that are new and for which the table names none; Enter takes what is typed");
    }
    if (window().getReferenceCurrency() == nullptr)
        ask("txtImportReference", "Reference currency", true, options_.reference,
            "The currency that all rates and totals are given in from now on; Enter takes what is typed");
}

void ImportQuotes::fillRows(ImportSheet& sheet) const
{
    // What a person has to do something about comes first.
    if (!plan_ && !problem_.empty())
        sheet.rows.push_back(refusedRow("", 0, problem_));
    for (const Refused& refused : refused_)
        sheet.rows.push_back(
            refusedRow(std::to_string(refused.line), static_cast<double>(refused.line), refused.reason));
    if (refusedCount_ > refused_.size())
        sheet.rows.push_back(
            refusedRow("", 1e300, "and " + importedCount(refusedCount_ - refused_.size(), "line") + " more"));
    if (!plan_)
        return;
    std::unordered_set<const Currency*> made;
    for (const auto& currency : plan_->newCurrencies) {
        made.insert(currency.get());
        sheet.rows.push_back(rowOf("New", "Currency", textOf(currency->getRepresentation()), "", nullptr));
    }
    for (const auto& [market, currency] : plan_->newMarkets)
        sheet.rows.push_back(
            rowOf("New", "Market", textOf(market->getName()), textOf(currency->getRepresentation()), nullptr));
    std::unordered_map<const Company*, const Market*> marketOf; // of those that have none yet
    for (const auto& [company, market] : plan_->newCompanies)
        marketOf.emplace(company.get(), market);
    auto lastQuotes = lastValues(plan_->quotes);
    for (const auto& tally : plan_->quoteTallies) {
        const Market* market = tally.isNew ? marketOf.at(tally.owner) : tally.owner->market();
        sheet.rows.push_back(rowOf(becomesOf(tally.counts, tally.isNew), "Company",
                                   textOf(tally.owner->getAbbreviation()),
                                   textOf(market->getName()) + ", " + textOf(tally.currency->getRepresentation()),
                                   &tally.counts, lastQuotes[tally.owner]));
    }
    auto lastRates = lastValues(plan_->rates);
    for (const auto& tally : plan_->rateTallies)
        sheet.rows.push_back(rowOf(becomesOf(tally.counts, made.contains(tally.owner)), "Rates",
                                   textOf(tally.owner->getRepresentation()), "", &tally.counts,
                                   lastRates[tally.owner]));
}

void ImportQuotes::choose(const std::string& question, std::size_t item)
{
    if (isStale())
        return;
    if (question == "importColumn") {
        column_ = std::min(item, columnsOf(areRates_).size() - 1);
        return;
    }
    if (question == "importKind") {
        areRates_ = item == 1;
        columnsTold_.clear(); // they were told of another kind of table
        options_.ratesAreUnits.reset();
        column_ = 0;
    } else if (question == "importRates") {
        options_.ratesAreUnits = item == 0;
    } else if (question == "importHeading") {
        const std::string heading = item > 0 && item <= head_.headings.size() ? head_.headings[item - 1] : "";
        tellHeading(columnsTold_, columnsOf(areRates_)[column_].column, heading);
    }
    read();
}

void ImportQuotes::type(const std::string& question, const std::string& text)
{
    if (isStale() || text.empty())
        return; // the field shows again what is taken
    std::string& option = question == "txtImportMarket"     ? options_.market
                          : question == "txtImportCurrency" ? options_.currency
                                                            : options_.reference;
    option = text;
    read();
}

std::string ImportQuotes::stepName() const
{
    return std::string(areRates_ ? "Import rates from " : "Import quotes from ") + importedName(path_);
}

std::string ImportQuotes::carryOut()
{
    if (!problem().empty())
        return {};
    const StateHold hold(window()); // until all pages know what is new
    std::vector<Currency*> currencies;
    std::vector<Market*> markets;
    std::vector<Company*> companies;
    for (const auto& currency : plan_->newCurrencies)
        currencies.push_back(currency.get());
    for (const auto& entry : plan_->newMarkets)
        markets.push_back(entry.market.get());
    for (const auto& entry : plan_->newCompanies)
        companies.push_back(entry.company.get());
    window().showProgress("Importing " + importedName(path_) + " ...");
    plan_->carryOut(window().catalogue());
    // From here on the plan is of what was: it is only told from.
    show(currencies, markets, companies);
    const auto& counts = areRates_ ? plan_->rateCounts : plan_->quoteCounts;
    std::string text =
        "Imported from " + importedName(path_) + ": " + countsText(areRates_ ? "rates" : "quotes", counts);
    const auto tell = [&](std::size_t n, const char* one, const char* many) {
        if (n > 0)
            text += ", " + countText(static_cast<int>(n)) + (n == 1 ? one : many);
    };
    tell(companies.size(), " new company", " new companies");
    tell(currencies.size(), " new currency", " new currencies");
    tell(refusedCount_, " line refused", " lines refused");
    plan_.reset();
    window().showProgress("");
    return text;
}

void ImportQuotes::show(const std::vector<Currency*>& currencies, const std::vector<Market*>& markets,
                        const std::vector<Company*>& companies)
{
    for (Currency* currency : currencies)
        currencies_.AddCurrency(currency, false);
    if (const Currency* reference = window().getReferenceCurrency())
        currencies_.setCurrencyRefName(reference->getName());
    for (Market* market : markets) {
        companies_.AddMarket(market, false);
        currencies_.AddMarket(market);
    }
    for (Company* company : companies)
        companies_.AddCompany(company, false);
    for (const auto& series : plan_->quotes)
        companies_.RefreshQuotes(series.owner);
    for (const auto& series : plan_->rates)
        currencies_.RefreshQuotes(series.owner);
    window().UpdateState();
}
