#include "app/Completions.h"

#include "app/PLWindow.h"
#include "platform/TextControl.h"
#include "views/ModelText.h"

namespace {

constexpr std::size_t kMostOffers = 50; // nobody reads on: more of the name is typed sooner

/// Such as "ALP  Alpine Water  Paris".
std::string labelOf(const NamedEntry& entry)
{
    constexpr std::size_t kLongestPart = 100; // bytes; a file can hold megabytes
    std::string label = shortened(entry.key, kLongestPart);
    for (const std::string& more : {entry.name, entry.place})
        label += more.empty() ? "" : "  " + shortened(more, kLongestPart);
    return label;
}

BTextControl& fieldOf(BView& page, const char* name)
{
    return dynamic_cast<BTextControl&>(*page.FindView(name)); // a misspelt name would show in every test
}

/// Nothing when what is typed is the only offer: the list would only cover what is below it.
std::vector<Completion> offers(const NameIndex& index, const std::string& typed)
{
    const auto found = index.find(typed, kMostOffers);
    if (found.size() == 1 && found.front()->key == typed)
        return {};
    std::vector<Completion> completions;
    for (const NamedEntry* entry : found)
        completions.push_back({entry->key, labelOf(*entry), {}});
    return completions;
}

} // namespace

const Completions::Names& Completions::names()
{
    if (names_ && names_->serial == window_.changeSerial())
        return *names_;
    // Keys and places are put into fields, whole; names are only shown.
    std::vector<NamedEntry> currencies, markets, companies;
    for (const Currency* currency : window_.catalogue().getCurrencies())
        currencies.push_back({wholeTextOf(currency->getRepresentation()), textOf(currency->getName()), {}});
    for (const Market* market : window_.catalogue().getMarkets()) {
        const std::string name = wholeTextOf(market->getName());
        markets.push_back({name, {}, textOf(market->getCurrencyRepresentation())});
        for (const Company* company : market->companies())
            companies.push_back({wholeTextOf(company->getAbbreviation()), textOf(company->getName()), name});
    }
    // What has no name cannot be asked for by it.
    for (auto* entries : {&currencies, &markets, &companies})
        std::erase_if(*entries, [](const NamedEntry& entry) { return entry.key.empty(); });
    names_ = Names{window_.changeSerial(), NameIndex(std::move(currencies)), NameIndex(std::move(markets)),
                   NameIndex(std::move(companies))};
    return *names_;
}

void Completions::offerCurrencies(BView& page, const char* name)
{
    fieldOf(page, name).SetCompletions([this](const std::string& typed) { return offers(names().currencies, typed); });
}

void Completions::offerMarkets(BView& page, const char* name)
{
    fieldOf(page, name).SetCompletions([this](const std::string& typed) { return offers(names().markets, typed); });
}

void Completions::offerCompanies(BView& page, const char* name, const char* market)
{
    BTextControl& marketField = fieldOf(page, market);
    fieldOf(page, name).SetCompletions([this, &marketField](const std::string& typed) {
        std::vector<Completion> completions;
        for (const NamedEntry* entry : names().companies.find(typed, kMostOffers)) {
            const std::string place = entry->place;
            completions.push_back({entry->key, labelOf(*entry), [&marketField, place] {
                                       if (place != marketField.Text())
                                           marketField.SetText(place.c_str());
                                   }});
        }
        const bool isDone = completions.size() == 1 && completions.front().text == typed &&
                            names().companies.find(typed, 1).front()->place == marketField.Text();
        return isDone ? std::vector<Completion>() : completions;
    });
}
