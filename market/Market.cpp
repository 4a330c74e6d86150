#include "market/Market.h"

#include "market/Company.h"
#include "market/Currency.h"
#include "market/RecordList.h"

#include <algorithm>
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
    // The currency is not named: the market's record lies within the currency's.
    name_.wrt(file);
    return writeRecords(file, companies());
}

int Market::rd(FILE* file)
{
    if (name_.rd(file) != 0)
        return -1;
    return readRecords(file, [&] {
        auto company = std::make_unique<Company>();
        const int result = company->rd(file);
        // A company cut short stays for the sake of what is whole in it.
        if (result == 0 || company->getNbrQuotes() + company->getNbrEvents() > 0)
            company.release()->setMarket(this);
        return result;
    });
}

const String& Market::getCurrencyRepresentation() const
{
    const Currency* currency = currency_.partner();
    return currency != nullptr ? currency->getRepresentation() : String::none();
}

int Market::getCompany(const String& abbreviation, Company** out) const
{
    // Several companies may have one ticker: the first one counts, in the order of the list.
    const auto all = companies();
    const auto found = std::ranges::find(all, abbreviation, &Company::getAbbreviation);
    *out = found != all.end() ? *found : nullptr;
    return *out != nullptr ? 0 : -1;
}

int Market::setCurrency(Currency* currency)
{
    return currency_.set(this, currency);
}
