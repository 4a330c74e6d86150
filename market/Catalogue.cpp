#include "market/Catalogue.h"

#include "foundation/FieldIO.h"
#include "market/Currency.h"
#include "market/Market.h"

#include <algorithm>

namespace {

// Each currency with the reference's symbol makes all quotes read so far be expressed anew. A file saved after the same
// data was loaded several times has a few of them; one with many is corrupt, and its reading would never end.
constexpr int kMostReferences = 100;

void expressIn(const Currency& newReference, const Currency& currency)
{
    // Dividing by 1 would change nothing but mark the trend as out of date.
    for (CurrencyQuote* quote : currency.quotes())
        if (const double rate = newReference.getRealQuote(quote->getDate()); rate != 1)
            quote->setValue(static_cast<float>(quote->getValue() / rate));
}

} // namespace

Catalogue::Catalogue() = default;

Catalogue::~Catalogue()
{
    clear();
}

int Catalogue::rd(FILE* file)
{
    String reference;
    if (reference.rd(file) != 0)
        return -1;
    int references = 0;
    auto missing = static_cast<unsigned>(freadint(file));
    for (; missing > 0 && !reachedEnd(file); --missing) {
        auto currency = std::make_unique<Currency>();
        const int result = currency->rd(file, nullptr);
        // A currency cut short stays for the sake of what is whole in it.
        if (result != 0 && currency->getNbrMarkets() + currency->getNbrQuotes() == 0)
            return -1;
        // From here on the catalogue owns the currency, whatever happens to the rest of the file.
        Currency* added = currency.release();
        addCurrency(added);
        const bool isReference = !reference.isUndefined() && added->getRepresentation() == reference;
        // The first one becomes the reference of what was read before it; a further one divides all of that anew.
        if (isReference && references++ < kMostReferences)
            rebaseOn(added);
        if (result != 0 || references > kMostReferences)
            return -1;
    }
    return reachedEnd(file) ? -1 : 0;
}

int Catalogue::wrt(FILE* file, const Date& stamp) const
{
    // Without a reference the undefined name is written; a reader then sets none.
    const String reference = reference_ != nullptr ? reference_->getRepresentation() : String();
    reference.wrt(file);
    fwriteint(file, static_cast<int>(currencies_.size()));
    for (const Currency* currency : currencies_)
        if (currency->wrt(file, stamp) != 0)
            return -1;
    return std::ferror(file) == 0 ? 0 : -1;
}

void Catalogue::addCurrency(Currency* currency)
{
    currencies_.push_back(currency);
}

void Catalogue::removeCurrency(Currency* currency)
{
    const auto place = std::find(currencies_.begin(), currencies_.end(), currency);
    if (place == currencies_.end())
        return;
    // The last currency fills the gap; the list holds `currency` no more, though others may still refer to it.
    *place = currencies_.back();
    currencies_.pop_back();
    // `currency` still has its rates here, but it is not divided: it is in the list no more.
    if (currency == reference_) {
        if (currencies_.empty())
            reference_ = nullptr;
        else
            rebaseOn(currencies_.front());
    }
    // Nobody may be left with a pointer to what its new owner may destroy.
    for (Currency* other : currencies_) {
        if (other->storedReference() == currency)
            other->setReferenceCurrency(reference_);
    }
}

void Catalogue::dropLastCurrency()
{
    if (currencies_.back() == reference_)
        reference_ = nullptr;
    delete currencies_.back();
    currencies_.pop_back();
}

void Catalogue::clear()
{
    // Each takes its markets, and through them companies and the portfolio's holdings, along.
    for (Currency* currency : currencies_)
        delete currency;
    currencies_.clear();
    reference_ = nullptr;
}

unsigned Catalogue::getNbrCurrencies() const
{
    return static_cast<unsigned>(currencies_.size());
}

Currency* Catalogue::getCurrencyByRepresentation(const String& representation) const
{
    for (Currency* currency : currencies_)
        if (currency->getRepresentation() == representation)
            return currency;
    return nullptr;
}

std::vector<Market*> Catalogue::getMarkets() const
{
    std::vector<Market*> markets;
    for (const Currency* currency : currencies_) {
        const auto own = currency->markets();
        markets.insert(markets.end(), own.begin(), own.end());
    }
    return markets;
}

void Catalogue::rebaseOn(Currency* newReference)
{
    if (newReference == reference_)
        return;
    if (reference_ != nullptr) {
        // The others first: the divisions need the new reference's rates as they were.
        for (const Currency* currency : currencies_)
            if (currency != newReference)
                expressIn(*newReference, *currency);
        for (CurrencyQuote* quote : newReference->quotes())
            quote->setValue(1);
    }
    // From here on all rates count as prices in `newReference`.
    reference_ = newReference;
}
