#include "portfolio/WalletNames.h"

#include "market/Company.h"
#include "market/Currency.h"
#include "market/Market.h"
#include "portfolio/Account.h"
#include "portfolio/Share.h"

std::size_t WalletNames::PairHash::operator()(const Pair& pair) const
{
    const std::hash<std::string_view> hash;
    return hash(pair.first) * 31 + hash(pair.second);
}

WalletNames::Pair WalletNames::pairOf(const Market& market, const Company& company)
{
    return {market.getName().comparedBytes(), company.getAbbreviation().comparedBytes()};
}

WalletNames::WalletNames(const std::vector<Market*>& markets, const std::vector<Currency*>& currencies)
{
    // `try_emplace` keeps what is there: of equal names the first counts, as in a search from the front.
    for (Currency* currency : currencies)
        if (currency->getName().hasText())
            currencies_.try_emplace(currency->getName().comparedBytes(), currency);
    for (const Market* market : markets)
        for (Company* company : market->companies())
            if (market->getName().hasText() && company->getAbbreviation().hasText())
                companies_.try_emplace(pairOf(*market, *company), company);
}

void WalletNames::add(Share* share)
{
    const Company* company = share->company();
    if (company != nullptr && company->market() != nullptr)
        shares_.try_emplace(pairOf(*company->market(), *company), share);
}

void WalletNames::add(Account* account)
{
    accounts_.try_emplace(account->getName().comparedBytes(), account);
}

template <class T>
int WalletNames::find(const PairMap<T>& map, const String& market, const String& abbreviation, T** out)
{
    const bool canMatch = market.hasText() && abbreviation.hasText();
    const auto found = canMatch ? map.find({market.comparedBytes(), abbreviation.comparedBytes()}) : map.end();
    *out = found != map.end() ? found->second : nullptr;
    return *out != nullptr ? 0 : -1;
}

int WalletNames::getCompany(const String& market, const String& abbreviation, Company** out) const
{
    return find(companies_, market, abbreviation, out);
}

int WalletNames::getShare(const String& market, const String& abbreviation, Share** out) const
{
    return find(shares_, market, abbreviation, out);
}

template <class T>
T* WalletNames::find(const Map<T>& map, const String& name)
{
    const auto found = name.hasText() ? map.find(name.comparedBytes()) : map.end();
    return found != map.end() ? found->second : nullptr;
}

int WalletNames::getCurrency(const String& name, Currency** out) const
{
    *out = find(currencies_, name);
    return *out != nullptr ? 0 : -1;
}

Account* WalletNames::getAccount(const String& name) const
{
    return find(accounts_, name);
}
