#include "portfolio/Wallet.h"

#include "market/Catalogue.h"
#include "portfolio/WalletNames.h"

#include <algorithm>
#include <iterator>

Wallet::Wallet() : shares_(this), accounts_(this), states_(this) {}

Wallet::~Wallet()
{
    // States refer to accounts and holdings, operations to holdings. What refers goes before what it refers to.
    removeAllStates();
    accounts_.deleteAll();
    shares_.deleteAll();
}

void Wallet::setCatalogue(const Catalogue& catalogue)
{
    // Copies: what is added to the catalogue later is not known here until the next call.
    currencies_ = catalogue.getCurrencies();
    markets_ = catalogue.getMarkets();
}

int Wallet::getCurrency(const String& name, Currency** out) const
{
    // While a file is read its index answers, here and below: these lists would be gone through for every record.
    if (names_ != nullptr)
        return names_->getCurrency(name, out);
    const auto found = std::ranges::find(currencies_, name, &Currency::getName);
    *out = found != currencies_.end() ? *found : nullptr;
    return *out != nullptr ? 0 : -1;
}

int Wallet::getCompany(const String& market, const String& abbreviation, Company** out) const
{
    if (names_ != nullptr)
        return names_->getCompany(market, abbreviation, out);
    for (const Market* candidate : markets_)
        if (candidate->getName() == market && candidate->getCompany(abbreviation, out) == 0)
            return 0;
    *out = nullptr;
    return -1;
}

int Wallet::getShare(const String& market, const String& abbreviation, Share** out) const
{
    if (names_ != nullptr)
        return names_->getShare(market, abbreviation, out);
    for (Share* share : shares())
        if (share->getCompanyAbbreviation() == abbreviation && share->getMarketName() == market) {
            *out = share;
            return 0;
        }
    *out = nullptr;
    return -1;
}

Account* Wallet::getAccountByName(const String& name) const
{
    if (names_ != nullptr)
        return names_->getAccount(name);
    const auto all = accounts();
    const auto found = std::ranges::find(all, name, &Account::getName);
    return found != all.end() ? *found : nullptr;
}

Account* Wallet::findDefaultTransferAccount(const String& currencyRepresentation) const
{
    // The one that is flagged comes before all others, wherever it stands.
    Account* first = nullptr;
    for (Account* account : accounts()) {
        const Currency* currency = account->currency();
        if (currency == nullptr || currency->getRepresentation() != currencyRepresentation)
            continue;
        if (account->isDefaultTransferAccount())
            return account;
        if (first == nullptr)
            first = account;
    }
    return first;
}

void Wallet::removeAutomaticOperations()
{
    for (const Account* account : accounts()) {
        // Gathered first: each removal disturbs the order, and the list is to be sorted once.
        std::vector<Operation*> automatic;
        std::ranges::copy_if(account->operations(), std::back_inserter(automatic), &Operation::isAutomatic);
        // Each leaves the lists it is in: a transfer those of both accounts.
        for (Operation* operation : automatic)
            delete operation;
    }
}

std::vector<const Operation*> operationsByDate(const Wallet& wallet)
{
    std::vector<const Operation*> operations;
    for (const Account* account : wallet.accounts())
        operations.insert(operations.end(), account->operations().begin(), account->operations().end());
    std::ranges::stable_sort(operations, {}, &Operation::getDate);
    return operations;
}
