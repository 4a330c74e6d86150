#include "portfolio/Wallet.h"

#include "market/Catalogue.h"
#include "market/Company.h"
#include "market/Currency.h"
#include "market/Market.h"
#include "portfolio/Account.h"
#include "portfolio/Operation.h"
#include "portfolio/Share.h"
#include "portfolio/WalletNames.h"

Wallet::Wallet() : shares_(this), accounts_(this), states_(this) {}

Wallet::~Wallet()
{
    states_.deleteAll();
    accounts_.deleteAll();
    shares_.deleteAll();
}

void Wallet::setCurrencies(int count, Currency** currencies)
{
    currencies_.assign(currencies, currencies + count);
}

void Wallet::setMarkets(int count, Market** markets)
{
    markets_.assign(markets, markets + count);
}

void Wallet::setCatalogue(const Catalogue& catalogue)
{
    currencies_ = catalogue.getCurrencies();
    markets_ = catalogue.getMarkets();
}

int Wallet::getCurrency(const String& name, Currency** out) const
{
    if (names_ != nullptr)
        return names_->getCurrency(name, out);
    for (Currency* currency : currencies_)
        if (currency->getName() == name) {
            *out = currency;
            return 0;
        }
    *out = nullptr;
    return -1;
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
    unsigned n;
    Share** shares = getAllShares(&n);
    for (unsigned i = 0; i < n; ++i)
        if (shares[i]->getCompanyAbbreviation() == abbreviation && shares[i]->getMarketName() == market) {
            *out = shares[i];
            return 0;
        }
    *out = nullptr;
    return -1;
}

Account* Wallet::getAccountByName(const String& name) const
{
    if (names_ != nullptr)
        return names_->getAccount(name);
    unsigned n;
    Account** accounts = getAllAccounts(&n);
    for (unsigned i = 0; i < n; ++i)
        if (accounts[i]->getName() == name)
            return accounts[i];
    return nullptr;
}

Account* Wallet::findDefaultTransferAccount(const String& currencyRepresentation) const
{
    unsigned n;
    Account** accounts = getAllAccounts(&n);
    Account* first = nullptr;
    for (unsigned i = 0; i < n; ++i) {
        Currency* currency;
        if (accounts[i]->getCurrency(&currency) != 0 || currency->getRepresentation() != currencyRepresentation)
            continue;
        if (accounts[i]->isDefaultTransferAccount())
            return accounts[i];
        if (first == nullptr)
            first = accounts[i];
    }
    return first;
}

void Wallet::removeAutomaticOperations()
{
    unsigned nAccounts;
    Account** accounts = getAllAccounts(&nAccounts);
    for (unsigned i = 0; i < nAccounts; ++i) {
        // Gathered first: each removal disturbs the order, and the list is to be sorted once.
        unsigned n;
        Operation** operations = accounts[i]->getAllOperations(&n);
        std::vector<Operation*> automatic;
        for (unsigned k = 0; k < n; ++k)
            if (operations[k]->isAutomatic())
                automatic.push_back(operations[k]);
        for (Operation* operation : automatic)
            delete operation;
    }
}
