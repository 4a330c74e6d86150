#include "history/CatalogueImage.h"

#include "foundation/FieldIO.h"
#include "history/MemoryFile.h"
#include "market/Catalogue.h"
#include "market/Currency.h"
#include "market/Market.h"

#include <algorithm>
#include <unordered_map>
#include <unordered_set>

namespace {

template <class Image>
using Shared = std::shared_ptr<const Image>;

template <class Image>
const Image* at(const std::vector<Shared<Image>>* images, std::size_t place)
{
    return images != nullptr && place < images->size() ? (*images)[place].get() : nullptr;
}

/// The same text, and the same answer to whether there is one.
bool isSame(const String& a, const String& b)
{
    return a.hasText() == b.hasText() && a.bytes() == b.bytes();
}

std::string eventsOf(const Company& company)
{
    if (company.getNbrEvents() == 0)
        return {};
    return bytesWritten([&](FILE* file) { company.writeEvents(file); });
}

/// Takes the image of a catalogue beside a former one, of which it keeps what is still true.
class Taker {
public:
    explicit Taker(const CatalogueImage* former) : former_(former) {}

    Shared<CurrencyImage> take(const Currency& currency, std::optional<std::size_t> reference,
                               const std::vector<Shared<CurrencyImage>>* former, std::size_t place)
    {
        const CurrencyImage* old = at(former, place);
        CurrencyImage image{currency.getName(), currency.getRepresentation(), reference,
                            series(currency, old != nullptr ? &old->quotes : nullptr),
                            all<MarketImage>(currency.markets(), old != nullptr ? &old->markets : nullptr)};
        const bool isOld = old != nullptr && isSame(old->name, image.name) &&
                           isSame(old->representation, image.representation) && old->reference == reference &&
                           old->quotes.records == image.quotes.records && old->markets == image.markets;
        return isOld ? (*former)[place] : std::make_shared<const CurrencyImage>(std::move(image));
    }

private:
    Shared<MarketImage> take(const Market& market, const std::vector<Shared<MarketImage>>* former, std::size_t place)
    {
        const MarketImage* old = at(former, place);
        MarketImage image{market.getName(),
                          all<CompanyImage>(market.companies(), old != nullptr ? &old->companies : nullptr)};
        const bool isOld = old != nullptr && isSame(old->name, image.name) && old->companies == image.companies;
        return isOld ? (*former)[place] : std::make_shared<const MarketImage>(std::move(image));
    }

    Shared<CompanyImage> take(const Company& company, const std::vector<Shared<CompanyImage>>* former,
                              std::size_t place)
    {
        const CompanyImage* old = at(former, place);
        CompanyImage image{company.getName(), company.getAbbreviation(),
                           series(company, old != nullptr ? &old->quotes : nullptr), eventsOf(company)};
        const bool isOld = old != nullptr && isSame(old->name, image.name) &&
                           isSame(old->abbreviation, image.abbreviation) &&
                           old->quotes.records == image.quotes.records && old->events == image.events;
        return isOld ? (*former)[place] : std::make_shared<const CompanyImage>(std::move(image));
    }

    template <class Image>
    std::vector<Shared<Image>> all(auto objects, const std::vector<Shared<Image>>* former)
    {
        std::vector<Shared<Image>> images;
        images.reserve(objects.size());
        for (const auto* object : objects)
            images.push_back(take(*object, former, images.size()));
        return images;
    }

    /// `old` is what stood at the series' place, or null.
    SeriesImage series(const auto& live, const SeriesImage* old)
    {
        if (old != nullptr && old->revision == live.revision())
            return *old;
        // It may have stood at another place: one that goes leaves its own to the last.
        if (const auto moved = byRevision().find(live.revision()); moved != byRevision_->end())
            return {moved->second, live.revision()};
        SeriesImage image{std::make_shared<const std::string>(live.quoteRecords()), live.revision()};
        if (old == nullptr || *old->records != *image.records)
            return image;
        old->revision = live.revision(); // it was written anew, with the same quotes
        return *old;
    }

    /// The records of all series of the former image. Made when it is first asked for.
    const std::unordered_map<std::uint64_t, Shared<std::string>>& byRevision()
    {
        if (byRevision_)
            return *byRevision_;
        byRevision_.emplace();
        const auto note = [this](const SeriesImage& series) { byRevision_->emplace(series.revision, series.records); };
        if (former_ != nullptr)
            for (const auto& currency : former_->currencies) {
                note(currency->quotes);
                for (const auto& market : currency->markets)
                    for (const auto& company : market->companies)
                        note(company->quotes);
            }
        return *byRevision_;
    }

