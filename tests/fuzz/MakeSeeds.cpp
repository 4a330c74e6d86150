// Writes a small valid file and page of each kind for the fuzzers to start from: fuzz_seeds FOLDER makes FOLDER/market,
// FOLDER/wallet, FOLDER/latest and FOLDER/history.

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
#include <fstream>
#include <utility>

namespace {

const Date kStamp(3, 5, 1999);

template <class Object>
bool save(const Object& object, const std::filesystem::path& folder)
{
    std::filesystem::create_directories(folder);
    FILE* file = std::fopen((folder / "full").c_str(), "wb");
    const int result = file != nullptr ? object.wrt(file, kStamp) : -1;
    return file != nullptr && std::fclose(file) == 0 && result == 0;
}

bool savePage(const char* page, const std::filesystem::path& folder)
{
    std::filesystem::create_directories(folder);
    return static_cast<bool>(std::ofstream(folder / "page") << page << std::flush);
}

/// An event of each kind for the first company.
Company* addEvents(const Catalogue& catalogue)
{
    Company* company;
    catalogue.getMarkets().front()->getCompany("A", &company);
    new NoteCompanyEvent(company, kStamp, "Title", "Text");
    new SplitCompanyEvent(company, kStamp, 2, 1);
    return company;
}

/// Two accounts, a holding and an operation of each kind. All of it is owned by what it is given to.
void fill(Wallet& wallet, const Catalogue& catalogue, Company* company)
{
    auto* account = new Account("a");
    auto* other = new Account("b");
    for (Account* each : {account, other})
        each->setWallet(&wallet);
    account->setCurrency(catalogue.getCurrencies()[0]);
    other->setCurrency(catalogue.getCurrencies()[1]);
    other->setDefaultTransferAccount(true);
    new DepositAccountOperation(kStamp, account, 1000, false);
    new TransferAccountOperation(kStamp, account, other, 100, false);
    auto* share = new Share(&wallet, company);
    // Ten of the last are still held today: previsions sell them.
    for (const auto& [buy, date] : {std::pair(true, kStamp), {false, Date(7, 6, 1999)}, {true, Date(1, 3, 2000)}})
        (new ShareOperation(date, share, buy, 10, 40, false, 29.95F))->setAccount(account);
}

} // namespace

int main(int argc, char** argv)
{
    const std::filesystem::path folder = argc == 2 ? argv[1] : "";
    Catalogue catalogue;
    fillSmallCatalogue(catalogue);
    Wallet wallet;
    wallet.setCatalogue(catalogue);
    fill(wallet, catalogue, addEvents(catalogue));
    const char* latest = "<html><td nowrap><b>112 <sup>3</sup>/<sub>8</sub></b></td><td nowrap><b>45</b></td>";
    const char* history = "<pre><b>Date Close Volume (00s)</b>\n5/3/1999 45.5 46 100\n05/04/1999\t46\t47\t9\n</pre>";
    if (argc == 2 && save(catalogue, folder / "market") && save(wallet, folder / "wallet") &&
        savePage(latest, folder / "latest") && savePage(history, folder / "history"))
        return 0;
    std::fputs("usage: fuzz_seeds FOLDER, one that can be written into\n", stderr);
    return 1;
}
