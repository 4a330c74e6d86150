#include "tools/ImportReport.h"

#include "foundation/PrintableText.h"

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <iostream>
#include <stdexcept>

namespace {

/// "new markets: NYSE, Paris"; of many names only the first ones. Empty when there are none.
template <class Entries, class NameOf>
std::string newText(const char* what, const Entries& entries, const NameOf& nameOf)
{
    constexpr std::size_t kTold = 20;
    if (entries.empty())
        return "";
    std::string text = std::string("new ") + what + ':';
    for (std::size_t i = 0; i < std::min(entries.size(), kTold); ++i)
        text += (i == 0 ? " " : ", ") + printable(nameOf(entries[i]).bytes());
    if (entries.size() > kTold)
        text += " and " + std::to_string(entries.size() - kTold) + " more";
    return text + '\n';
}

std::string countText(const char* what, const MarketPlan::Counts& counts)
{
    return std::string(what) + ": " + std::to_string(counts.added) + " new, " + std::to_string(counts.changed) +
           " changed, " + std::to_string(counts.equal) + " equal\n";
}

} // namespace

ImportReport::ImportReport(const MarketPlan& plan)
{
    names = newText("currencies", plan.newCurrencies, [](const auto& made) { return made->getRepresentation(); }) +
            newText("markets", plan.newMarkets, [](const auto& made) { return made.market->getName(); }) +
            newText("companies", plan.newCompanies, [](const auto& made) { return made.company->getAbbreviation(); });
    if (plan.replaced > 0)
        names += "values of a day for which a later line has another: " + std::to_string(plan.replaced) + '\n';
    figures = countText("quotes", plan.quoteCounts) + countText("rates", plan.rateCounts) +
              "refused: " + std::to_string(plan.refused) + '\n';
}

void ImportReport::print() const
{
    std::cerr << names;
    if (!(std::cout << figures << std::flush))
        throw std::runtime_error(std::string("standard output: ") + std::strerror(errno));
}
