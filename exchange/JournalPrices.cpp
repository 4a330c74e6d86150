// The prices of a journal.

#include "exchange/Journal.h"
#include "exchange/JournalText.h"
#include "exchange/TableText.h"
#include "foundation/PrintableText.h"
#include "market/Catalogue.h"
#include "market/Currency.h"
#include "market/Market.h"
#include "portfolio/Wallet.h"
#include "valuation/State.h"

#include <algorithm>
#include <cmath>
#include <set>
#include <string_view>

namespace {

const Currency* currencyOf(const Company& company)
{
    return company.market() != nullptr ? company.market()->currency() : nullptr;
}

} // namespace

void Journal::addPrices()
{
    std::set<std::string_view> used; // symbols
    for (const Account* account : wallet_.accounts())
        used.insert(account->getCurrencyRepresentation().comparedBytes());
    for (const Company* company : companies_)
        used.insert(company->getCurrencyRepresentation().comparedBytes());
    // Of several of a symbol the first has the rates that count.
    std::set<std::string_view> known;
    for (const Currency* currency : catalogue_.getCurrencies())
        if (known.insert(currency->getRepresentation().comparedBytes()).second)
            currencies_.push_back(currency);
    if (catalogue_.getReferenceCurrency() == nullptr)
        remarks_.push_back("the market file has no reference currency, so that no currency has a price");
    for (const Currency* currency : currencies_)
        addPricesOf(*currency, used.contains(currency->getRepresentation().comparedBytes()));
    for (const Company* company : companies_)
        addPricesOf(*company);
}

/// Puts the values of the series up to the day, and that of the day itself, which may be an estimate.
template <class Series, class ValueOf>
void Journal::addSeries(const Series& series, const std::string& commodity, const std::string& in,
                        const ValueOf& valueOf)
{
    for (const auto* quote : series.quotes())
        if (quote->getDate() < day_)
            putPrice(quote->getDate(), commodity, valueOf(quote->getDate(), quote->getValue()), in);
    putPrice(day_, commodity, valueOf(day_, series.getRealQuote(day_)), in);
}

void Journal::addPricesOf(const Currency& currency, bool isUsed)
{
    const Currency* reference = catalogue_.getReferenceCurrency();
    if (reference == nullptr || currency.getRepresentation() == reference->getRepresentation())
        return;
    const std::string& commodity = names_.ofCurrency(currency.getRepresentation());
    const std::string& in = names_.ofCurrency(reference->getRepresentation());
    const auto price = [reference](const Date& day, double rate) { return rate / reference->getRealQuote(day); };
    if (isUsed)
        addSeries(currency, commodity, in, price);
    else
        putPrice(day_, commodity, price(day_, currency.getRealQuote(day_)), in);
}

void Journal::addPricesOf(const Company& company)
{
    const Currency* currency = currencyOf(company);
    if (currency == nullptr)
        return;
    addSeries(company, names_.of(company), names_.ofCurrency(currency->getRepresentation()),
              [](const Date&, double quote) { return quote; });
    const Currency* reference = catalogue_.getReferenceCurrency();
    if (form_.needsDirectPrices() && reference != nullptr &&
        currency->getRepresentation() != reference->getRepresentation())
        addDirectPricesOf(company, *catalogue_.getCurrencyByRepresentation(currency->getRepresentation()));
}

void Journal::addDirectPricesOf(const Company& company, const Currency& currency)
{
    const Currency& reference = *catalogue_.getReferenceCurrency();
    std::set<PackedDate> days{day_};
    for (const CompanyQuote* quote : company.quotes())
        days.insert(quote->getPackedDate());
    for (const CurrencyQuote* rate : currency.quotes())
        if (company.getNbrQuotes() > 0 && rate->getPackedDate() > *days.begin())
            days.insert(rate->getPackedDate());
    for (const PackedDate& packed : days) {
        const Date day = packed.date();
        const double price = static_cast<double>(company.getRealQuote(day)) * currency.getRealQuote(day);
        if (day <= day_)
            putPrice(day, names_.of(company), price / reference.getRealQuote(day),
                     names_.ofCurrency(reference.getRepresentation()));
    }
}

void Journal::putPrice(const Date& day, const std::string& commodity, double price, const std::string& in)
{
    if (!std::isfinite(price) || !isWithin(day)) {
        if (day == day_)
            remarks_.push_back(printable(commodity) + " has no price of the day that is a number");
        return;
    }
    ++prices_;
    priceText_ += form_.price(tableDate(day), commodity, journalNumber(price), in);
}
