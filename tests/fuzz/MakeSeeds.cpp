// Writes small valid files for the fuzzers to start from: fuzz_seeds FOLDER makes FOLDER/market and FOLDER/wallet.

#include "market/Catalogue.h"
#include "market/Company.h"
#include "market/Currency.h"
#include "market/Market.h"
#include "market/NoteCompanyEvent.h"
#include "market/SplitCompanyEvent.h"
#include "portfolio/Account.h"
#include "portfolio/DepositAccountOperation.h"
#include "portfolio/Share.h"
#include "portfolio/ShareOperation.h"
#include "portfolio/TransferAccountOperation.h"
#include "portfolio/Wallet.h"
#include "tests/fuzz/SmallCatalogue.h"

#include <filesystem>

namespace {

const Date kStamp(3, 5, 1999);

/// Everything here is owned by what it is given to.
template <class Object>
bool save(const Object& object, const std::filesystem::path& path)
{
    FILE* file = std::fopen(path.c_str(), "wb");
    if (file == nullptr)
        return false;
    const int result = object.wrt(file, kStamp);
    return std::fclose(file) == 0 && result == 0;
}

bool saveMarkets(const std::filesystem::path& folder)
{
    Catalogue empty;
    Catalogue rates;
    auto* euro = new Currency("Euro", "E", nullptr);
    rates.addCurrency(euro);
    rates.setReferenceCurrency(euro);
    new CurrencyQuote(euro, kStamp, 1);
    Catalogue full;
    fillSmallCatalogue(full);
    Company* company;
    full.getMarkets().front()->getCompany("A", &company);
    new NoteCompanyEvent(company, kStamp, "Title", "Text");
    new SplitCompanyEvent(company, kStamp, 2, 1);
    return save(empty, folder / "empty") && save(rates, folder / "rates") && save(full, folder / "full");
}

Account* addAccount(Wallet& wallet, const char* name, const char* currencyName)
{
    Currency* currency;
    wallet.getCurrency(currencyName, &currency);
    auto* account = new Account(name);
    account->setWallet(&wallet);
    account->setCurrency(currency);
    return account;
}

void trade(Share* share, Account* account, bool buy, int quantity, const Date& date)
{
    auto* operation = new ShareOperation(date, share, buy, quantity, 40, false, 29.95F);
    operation->setAccount(account);
}

Share* addShare(Wallet& wallet, const char* market, const char* ticker)
{
    Company* company;
    wallet.getCompany(market, ticker, &company);
    return new Share(&wallet, company);
}

bool saveWallets(const std::filesystem::path& folder)
{
    Catalogue catalogue;
    fillSmallCatalogue(catalogue);
    Wallet wallet;
    setCatalogue(wallet, catalogue);
    bool isSaved = save(wallet, folder / "empty");
    Account* account = addAccount(wallet, "a", "E");
    new DepositAccountOperation(kStamp, account, 1000, false);
    isSaved = isSaved && save(wallet, folder / "deposit");
    Account* other = addAccount(wallet, "b", "D");
    other->setDefaultTransferAccount(true);
    new TransferAccountOperation(kStamp, account, other, 100, false);
    new TransferAccountOperation(Date(4, 5, 1999), other, account, 50, false);
    isSaved = isSaved && save(wallet, folder / "transfers");
    Share* share = addShare(wallet, "P", "A");
    Share* abroad = addShare(wallet, "Y", "C");
    trade(share, account, true, 10, kStamp);
    trade(share, account, true, 10, Date(20, 5, 1999));
    trade(share, account, false, 15, Date(7, 6, 1999));
    trade(abroad, account, true, 100, Date(1, 3, 2000)); // still held today: previsions sell it
    return isSaved && save(wallet, folder / "trades");
}

} // namespace

int main(int argc, char** argv)
{
    if (argc != 2) {
        std::fputs("usage: fuzz_seeds FOLDER\n", stderr);
        return 2;
    }
    const std::filesystem::path folder = argv[1];
    std::filesystem::create_directories(folder / "market");
    std::filesystem::create_directories(folder / "wallet");
    if (!saveMarkets(folder / "market") || !saveWallets(folder / "wallet")) {
        std::fprintf(stderr, "fuzz_seeds: cannot write into %s\n", argv[1]);
        return 1;
    }
    return 0;
}
