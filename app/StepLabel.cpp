#include "app/StepLabel.h"

#include "app/History.h"
#include "portfolio/Operation.h"
#include "views/ModelText.h"

#include <algorithm>

namespace {

/// The first place where two lists differ; nothing when they do not.
template <class List>
std::optional<std::size_t> firstDifference(const List& a, const List& b)
{
    const auto [inA, inB] = std::ranges::mismatch(a, b);
    if (inA == a.end() && inB == b.end())
        return std::nullopt;
    return static_cast<std::size_t>(inA - a.begin());
}

/// The element that came, went or changed, and what it was before when it only changed.
template <class Element>
struct Changed {
    const Element* element = nullptr;
    const Element* former = nullptr;
};

template <class Image>
Changed<Image> changedOf(const std::vector<std::shared_ptr<const Image>>& before,
                         const std::vector<std::shared_ptr<const Image>>& after)
{
    const auto place = firstDifference(before, after);
    if (!place)
        return {};
    if (before.size() > after.size())
        return {before[*place].get(), nullptr};
    return {after[*place].get(), before.size() == after.size() ? before[*place].get() : nullptr};
}

std::string subjectOf(const CatalogueImage& before, const CatalogueImage& after)
{
    const auto currency = changedOf(before.currencies, after.currencies);
    if (currency.element == nullptr)
        return {};
    const auto* formerCurrency = currency.former;
    if (formerCurrency == nullptr || formerCurrency->markets == currency.element->markets)
        return textOf(currency.element->name);
    const auto market = changedOf(formerCurrency->markets, currency.element->markets);
    if (market.former == nullptr || market.former->companies == market.element->companies)
        return textOf(market.element->name);
    const auto company = changedOf(market.former->companies, market.element->companies);
    return textOf(company.element->abbreviation);
}

/// The ticker of the holding that a trade is of, or the name of the account that an operation is on.
std::string subjectOf(const WalletImage& wallet, const CatalogueImage& catalogue, std::uint32_t operation)
{
    for (const WalletImage::Link& link : wallet.holdingLinks)
        if (std::ranges::count(wallet.holdings[link.own], operation) > 0)
            return textOf(
                catalogue.currencies[link.currency]->markets[link.market]->companies[link.company]->abbreviation);
    for (const auto& account : wallet.accounts)
        if (std::ranges::count(account.operations, operation) > 0)
            return textOf(account.name);
    return {};
}

std::string subjectOf(const Moment& before, const Moment& after)
{
    const auto& accountsBefore = before.wallet->accounts;
    const auto& accountsAfter = after.wallet->accounts;
    if (accountsBefore.size() != accountsAfter.size()) {
        const bool isRemoval = accountsBefore.size() > accountsAfter.size();
        const auto& more = isRemoval ? accountsBefore : accountsAfter;
        const auto& less = isRemoval ? accountsAfter : accountsBefore;
        std::size_t place = 0;
        while (place < less.size() && less[place].name == more[place].name)
            ++place;
        return textOf(more[place].name);
    }
    const auto place = firstDifference(before.wallet->operations, after.wallet->operations);
    if (!place)
        return {};
    const Moment& shown = before.wallet->operations.size() > after.wallet->operations.size() ? before : after;
    return subjectOf(*shown.wallet, *shown.catalogue, static_cast<std::uint32_t>(*place));
}

} // namespace

std::string stepLabel(const std::string& command, const Moment& before, const Moment& after)
{
    // An import names its file, and may be about many things.
    if (command.starts_with("Import "))
        return command;
    std::string subject = subjectOf(*before.catalogue, *after.catalogue);
    if (subject.empty())
        subject = subjectOf(before, after);
    const std::string name = command.empty() ? "Change" : command;
    return subject.empty() ? name : name + ' ' + subject;
}
