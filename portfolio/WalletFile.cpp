// The portfolio file: how a wallet is written and read. docs/FILES.md has the layout.

#include "market/RecordList.h"
#include "portfolio/Wallet.h"
#include "portfolio/WalletNames.h"

#include <memory>

int Wallet::wrt(FILE* file, const Date& stamp) const
{
    stamp.wrt(file);
    // What names something comes behind what it names: the trades of the accounts behind the holdings, the transfers
    // behind all accounts.
    fwriteint(file, static_cast<int>(getNbrShares()));
    for (const Share* share : shares()) {
        share->getMarketName().wrt(file);
        share->getCompanyAbbreviation().wrt(file);
    }
    fwriteint(file, static_cast<int>(getNbrAccounts()));
    for (const Account* account : accounts()) {
        const String& currency = account->getCurrencyName();
        if (currency.isUndefined())
            return -1; // a reader could not find the account's currency again
        currency.wrt(file);
        if (account->wrt(file) != 0)
            return -1;
    }
    // In the order of the accounts, from which a reader knows whose block is whose.
    for (const Account* account : accounts())
        if (account->writeTransferOperations(file) != 0)
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
    // The former content goes in any case, also when the file turns out to be damaged.
    shares_.deleteAll();
    accounts_.deleteAll();
    removeAllStates();

    // Thousands of records name what they belong to: look-ups go through an index for as long as the file is read.
    WalletNames names(markets_, currencies_);
    names_ = &names;
    const bool isRead = readShares(file) == 0 && readAccounts(file) == 0;
    // Intended: a transfer to an unknown account does not fail the file, so that a portfolio that names an account it
    // no longer has still opens; what follows is then read out of place, and may well meet the end.
    hasLostRecipient_ = false;
    if (isRead)
        for (Account* account : accounts())
            account->readTransferOperations(file, &hasLostRecipient_);
    // The names may change again from here on, which the index would not see.
    names_ = nullptr;
    if (!isRead)
        return -1;
    readParameters(file);
    return reachedEnd(file) && !hasLostRecipient_ ? -1 : 0;
}

int Wallet::readShares(FILE* file)
{
    return readRecords(file, [&] {
        String market;
        String abbreviation;
        if (market.rd(file) != 0 || abbreviation.rd(file) != 0)
            return -1;
        Company* company;
        // A portfolio without one of its holdings would have other balances, so it is not opened at all.
        if (getCompany(market, abbreviation, &company) != 0) {
            std::puts("Error getting a company -> the portofolio doesn't match the company descriptions...");
            return -1;
        }
        // The wallet owns the holding. Trades find it in the index from here on.
        names_->add(new Share(this, company));
        return 0;
    });
}

int Wallet::readAccounts(FILE* file)
{
    return readRecords(file, [&] {
        String currencyName;
        Currency* currency;
        // Of a name that is not known the index keeps note, for the message to the user.
        if (currencyName.rd(file) != 0 || getCurrency(currencyName, &currency) != 0)
            return -1;
        auto account = std::make_unique<Account>();
        // Wallet and currency come first: the operations are read by way of them.
        account->setWallet(this);
        account->setCurrency(currency);
        const int result = account->rd(file);
        // An account cut short stays for the sake of the operations in it that are whole.
        if (result == 0 || account->getNbrOperations() > 0)
            // The account is the wallet's since `setWallet`. What is not kept destroys itself, and so leaves wallet and
            // currency.
            names_->add(account.release());
        return result;
    });
}

void Wallet::writeParameters(FILE* file) const
{
    // All are floats but the period, which has 16 bits in the file.
    for (int i = 0; i < kParameterCount; ++i)
        if (i == kInvestementPeriod)
            fwriteshort(file, static_cast<unsigned short>(getInvestementPeriod()));
        else
            fwritefloat(file, parameters_[static_cast<std::size_t>(i)]);
}

void Wallet::readParameters(FILE* file)
{
    for (int i = 0; i < kParameterCount; ++i) {
        const float value = i == kInvestementPeriod ? static_cast<short>(freadshort(file)) : freadfloat(file);
        // A portfolio that was read out of place has to be of use without the parameters that the end has cost it.
        if (reachedEnd(file))
            return;
        parameters_[static_cast<std::size_t>(i)] = value;
    }
}
