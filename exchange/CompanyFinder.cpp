#include "exchange/CompanyFinder.h"

#include "exchange/Table.h"
#include "foundation/FoldedText.h"
#include "market/Catalogue.h"
#include "market/Company.h"
#include "market/Market.h"

#include <algorithm>
#include <set>

namespace {

std::string_view marketOf(const Company* company)
{
    return company->market()->getName().comparedBytes();
}

/// Leaves those for which `fits` holds, if there are any.
template <class Fits>
void prefer(std::vector<Company*>* companies, const Fits& fits)
{
    if (std::ranges::any_of(*companies, fits))
        std::erase_if(*companies, [&](const Company* company) { return !fits(company); });
}

} // namespace

CompanyFinder::CompanyFinder(const Catalogue& catalogue)
{
    std::set<std::pair<std::string_view, std::string_view>> taken; // market and ticker
    for (const Market* market : catalogue.getMarkets())
        for (Company* company : market->companies()) {
            const std::string_view ticker = company->getAbbreviation().comparedBytes();
            const bool hasNames = market->getName().hasText() && company->getAbbreviation().hasText();
            if (!hasNames || !taken.emplace(market->getName().comparedBytes(), ticker).second)
                continue;
            byTicker_[foldedText(ticker)].push_back(company);
            byName_[foldedText(company->getName().comparedBytes())].push_back(company);
        }
}

Company* CompanyFinder::find(std::string_view market, std::string_view ticker, std::string_view name,
                             const Currency* currency) const
{
    if (ticker.empty() && name.empty())
        throw UnusableRow("names no company");
    const auto& index = ticker.empty() ? byName_ : byTicker_;
    const std::string_view text = ticker.empty() ? name : ticker;
    const auto found = index.find(foldedText(text));
    if (found == index.end())
        throw UnusableRow("the market file has no company " + shown(text));
    Companies companies = found->second;
    if (!market.empty()) {
        const std::string key = foldedText(market);
        std::erase_if(companies, [&](const Company* company) { return foldedText(marketOf(company)) != key; });
        if (companies.empty())
            throw UnusableRow("the market file has no company " + shown(text) + " at " + shown(market));
        prefer(&companies, [&](const Company* company) { return marketOf(company) == market; });
    }
    // What is written alike is meant; then what can be bought from the account.
    prefer(&companies, [&](const Company* company) {
        return (ticker.empty() ? company->getName() : company->getAbbreviation()).comparedBytes() == text;
    });
    prefer(&companies, [&](const Company* company) { return company->market()->currency() == currency; });
    if (companies.size() > 1)
        throw UnusableRow(shown(text) + " may be " + shown(companies[0]->getAbbreviation().comparedBytes()) + " at " +
                          shown(marketOf(companies[0])) + " or " +
                          shown(companies[1]->getAbbreviation().comparedBytes()) + " at " +
                          shown(marketOf(companies[1])));
    return companies.front();
}
