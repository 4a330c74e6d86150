#include "tools/MarketUpdate.h"

#include "exchange/MarketFile.h"
#include "exchange/Table.h"
#include "foundation/PrintableText.h"
#include "storage/AtomicFile.h"
#include "tools/ImportReport.h"
#include "tools/ProgressBar.h"
#include "tools/SourceRuns.h"

#include <algorithm>
#include <functional>
#include <iostream>
#include <map>
#include <stdexcept>

namespace {

std::string symbolOf(const Currency& currency)
{
    return std::string(currency.getRepresentation().comparedBytes());
}

/// By such a symbol a currency is known elsewhere.
bool isCode(const std::string& symbol)
{
    return symbol.size() == 3 && std::ranges::all_of(symbol, [](char c) { return c >= 'A' && c <= 'Z'; });
}

/// A close as it may be added: the latest one. Throws an UnusableRow with the reason when there is none.
DatedValue latestOf(const SourceAnswer& answer)
{
    if (answer.closes.empty())
        throw UnusableRow(answer.reason);
    const auto& [day, close] = *answer.closes.rbegin();
    return {day, close};
}

/// What a source brings for a market file.
class MarketUpdate {
public:
    explicit MarketUpdate(MarketFile& file);

    void ask(const QuoteSource& source, const SourceRuns& runs);
    /// Throws std::runtime_error when nothing has come.
    MarketPlan plan();

private:
    struct Listed {
        Company* company;
        Currency* currency; // of its market
    };
    /// How names are asked for.
    struct Asking {
        std::function<std::string(const std::string&)> whyNot; // empty for one that can be asked for
        std::function<QuoteSource::Run(const std::vector<std::string>&)> makeRun;
    };

    template <class Named, class Take>
    void askFor(const Named& named, const Asking& asking, std::size_t most, const SourceRuns& runs, const Take& take);
    void takeQuote(const std::vector<Listed>& listed, const SourceAnswer& answer);
    void takeRate(Currency* currency, const SourceAnswer& answer);
    void refuse(const std::string& name, const std::string& reason);
    void tellRefused();

