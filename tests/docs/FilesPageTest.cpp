// The examples of docs/FILES.md are what the program writes, and it reads them.

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
#include "tests/support/Bytes.h"

#include <fstream>
#include <gtest/gtest.h>
#include <vector>

namespace {

const Date kFirst(3, 5, 1999);
const Date kSecond(4, 5, 1999);
const Date kSaved(5, 5, 1999);

/// The bytes of each block of the page that is marked as hex: on every line the digits before the explanation.
std::vector<std::string> examples()
{
    std::vector<std::string> blocks;
    std::ifstream page(PELORIN_FILES_PAGE);
    bool inside = false;
    for (std::string line; std::getline(page, line);) {
        if (line == "```hex")
            blocks.emplace_back();
        inside = line == "```hex" || (inside && line != "```");
        if (inside && line != "```hex")
            blocks.back() += bytesOf(line.substr(0, line.find("   ")));
    }
    return blocks;
}

Company* fill(Catalogue& catalogue)
{
    auto* dollar = new Currency("Dollar", "$", nullptr);
    catalogue.addCurrency(dollar);
    catalogue.setReferenceCurrency(dollar);
    auto* market = new Market("NYSE");
    market->setCurrency(dollar);
    auto* company = new Company(market, "Acme", "ACM");
    new CompanyQuote(company, kFirst, 1.5F);
    new SplitCompanyEvent(company, kFirst, 2, 1);
    new NoteCompanyEvent(company, kSecond, "Hi", "!");
    new CurrencyQuote(dollar, kFirst, 1);
    return company;
}

void fill(Wallet& wallet, const Catalogue& catalogue, Company* company)
{
    auto* share = new Share(&wallet, company);
    auto* main = new Account("Main");
    auto* rest = new Account("Rest");
    for (Account* account : {main, rest}) {
        account->setWallet(&wallet);
        account->setCurrency(catalogue.getReferenceCurrency());
    }
    rest->setDefaultTransferAccount(true);
    new DepositAccountOperation(kFirst, main, 1000, false);
    new TransferAccountOperation(kSecond, main, rest, 250, false);
    (new ShareOperation(kSecond, share, true, 100, 1.5F, false, 29.95F))->setAccount(main);
}

} // namespace

TEST(FilesPageTest, ExamplesAreWhatIsWrittenAndRead)
{
    const std::vector<std::string> pages = examples();
    ASSERT_EQ(pages.size(), 2U);
    Catalogue catalogue;
    Company* company = fill(catalogue);
    EXPECT_EQ(pages[0], written([&](FILE* file) { catalogue.wrt(file, kSaved); }));
    Wallet wallet;
    fill(wallet, catalogue, company);
    EXPECT_EQ(pages[1], written([&](FILE* file) { wallet.wrt(file, kSaved); }));

    Catalogue readCatalogue;
    ASSERT_EQ(readCatalogue.rd(BytesFile(pages[0])), 0);
    EXPECT_EQ(pages[0], written([&](FILE* file) { readCatalogue.wrt(file, kSaved); }));
    Wallet readWallet;
    readWallet.setCatalogue(readCatalogue);
    Date stamp;
    ASSERT_EQ(readWallet.rd(BytesFile(pages[1]), &stamp), 0);
    EXPECT_EQ(stamp, kSaved);
    EXPECT_EQ(pages[1], written([&](FILE* file) { readWallet.wrt(file, kSaved); }));
}
