#include "exchange/MarketPlaces.h"

#include "exchange/Table.h"
#include "market/Catalogue.h"

namespace {

constexpr char kMark = '\0'; // is in no part of a key

std::string keyOf(std::string_view first, std::string_view second)
{
    return (std::string(first) += kMark) += second;
}

std::string keyOf(std::string_view first, std::string_view second, std::string_view third)
{
    return (keyOf(first, second) += kMark) += third;
}

String toString(const std::string& text)
{
    return String(text.c_str());
}

} // namespace

MarketPlaces::MarketPlaces(const Catalogue& catalogue, MarketPlan& plan, const Named& usual)
    : plan_(plan), usual_(usual)
{
    for (Currency* currency : catalogue.getCurrencies()) {
        currencies_.try_emplace(std::string(currency->getRepresentation().comparedBytes()), currency);
        for (Market* market : currency->markets()) {
            enrol(market, currency);
            for (Company* company : market->companies()) {
                enrol(company, market);
                const std::string ticker(company->getAbbreviation().comparedBytes());
                if (const auto [entry, isFirst] = sole_.try_emplace(ticker, company); !isFirst)
                    entry->second = nullptr;
            }
        }
    }
}

void MarketPlaces::enrol(Market* market, Currency* currency)
{
    tradedIn_[market] = currency;
    // Under its currency, and for rows that leave the currency open. What stands there already comes before it.
    for (const std::string_view symbol : {currency->getRepresentation().comparedBytes(), std::string_view()})
        markets_.try_emplace(keyOf(market->getName().comparedBytes(), symbol), market);
}

void MarketPlaces::enrol(Company* company, Market* market)
{
    listedOn_[company] = market;
    const std::string_view ticker = company->getAbbreviation().comparedBytes();
    for (const std::string_view symbol :
         {tradedIn_.at(market)->getRepresentation().comparedBytes(), std::string_view()})
        companies_.try_emplace(keyOf(market->getName().comparedBytes(), symbol, ticker), company);
}

Currency* MarketPlaces::currency(const std::string& symbol)
{
    Currency*& currency = currencies_[symbol];
    if (currency == nullptr) {
        currency = plan_.newCurrencies
                       .emplace_back(std::make_unique<Currency>(toString(symbol), toString(symbol), plan_.reference))
                       .get();
    }
    return currency;
}

SeriesValues<Currency>* MarketPlaces::ratesOf(Currency* currency)
{
    SeriesValues<Currency>*& rates = rates_[currency];
    if (rates == nullptr)
        rates = &plan_.rates.emplace_back(SeriesValues<Currency>{currency, currency, false, {}});
    return rates;
}

void MarketPlaces::mention(const std::string& ticker, const Named& named)
{
    const Place place = find(ticker, named);
    if (place.market == nullptr)
        makeMarket(place.name, named.currency);
}

SeriesValues<Company>* MarketPlaces::company(const std::string& ticker, const Named& named, const std::string& name)
{
    Place place = find(ticker, named);
    // From here on nothing of the row contradicts what is known.
    if (place.market == nullptr)
        place.market = makeMarket(place.name, named.currency);
    const bool isNew = place.company == nullptr;
    if (isNew) {
        auto made = std::make_unique<Company>(nullptr, toString(name), toString(ticker));
        place.company =
            plan_.newCompanies.emplace_back(MarketPlan::NewCompany{std::move(made), place.market}).company.get();
        enrol(place.company, place.market);
    }
    SeriesValues<Company>*& quotes = quotes_[place.company];
    if (quotes == nullptr)
        quotes =
            &plan_.quotes.emplace_back(SeriesValues<Company>{place.company, tradedIn_.at(place.market), isNew, {}});
    return quotes;
}

MarketPlaces::Place MarketPlaces::find(const std::string& ticker, const Named& named) const
{
    if (named.market.empty()) {
        if (const auto sole = sole_.find(ticker); sole != sole_.end() && sole->second != nullptr) {
            Market* market = listedOn_.at(sole->second);
            if (!named.currency.empty() && named.currency != tradedIn(market))
                throw UnusableRow("has " + shown(named.currency) + " for " + shown(ticker) + ", which is quoted in " +
                                  shown(tradedIn(market)));
            return {"", market, sole->second};
        }
        // Else a first line like that would settle in what currency all tickers of unknown market are quoted.
        if (!named.currency.empty() && named.currency != usual_.currency &&
            !markets_.contains(keyOf(usual_.market, named.currency)))
            throw UnusableRow("has the currency " + shown(named.currency) + " but no market");
    }
    const std::string& name = named.market.empty() ? usual_.market : named.market;
    const auto first = markets_.find(keyOf(name, ""));
    if (first == markets_.end())
        return {name};
    const auto market = markets_.find(keyOf(name, named.currency));
    if (market == markets_.end())
        throw UnusableRow("has " + shown(named.currency) + " for the market " + shown(name) + ", which trades in " +
                          shown(tradedIn(first->second)));
    // Of several markets of one name, one that has the company comes before the first.
    if (const auto company = companies_.find(keyOf(name, named.currency, ticker)); company != companies_.end())
        return {name, listedOn_.at(company->second), company->second};
    return {name, market->second};
}

std::string MarketPlaces::tradedIn(const Market* market) const
{
    return std::string(tradedIn_.at(market)->getRepresentation().comparedBytes());
}

Market* MarketPlaces::makeMarket(const std::string& name, const std::string& currencyOrNone)
{
    Currency* tradesIn = currency(currencyOrNone.empty() ? usual_.currency : currencyOrNone);
    auto made = std::make_unique<Market>(toString(name));
    Market* market = plan_.newMarkets.emplace_back(MarketPlan::NewMarket{std::move(made), tradesIn}).market.get();
    enrol(market, tradesIn);
    return market;
}