    const CatalogueImage* former_;
    std::optional<std::unordered_map<std::uint64_t, Shared<std::string>>> byRevision_;
};

std::optional<std::size_t> placeOf(const Currency* currency, const std::vector<Currency*>& currencies)
{
    const auto found = std::ranges::find(currencies, currency);
    if (currency == nullptr || found == currencies.end())
        return std::nullopt;
    return static_cast<std::size_t>(found - currencies.begin());
}

void restoreSeries(auto& live, const SeriesImage& image)
{
    if (live.revision() != image.revision && live.quoteRecords() != *image.records)
        live.setQuoteRecords(*image.records);
    image.revision = live.revision(); // from here on both have the same quotes
}

void restore(Company& company, const CompanyImage& image)
{
    company.setName(image.name);
    company.setAbbreviation(image.abbreviation);
    restoreSeries(company, image.quotes);
    if (eventsOf(company) == image.events)
        return;
    while (company.getNbrEvents() > 0)
        delete company.events().back();
    if (!image.events.empty())
        company.readEvents(MemoryFile(image.events));
}

void restore(Market& market, const MarketImage& image)
{
    market.setName(image.name);
    // From the end, so that the others keep their places.
    while (market.getNbrCompanies() > image.companies.size())
        delete market.companies().back();
    while (market.getNbrCompanies() < image.companies.size())
        (new Company)->setMarket(&market); // which owns it
    for (std::size_t i = 0; i < image.companies.size(); ++i)
        restore(*market.companies()[i], *image.companies[i]);
}

void restore(Currency& currency, const CurrencyImage& image)
{
    currency.setName(image.name);
    currency.setRepresentation(image.representation);
    restoreSeries(currency, image.quotes);
    while (currency.getNbrMarkets() > image.markets.size())
        delete currency.markets().back();
    while (currency.getNbrMarkets() < image.markets.size())
        (new Market)->setCurrency(&currency); // which owns it
    for (std::size_t i = 0; i < image.markets.size(); ++i)
        restore(*currency.markets()[i], *image.markets[i]);
}

std::size_t bytesOf(const String& text)
{
    return static_cast<std::size_t>(text.getLength());
}

/// Adds up what an image has and another one has not.
class Difference {
public:
    explicit Difference(const CatalogueImage& other) : other_(other) {}

    std::size_t of(const std::vector<Shared<CurrencyImage>>& images, const std::vector<Shared<CurrencyImage>>* others)
    {
        return sum(images, others, [this](const CurrencyImage& image, const CurrencyImage* other) {
            return bytesOf(image.name) + bytesOf(image.representation) + records(image.quotes) +
                   of(image.markets, other != nullptr ? &other->markets : nullptr);
        });
    }

private:
    std::size_t of(const std::vector<Shared<MarketImage>>& images, const std::vector<Shared<MarketImage>>* others)
    {
        return sum(images, others, [this](const MarketImage& image, const MarketImage* other) {
            return bytesOf(image.name) + of(image.companies, other != nullptr ? &other->companies : nullptr);
        });
    }

    std::size_t of(const std::vector<Shared<CompanyImage>>& images, const std::vector<Shared<CompanyImage>>* others)
    {
        return sum(images, others, [this](const CompanyImage& image, const CompanyImage*) {
            return bytesOf(image.name) + bytesOf(image.abbreviation) + image.events.size() + records(image.quotes);
        });
    }

    template <class Image>
    static std::size_t sum(const std::vector<Shared<Image>>& images, const std::vector<Shared<Image>>* others,
                           auto bytes)
    {
        std::size_t total = 0;
        for (std::size_t i = 0; i < images.size(); ++i)
            if (const Image* other = at(others, i); other != images[i].get())
                total += sizeof(Image) + sizeof(Shared<Image>) + bytes(*images[i], other);
        return total;
    }

    std::size_t records(const SeriesImage& series)
    {
        if (others_.empty())
            for (const auto& currency : other_.currencies) {
                others_.insert(currency->quotes.records.get());
                for (const auto& market : currency->markets)
                    for (const auto& company : market->companies)
                        others_.insert(company->quotes.records.get());
            }
        return others_.contains(series.records.get()) ? 0 : series.records->size();
    }

    const CatalogueImage& other_;
    std::unordered_set<const std::string*> others_;
};

} // namespace

std::shared_ptr<const CatalogueImage> CatalogueImage::of(const Catalogue& catalogue,
                                                         const std::shared_ptr<const CatalogueImage>& former)
{
    const auto& all = catalogue.getCurrencies();
    Taker taker(former.get());
    CatalogueImage image{placeOf(catalogue.getReferenceCurrency(), all), {}};
    for (const Currency* currency : all)
        image.currencies.push_back(taker.take(*currency, placeOf(currency->storedReference(), all),
                                              former != nullptr ? &former->currencies : nullptr,
                                              image.currencies.size()));
    const bool isFormer =
        former != nullptr && former->reference == image.reference && former->currencies == image.currencies;
    return isFormer ? former : std::make_shared<const CatalogueImage>(std::move(image));
}

void CatalogueImage::restore(Catalogue& catalogue) const
{
    while (catalogue.getNbrCurrencies() > currencies.size())
        catalogue.dropLastCurrency();
    while (catalogue.getNbrCurrencies() < currencies.size())
        catalogue.addCurrency(new Currency); // which the catalogue owns
    // All are there: references can be told by their places.
    const auto& live = catalogue.getCurrencies();
    const auto currencyAt = [&](std::optional<std::size_t> place) { return place ? live[*place] : nullptr; };
    for (std::size_t i = 0; i < currencies.size(); ++i) {
        ::restore(*live[i], *currencies[i]);
        live[i]->setReferenceCurrency(currencyAt(currencies[i]->reference));
    }
    catalogue.setReferenceCurrency(currencyAt(reference));
}

std::size_t CatalogueImage::bytesBeside(const CatalogueImage& other) const
{
    return this == &other ? 0 : sizeof *this + Difference(other).of(currencies, &other.currencies);
}
