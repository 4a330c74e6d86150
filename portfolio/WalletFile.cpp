// The portfolio file: how a wallet is written and read. docs/FILES.md has the layout.

#include "foundation/FieldIO.h"
#include "market/Company.h"
#include "market/Currency.h"
#include "portfolio/Account.h"
#include "portfolio/Share.h"
#include "portfolio/Wallet.h"
#include "portfolio/WalletNames.h"

#include <memory>

int Wallet::wrt(FILE*) const
{
    return -1;
}

int Wallet::rd(FILE*)
{
    return -1;
}

int Wallet::wrt(FILE* file, const Date& stamp) const
{
    stamp.wrt(file);
    unsigned nShares;
    Share** shares = getAllShares(&nShares);
    fwriteint(file, static_cast<int>(nShares));
    for (unsigned i = 0; i < nShares; ++i) {
        shares[i]->getMarketName().wrt(file);
        shares[i]->getCompanyAbbreviation().wrt(file);
    }
    unsigned nAccounts;
    Account** accounts = getAllAccounts(&nAccounts);
    fwriteint(file, static_cast<int>(nAccounts));
    for (unsigned i = 0; i < nAccounts; ++i) {
        const String currency = accounts[i]->getCurrencyName();
        if (currency.isUndefined())
            return -1; // a reader could not find the account's currency again
        currency.wrt(file);
        if (accounts[i]->wrt(file) != 0)
            return -1;
    }
    for (unsigned i = 0; i < nAccounts; ++i)
        if (accounts[i]->writeTransferOperations(file) != 0)
            return -1;
    writeParameters(file);
    return std::ferror(file) == 0 ? 0 : -1;
}

int Wallet::rd(FILE* file, Date* stamp)
{
    Date date;
    date.rd(file);
    if (stamp != nullptr)
        *stamp = date;
    shares_.deleteAll();
    accounts_.deleteAll();
    removeAllStates();

    // Thousands of records name what they belong to: look-ups go through an index for as long as the file is read.
    WalletNames names(markets_, currencies_);
    names_ = &names;
    const bool isRead = readShares(file) == 0 && readAccounts(file) == 0;
    unsigned n;
    Account** accounts = getAllAccounts(&n);
    // Intended: a transfer to an unknown account does not fail the file, so that a portfolio that names an account it
    // no longer has still opens; what follows is then read out of place.
    for (unsigned i = 0; isRead && i < n; ++i)
        accounts[i]->readTransferOperations(file);
    names_ = nullptr;
    unknownName_ = isRead ? String() : names.getUnknown();
    if (!isRead)
        return -1;
    readParameters(file);
    return reachedEnd(file) ? -1 : 0;
}

int Wallet::readShares(FILE* file)
{
    auto missing = static_cast<unsigned>(freadint(file));
    for (; missing > 0 && !reachedEnd(file); --missing) {
        String market;
        String abbreviation;
        if (market.rd(file) != 0 || abbreviation.rd(file) != 0)
            return -1;
        Company* company;
        if (getCompany(market, abbreviation, &company) != 0) {
            std::puts("Error getting a company -> the portofolio doesn't match the company descriptions...");
            return -1;
        }
        names_->add(new Share(this, company));
    }
    return reachedEnd(file) ? -1 : 0;
}

int Wallet::readAccounts(FILE* file)
{
    auto missing = static_cast<unsigned>(freadint(file));
    for (; missing > 0 && !reachedEnd(file); --missing) {
        String currencyName;
        Currency* currency;
        if (currencyName.rd(file) != 0 || getCurrency(currencyName, &currency) != 0)
            return -1;
        auto account = std::make_unique<Account>();
        account->setWallet(this);
        account->setCurrency(currency);
        const int result = account->rd(file);
        // An account cut short stays for the sake of the operations in it that are whole.
        if (result == 0 || account->getNbrOperations() > 0)
            names_->add(account.release());
        if (result != 0)
            return -1;
    }
    return reachedEnd(file) ? -1 : 0;
}

void Wallet::writeParameters(FILE* file) const
{
    fwritefloat(file, buyCost_);
    fwritefloat(file, sellCost_);
    fwritefloat(file, buyRateCost_);
    fwritefloat(file, sellRateCost_);
    fwriteshort(file, static_cast<unsigned short>(investementPeriod_));
    fwritefloat(file, beginProfitSellRate_);
    fwritefloat(file, endProfitSellRate_);
    fwritefloat(file, beginLoseSellRate_);
    fwritefloat(file, endLoseSellRate_);
    fwritefloat(file, reinvestRate_);
}

void Wallet::readParameters(FILE* file)
{
    buyCost_ = freadfloat(file);
    sellCost_ = freadfloat(file);
    buyRateCost_ = freadfloat(file);
    sellRateCost_ = freadfloat(file);
    investementPeriod_ = static_cast<short>(freadshort(file));
    beginProfitSellRate_ = freadfloat(file);
    endProfitSellRate_ = freadfloat(file);
    beginLoseSellRate_ = freadfloat(file);
    endLoseSellRate_ = freadfloat(file);
    reinvestRate_ = freadfloat(file);
}
