#include "valuation/QuoteCoverage.h"

#include "foundation/DateText.h"
#include "market/Catalogue.h"
#include "market/Company.h"
#include "market/Currency.h"
#include "market/Market.h"
#include "portfolio/Account.h"
#include "valuation/State.h"

#include <algorithm>

namespace {

template <class Series>
void makeUnique(std::vector<const Series*>& series)
{
    std::ranges::sort(series);
    series.erase(std::unique(series.begin(), series.end()), series.end());
}

/// The last day up to `day` on which all of `series` have a quote; undefined when there is none.
///
/// A series without a quote of the day moves it back to its own last one. It is asked first from then on, and the one
/// that was so before comes next: two that never agree do not have all others asked between them.
template <class Series>
Date lastCommonDay(std::vector<const Series*> series, Date day)
{
    makeUnique(series);
    for (std::size_t agreeing = 0; agreeing < series.size(); ++agreeing) {
        const Date quoted = series[agreeing]->getLastQuoteUpTo(day);
        if (quoted == day)
            continue;
        if (quoted.isUndefined())
            return {};
        day = quoted;
        const auto moved = series.begin() + static_cast<std::ptrdiff_t>(agreeing);
        std::rotate(series.begin(), moved, moved + 1);
        agreeing = 0; // the one in front
    }
    return day;
}

template <class Series>
QuoteCoverage coverageOf(const std::vector<const Series*>& series, const Date& day)
{
    QuoteCoverage coverage;
    coverage.needed = static_cast<unsigned>(series.size());
    for (const Series* s : series) {
        const Date quoted = s->getLastQuoteUpTo(day);
        coverage.unknown += quoted.isUndefined() ? 1 : 0;
        coverage.older += !quoted.isUndefined() && quoted != day ? 1 : 0;
    }
    if (coverage.unknown == 0) // otherwise there is no such day
        coverage.lastFullDay = lastCommonDay(series, day);
    return coverage;
}

/// Null without a company.
const Company* heldCompany(const ShareState& state)
{
    return state.isHeld() && state.share() != nullptr ? state.share()->company() : nullptr;
}

} // namespace

QuoteCoverage quoteCoverage(const State& state)
{
    std::vector<const Company*> companies;
    for (const ShareState* held : state.shareStates())
        if (const Company* company = heldCompany(*held))
            companies.push_back(company);
    return coverageOf(companies, state.getDate());
}

QuoteCoverage rateCoverage(const State& state, const Catalogue& catalogue)
{
    std::vector<const Currency*> currencies;
    const auto add = [&](const Currency* currency) {
        if (currency != nullptr && currency != catalogue.getReferenceCurrency())
            currencies.push_back(currency);
    };
    for (const ShareState* held : state.shareStates())
        if (const Company* company = heldCompany(*held); company != nullptr && company->market() != nullptr)
            add(company->market()->currency());
    for (const AccountState* account : state.accountStates())
        if (account->getCash() != 0 && account->account() != nullptr)
            add(account->account()->currency());
    makeUnique(currencies);
    return coverageOf(currencies, state.getDate());
}

std::string coverageText(const QuoteCoverage& coverage, const char* what, const Date& day)
{
    const unsigned missing = coverage.older + coverage.unknown;
    if (missing == 0)
        return {};
    return std::to_string(missing) + " of " + std::to_string(coverage.needed) + ' ' + what +
           (missing == 1 ? " is " : " are ") + (coverage.unknown > 0 ? "not of " : "older than ") + dateText(day);
}

std::string estimateText(const QuoteCoverage& quotes, const QuoteCoverage& rates, const Date& day)
{
    const std::string ofQuotes = coverageText(quotes, "quotes", day);
    const std::string missing = ofQuotes.empty() ? coverageText(rates, "rates", day) : ofQuotes;
    if (missing.empty())
        return {};
    const std::string what = ofQuotes.empty() ? "rates" : "quotes";
    const Date& last = ofQuotes.empty() ? rates.lastFullDay : quotes.lastFullDay;
    return "estimated: " + missing + ", " +
           (last.isUndefined() ? "no day has all " + what : "the last day with all " + what + " is " + dateText(last));
}
