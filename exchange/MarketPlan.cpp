#include "exchange/MarketPlan.h"

#include "market/Catalogue.h"

#include <algorithm>
#include <optional>
#include <utility>

namespace {

/// By date, and of each day the last one only. @return how many were given up.
std::size_t sortByDay(std::vector<DatedValue>& values)
{
    // Most tables are in the order of the days, up or down.
    const auto isAfter = [](const DatedValue& a, const DatedValue& b) { return a.day >= b.day; };
    if (std::ranges::adjacent_find(values, isAfter) == values.end())
        return 0;
    std::ranges::stable_sort(values, {}, &DatedValue::day);
    const std::size_t before = values.size();
    // From the back, so that of equal days the last line comes first, and is the one that stays.
    const auto rest = std::unique(values.rbegin(), values.rend(),
                                  [](const DatedValue& a, const DatedValue& b) { return a.day == b.day; });
    values.erase(values.begin(), rest.base());
    return before - values.size();
}

/// Goes along `values`, which are by date: `visit(value, quotes)` with the quotes that the series has of that day, none
/// or one or, rarely, several.
template <class Series, class Visit>
void walk(const Series& series, const std::vector<DatedValue>& values, const Visit& visit)
{
    const auto quotes = series.quotes();
    const auto dayOf = [](const auto* quote) { return quote->getPackedDate(); };
    auto next = values.empty() ? quotes.begin() : std::ranges::lower_bound(quotes, values.front().day, {}, dayOf);
    for (const DatedValue& value : values) {
        while (next != quotes.end() && dayOf(*next) < value.day)
            ++next;
        const auto first = next;
        while (next != quotes.end() && dayOf(*next) == value.day)
            ++next;
        visit(value, std::span(first, next));
    }
}

/// Counts the values of a series, which are by date, and leaves those that are new or other than what is there.
template <class Owner>
void dropEqual(SeriesValues<Owner>& series, MarketPlan::Counts& counts)
{
    std::size_t left = 0;
    walk(*series.owner, series.values, [&](const DatedValue& value, const auto& ofDay) {
        const auto isEqual = [&](const auto* quote) { return quote->getValue() == value.value; };
        if (!ofDay.empty() && std::ranges::all_of(ofDay, isEqual)) {
            ++counts.equal;
            return;
        }
        ++(ofDay.empty() ? counts.added : counts.changed);
        series.values[left++] = value; // never in front of where the walk is
    });
    series.values.resize(left);
}

/// Gives the series its values, and their memory back.
template <class Owner>
void bringIn(SeriesValues<Owner>& series)
{
    std::vector<DatedValue> added;
    walk(*series.owner, series.values, [&](const DatedValue& value, const auto& ofDay) {
        if (ofDay.empty())
            added.push_back(value);
        // The day stays, so the quotes keep their order while the walk lasts.
        for (auto* quote : ofDay)
            quote->setValue(value.value);
    });
    series.owner->addQuotes(added);
    std::vector<DatedValue>().swap(series.values);
}

/// The earliest and the latest day of all values; undefined ones without any.
template <class Series>
std::pair<PackedDate, PackedDate> daysOf(const Series& all)
{
    std::optional<std::pair<PackedDate, PackedDate>> days;
    for (const auto& series : all)
        for (const DatedValue& value : series.values)
            days = days ? std::pair(std::min(days->first, value.day), std::max(days->second, value.day))
                        : std::pair(value.day, value.day);
    return days.value_or(std::pair<PackedDate, PackedDate>());
}

} // namespace

void MarketPlan::giveReferenceItsRates(std::vector<DatedValue>& ones)
{
    if (!std::ranges::all_of(reference->quotes(), [](const auto* rate) { return rate->getValue() == 1; }))
        return;
    std::vector<PackedDate> days;
    for (const auto& series : rates)
        for (const DatedValue& rate : series.values)
            days.push_back(rate.day);
    const auto isInReference = [&](const auto& series) {
        return series.currency == reference && !series.values.empty();
    };
    const bool isNew = !newCurrencies.empty() && newCurrencies.front().get() == reference;
    const bool isNamed = isNew || std::ranges::any_of(quotes, isInReference);
    if (days.empty() && reference->getNbrQuotes() == 0 && isNamed)
        days.push_back(daysOf(quotes).first);
    std::ranges::sort(days);
    days.erase(std::unique(days.begin(), days.end()), days.end());
    // What the tables themselves say of the reference is 1 as well, so that the days alone tell all.
    ones.clear();
    for (const PackedDate& day : days)
        ones.push_back({day, 1});
}

PackedDate MarketPlan::lastDay() const
{
    return std::max(daysOf(quotes).second, daysOf(rates).second);
}

void MarketPlan::settle()
{
    const auto settleAll = [&](auto& all, auto& tallies, const auto& countsOf) {
        for (auto& series : all) {
            if (series.values.empty())
                continue;
            replaced += sortByDay(series.values);
            Counts counts;
            dropEqual(series, counts);
            countsOf(series) += counts;
            tallies.push_back({series.owner, series.currency, series.isNew, counts});
        }
        std::erase_if(all, [](const auto& series) { return series.values.empty(); });
    };
    settleAll(quotes, quoteTallies, [this](const auto&) -> Counts& { return quoteCounts; });
    settleAll(rates, rateTallies, [this](const auto& series) -> Counts& {
        return series.owner == reference ? referenceCounts : rateCounts;
    });
}

void MarketPlan::dropUnused()
{
    std::unordered_set<const void*> used;
    for (const auto& series : rates)
        used.insert(series.owner);
    for (const auto& series : quotes)
        used.insert(series.owner);
    std::erase_if(newCompanies, [&](const NewCompany& entry) { return !used.contains(entry.company.get()); });
    for (const auto& [company, market] : newCompanies)
        used.insert(market);
    std::erase_if(newMarkets, [&](const NewMarket& entry) { return !used.contains(entry.market.get()); });
    for (const auto& [market, currency] : newMarkets)
        used.insert(currency);
    std::erase_if(newCurrencies, [&](const auto& currency) { return !used.contains(currency.get()); });
}

MarketPlan::Owners MarketPlan::carryOut(Catalogue& catalogue)
{
    // From the top down, so that whatever gets an owner has one that is the catalogue's already.
    for (auto& currency : newCurrencies)
        catalogue.addCurrency(currency.release());
    if (reference != catalogue.getReferenceCurrency())
        catalogue.setReferenceCurrency(reference);
    for (auto& [market, currency] : newMarkets)
        market.release()->setCurrency(currency);
    for (auto& [company, market] : newCompanies)
        company.release()->setMarket(market);
    Owners changed;
    const auto bringAll = [&](auto& all) {
        for (auto& series : all) {
            bringIn(series);
            changed.insert(series.owner);
        }
    };
    bringAll(quotes);
    bringAll(rates);
    return changed;
}