    MarketFile& file_;
    std::map<std::string, std::vector<Listed>> companies_; // by ticker
    std::map<std::string, Currency*> currencies_;          // by symbol, without the reference
    MarketPlan plan_;
    std::vector<std::pair<std::string, std::vector<std::string>>> refused_; // reason, and whom it is about
    ProgressBar bar_{stderr};
};

MarketUpdate::MarketUpdate(MarketFile& file) : file_(file)
{
    plan_.reference = file.catalogue().getReferenceCurrency();
    for (Currency* currency : file.catalogue().getCurrencies()) {
        const std::string symbol = symbolOf(*currency);
        if (symbol != file.reference())
            currencies_.try_emplace(symbol, currency); // of several the first, as in the whole program
        for (Market* market : currency->markets())
            for (Company* company : market->companies())
                companies_[std::string(company->getAbbreviation().comparedBytes())].push_back({company, currency});
    }
}

void MarketUpdate::ask(const QuoteSource& source, const SourceRuns& runs)
{
    const std::string reference = file_.reference();
    const Asking quotes = {
        [](const auto& ticker) { return isTicker(ticker) ? "" : "has other signs than those of a ticker"; },
        [&](const auto& tickers) { return source.quotesOf(tickers); }};
    const Asking rates = {[&](const auto& symbol) {
                              return !isCode(symbol)     ? "is no symbol of three capital letters"
                                     : isCode(reference) ? ""
                                                         : "has no rate in the reference " + shown(reference);
                          },
                          [&](const auto& symbols) { return source.ratesOf(symbols, reference); }};
    const std::size_t most = source.mostNames();
    askFor(companies_, quotes, most, runs, [this](const auto& listed, const auto& told) { takeQuote(listed, told); });
    askFor(currencies_, rates, most, runs, [this](Currency* currency, const auto& told) { takeRate(currency, told); });
}

/// Asks for all names that can be asked for, `most` at a time, and hands each answer to `take`, which throws an
/// UnusableRow for what is refused.
template <class Named, class Take>
void MarketUpdate::askFor(const Named& named, const Asking& asking, std::size_t most, const SourceRuns& runs,
                          const Take& take)
{
    std::vector<std::string> names;
    for (const auto& [name, whose] : named)
        if (const std::string reason = asking.whyNot(name); reason.empty())
            names.push_back(name);
        else
            refuse(name, reason);
    std::vector<QuoteSource::Run> all;
    for (std::size_t at = 0; at < names.size(); at += most) {
        const auto begin = names.begin() + static_cast<std::ptrdiff_t>(at);
        const auto count = static_cast<std::ptrdiff_t>(std::min(most, names.size() - at));
        all.push_back(asking.makeRun(std::vector<std::string>(begin, begin + count)));
    }
    const auto answers = runs.answers(all, [this](double part) { bar_.show(file_.path(), part); });
    for (const std::string& name : names)
        try {
            take(named.at(name), answers.at(name));
        } catch (const UnusableRow& reason) {
            refuse(name, reason.what());
        }
}

/// A source knows tickers, and no markets: of several companies of one ticker at most the currency tells which is
/// meant.
void MarketUpdate::takeQuote(const std::vector<Listed>& listed, const SourceAnswer& answer)
{
    const DatedValue latest = latestOf(answer);
    std::vector<Listed> meant;
    for (const Listed& one : listed)
        if (answer.currency.empty() || answer.currency == symbolOf(*one.currency))
            meant.push_back(one);
    if (meant.empty())
        throw UnusableRow("comes in " + shown(answer.currency) + ", and its market trades in " +
                          shown(symbolOf(*listed.front().currency)));
    if (meant.size() > 1)
        throw UnusableRow("is the ticker of " + std::to_string(meant.size()) + " companies");
    plan_.quotes.push_back({meant.front().company, meant.front().currency, false, {latest}});
}

void MarketUpdate::takeRate(Currency* currency, const SourceAnswer& answer)
{
    const DatedValue latest = latestOf(answer);
    if (!answer.currency.empty() && answer.currency != file_.reference())
        throw UnusableRow("comes in " + shown(answer.currency) + ", and not in the reference " +
                          shown(file_.reference()));
    plan_.rates.push_back({currency, currency, false, {latest}});
}

void MarketUpdate::refuse(const std::string& name, const std::string& reason)
{
    ++plan_.refused;
    if (refused_.empty() || refused_.back().first != reason)
        refused_.push_back({reason, {}});
    refused_.back().second.push_back(name.empty() ? "\"\"" : name);
}

/// A source that fails does so for all that it is asked for: of those that follow each other the first are named.
void MarketUpdate::tellRefused()
{
    constexpr std::size_t kTold = 5;
    for (const auto& [reason, names] : refused_) {
        for (std::size_t i = 0; i < std::min(names.size(), kTold); ++i)
            std::cerr << (i == 0 ? "" : ", ") << printable(names[i]);
        if (names.size() > kTold)
            std::cerr << " and " << names.size() - kTold << " more";
        std::cerr << ": " << reason << '\n';
    }
}

MarketPlan MarketUpdate::plan()
{
    bar_.clear();
    tellRefused();
    if (plan_.isEmpty())
        throw std::runtime_error(file_.path() + ": no quote and no rate has come, and it is left as it is");
    if (plan_.reference != nullptr)
        plan_.giveReferenceItsRates(
            plan_.rates.emplace_back(SeriesValues<Currency>{plan_.reference, plan_.reference, false, {}}).values);
    return std::move(plan_);
}

} // namespace

void updateMarket(const std::string& path, const QuoteSource& source, std::chrono::milliseconds limit,
                  const Descriptor& stop)
{
    // Before anything is asked for, which may take minutes.
    AtomicFile::check(path, AtomicFile::Existing::kReplace);
    MarketFile file(path);
    MarketUpdate update(file);
    update.ask(source, SourceRuns(limit, stop));
    MarketPlan plan = update.plan();
    const Date latestDay = plan.lastDay().date();
    plan.settle();
    const ImportReport report(plan);
    if (!plan.isEmpty())
        file.save(plan, latestDay);
    report.print();
}
