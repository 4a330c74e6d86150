#include "portfolio/WalletNames.h"

#include "portfolio/Account.h"
#include "portfolio/Share.h"

namespace {

/// Where what has a name, but no market, is looked for.
const String kNoMarket("");

} // namespace

std::size_t WalletNames::KeyHash::operator()(const Key& key) const
{
    // Multiplied, so that a market and a ticker of the same name do not cancel out.
    const std::hash<std::string_view> hash;
    return hash(key.first) * 31 + hash(key.second);
}

WalletNames::Key WalletNames::keyOf(const Market& market, const Company& company)
{
    return {market.getName().comparedBytes(), company.getAbbreviation().comparedBytes()};
}

WalletNames::WalletNames(const std::vector<Market*>& markets, const std::vector<Currency*>& currencies)
{
    // `try_emplace` keeps what is there: of equal names the first counts, as in a search from the front. What has no
    // text is left out, because it equals no name, its own included; an empty text is a name like any other.
    for (Currency* currency : currencies)
        if (currency->getName().hasText())
            currencies_.try_emplace(Key("", currency->getName().comparedBytes()), currency);
    for (const Market* market : markets)
        for (Company* company : market->companies())
            if (market->getName().hasText() && company->getAbbreviation().hasText())
                companies_.try_emplace(keyOf(*market, *company), company);
}

void WalletNames::add(Share* share)
{
    // Later holdings of the same company are not found: the first one gets all trades, as in a search from the front.
    const Company* company = share->company();
    if (company != nullptr && company->market() != nullptr)
        shares_.try_emplace(keyOf(*company->market(), *company), share);
}

void WalletNames::add(Account* account)
{
    accounts_.try_emplace(Key("", account->getName().comparedBytes()), account);
}

template <class T>
int WalletNames::find(const Map<T>& map, const String& market, const String& name, T** out)
{
    const bool canMatch = market.hasText() && name.hasText();
    // The views live as long as this call, which is all that a search needs; the keys in the map refer to names that
    // stay.
    const auto found = canMatch ? map.find({market.comparedBytes(), name.comparedBytes()}) : map.end();
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

int WalletNames::getCurrency(const String& name, Currency** out) const
{
    return find(currencies_, kNoMarket, name, out);
}

Account* WalletNames::getAccount(const String& name) const
{
    Account* account = nullptr;
    find(accounts_, kNoMarket, name, &account);
    return account;
}
