#include "market/Market.h"

#include "foundation/FieldIO.h"
#include "market/Company.h"
#include "market/Currency.h"

#include <memory>

Market::Market() : companies_(this) {}

Market::Market(const String& name) : Market()
{
    name_ = name;
}

Market::~Market()
{
    // The companies first, since they unlink themselves from the list. Then the currency lists the market no more.
    companies_.deleteAll();
    setCurrency(nullptr);
}

int Market::wrt(FILE* file) const
{
    name_.wrt(file);
    fwriteint(file, static_cast<int>(getNbrCompanies()));
    for (const Company* company : companies())
        if (company->wrt(file) != 0)
            return -1;
    return 0;
}

int Market::rd(FILE* file)
{
    if (name_.rd(file) != 0)
        return -1;
    auto missing = static_cast<unsigned>(freadint(file));
    for (; missing > 0 && !reachedEnd(file); --missing) {
        auto company = std::make_unique<Company>();
        const int result = company->rd(file);
        // A company cut short stays for the sake of what is whole in it.
        if (result == 0 || company->getNbrQuotes() + company->getNbrEvents() > 0)
            company.release()->setMarket(this);
        if (result != 0)
            return -1;
    }
    return reachedEnd(file) ? -1 : 0;
}

const String& Market::getCurrencyRepresentation() const
{
    const Currency* currency = currency_.partner();
    return currency != nullptr ? currency->getRepresentation() : String::none();
}

int Market::getCompany(const String& abbreviation, Company** out) const
{
    // Several companies may have one ticker: the first one counts, in the order of the list.
    for (Company* company : companies())
        if (company->getAbbreviation() == abbreviation) {
            *out = company;
            return 0;
        }
    *out = nullptr;
    return -1;
}

int Market::setCurrency(Currency* currency)
{
    return currency_.set(this, currency);
}
