#include "portfolio/Share.h"

#include "market/Company.h"
#include "market/Market.h"
#include "portfolio/ShareOperation.h"
#include "portfolio/Wallet.h"

#include <algorithm>
#include <iterator>
#include <vector>

Share::Share() : operations_(this), states_(this) {}

Share::Share(Wallet* wallet, Company* company) : Share()
{
    setWallet(wallet);
    setCompany(company);
}

Share::~Share()
{
    // Each operation leaves its account's list, too, so the balances change with the holding.
    operations_.deleteAll();
    states_.deleteAll();
    setWallet(nullptr);
    setCompany(nullptr);
}

const String& Share::getMarketName() const
{
    const Market* market = company() != nullptr ? company()->market() : nullptr;
    return market != nullptr ? market->getName() : String::none();
}

int Share::getQuote(const Date& date, float* out) const
{
    *out = company() != nullptr ? company()->getRealQuote(date) : 0;
    return company() != nullptr ? 0 : -1;
}

void Share::removeAutomaticShareOperations()
{
    // Gathered first: each removal disturbs the order, and the list is to be sorted once.
    std::vector<ShareOperation*> automatic;
    std::ranges::copy_if(shareOperations(), std::back_inserter(automatic), &ShareOperation::isAutomatic);
    // Each unlinks itself from the holding, and from an account if it has one.
    for (ShareOperation* operation : automatic)
        delete operation;
}

void CompanyToShares::deleteAll()
{
    OneToManyAssociation::deleteAll();
}

int Share::setWallet(Wallet* wallet)
{
    return wallet_.set(this, wallet);
}

int Company::addShare(Share* share)
{
    return shares_.add(share);
}

int Company::removeShare(Share* share)
{
    return shares_.remove(share);
}
