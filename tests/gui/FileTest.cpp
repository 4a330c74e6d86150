// Loading, saving and starting anew, by buttons and panels.

#include "platform/Entry.h"
#include "platform/Message.h"
#include "portfolio/Account.h"
#include "portfolio/Wallet.h"
#include "tests/gui/WindowFixture.h"
#include "tests/support/ToolRun.h"

#include <filesystem>
#include <fstream>
#include <gmock/gmock.h>
#include <sys/stat.h>

namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

class FileTest : public WindowTest {
protected:
    void loadMarkets(const std::string& path) { load(kCompanyPage, "btnLoadMarket", path); }
    void loadWallet(const std::string& path) { load(kPortoFolioPage, "btnLoadPortoFolio", path); }
    void load(Page page, const char* button, const std::string& path)
    {
        show(page);
        if (page == kPortoFolioPage || window().catalogue().getNbrCurrencies() > 0)
            answerNextAlert("Continue");
        click(button);
        answerPanel("OpenPanel", path);
    }
    void receive(const BMessage& refs, const std::string& expected)
    {
        clearMessage();
        window().PostMessage(&refs);
        settle();
        EXPECT_EQ(message(), expected);
    }

    static void write(const std::string& path, const std::string& content)
    {
        std::ofstream(path, std::ios::binary) << content;
    }
};

TEST_F(FileTest, SampleComesInThroughTheButtonsAndIsSavedUnchanged)
{
    loadSample();
    const ToolRun valued(PELORIN_VALUE, "'" + marketFile() + "' '" + walletFile() + "' --date 21/11/2024",
                         TemporaryFolder("pelorin-gui-value"));
    const std::string total = text("txtTotalValue");
    EXPECT_THAT(valued.out, testing::HasSubstr(total.substr(0, total.find(' '))));
    const auto market = std::filesystem::file_size(marketFile());
    const auto portfolio = std::filesystem::file_size(walletFile());
    follow({{{}, "btnSavePortoFolio", "Wallet successfully saved..."}});
    show(kCurrencyPage);
    follow({{{}, "btnSaveMarket", "Currencies successfully saved..."}});
    // The stamps of the day are all that differs: the records are as long as before, and load to the same again.
    EXPECT_EQ(std::filesystem::file_size(marketFile()), market);
    EXPECT_EQ(std::filesystem::file_size(walletFile()), portfolio);
    restart();
    loadMarkets(marketFile());
    loadWallet(walletFile());
    EXPECT_EQ(text("txtTotalValue"), total);
}

TEST_F(FileTest, LoadingAsksWhereSomethingCouldBeLost)
{
    makeSample();
    show(kCompanyPage);
    click("btnLoadMarket");
    EXPECT_THAT(alerts(), IsEmpty()) << "nothing is there yet";
    EXPECT_EQ(panelFolder("OpenPanel"), folder() + "/Companies");
    answerPanel("OpenPanel", "");
    EXPECT_EQ(window().catalogue().getNbrCurrencies(), 0U);

    const std::pair<Page, const char*> buttons[] = {{kCurrencyPage, "btnLoadMarket"},
                                                    {kPortoFolioPage, "btnLoadPortoFolio"}};
    loadMarkets(marketFile());
    for (const auto& [page, button] : buttons) {
        show(page);
        answerNextAlert("Cancel");
        click(button);
        EXPECT_EQ(panelFolder("OpenPanel"), "");
    }
    EXPECT_THAT(alerts(), ElementsAre("This will delete all unsaved changes to the wallet and the markets...",
                                      "This will delete all unsaved changes to the wallet..."))
        << "also of an empty portfolio";
    answerNextAlert("Continue");
    click("btnLoadPortoFolio");
    EXPECT_EQ(panelFolder("OpenPanel"), folder() + "/PortoFolios");
    answerPanel("OpenPanel", "");
}

TEST_F(FileTest, MarketLoadThrowsThePortfolioAwayAndHasEveryCurrencyTwiceAndEveryMarketOnce)
{
    loadSample();
    const unsigned currencies = window().catalogue().getNbrCurrencies();
    const auto markets = window().catalogue().getMarkets().size();
    ASSERT_GT(currencies, 1U);
    show(kParameterPage);
    enter("txtBuyCost", "12.5");
    loadMarkets(marketFile());
    EXPECT_EQ(message(), "Markets successfully loaded...");
    EXPECT_EQ(window().catalogue().getNbrCurrencies(), 2 * currencies);
    EXPECT_EQ(window().catalogue().getMarkets().size(), markets);
    EXPECT_EQ(wallet().getNbrAccounts(), 0U);
    show(kParameterPage);
    EXPECT_EQ(text("txtBuyCost"), "29.95");
    show(kPortoFolioPage);
    EXPECT_THAT(rows("lstAccounts"), IsEmpty());
}

TEST_F(FileTest, FileThatCannotBeOpenedLeavesEverything)
{
    loadSample();
    const auto currencies = window().catalogue().getNbrCurrencies();
    BMessage refs(B_REFS_RECEIVED);
    receive(refs, "ERROR GETTING REF");
    const std::string pipe = folder() + "/pipe"; // which nobody writes into: opening it would wait for ever
    ASSERT_EQ(mkfifo(pipe.c_str(), 0600), 0);
    for (const Page page : {kCompanyPage, kPortoFolioPage}) {
        for (const entry_ref& odd : {entry_ref{folder(), "missing"}, entry_ref{folder(), "pipe"},
                                     entry_ref{folder(), "Companies"}, entry_ref{"/dev", "zero"}}) {
            show(page);
            refs = BMessage(B_REFS_RECEIVED);
            refs.AddRef("refs", &odd);
            receive(refs, "OPEN FAILED: " + odd.directory + '/' + odd.name);
        }
        load(page, page == kCompanyPage ? "btnLoadMarket" : "btnLoadPortoFolio", pipe);
        EXPECT_EQ(message(), "OPEN FAILED: " + pipe);
    }
    for (const Page page : {kOperationPage, kParameterPage}) { // which have no files
        show(page);
        receive(refs, "");
        for (const uint32 code : {'CBLd', 'WBLd', 'CBSv', 'WBSv'})
            post(code);
        EXPECT_EQ(panelFolder("OpenPanel") + panelFolder("SavePanel") + message(), "");
    }
    EXPECT_EQ(window().catalogue().getNbrCurrencies(), currencies);
    EXPECT_GT(wallet().getNbrAccounts(), 0U);
}

TEST_F(FileTest, DamagedMarketFileKeepsWhatWasReadAndIsNotSavedOver)
{
    makeSample();
    const std::string whole = contentOf(marketFile());
    const std::string damaged = folder() + "/Companies/Damaged";
    write(damaged, whole.substr(0, whole.size() / 2));
    loadMarkets(damaged);
    EXPECT_EQ(message(), "Failed to load the markets");
    EXPECT_GT(window().catalogue().getNbrCurrencies(), 0U);
    click("btnSaveMarket");
    EXPECT_EQ(panelFolder("SavePanel"), folder() + "/Companies") << "no path is known to save to";
    answerPanel("SavePanel", "");
    EXPECT_EQ(contentOf(damaged).size(), whole.size() / 2);

    // Nor do the remains go into the place of the file that was loaded before, until a name is given.
    loadMarkets(marketFile());
    loadMarkets(damaged);
    click("btnSaveMarket");
    answerPanel("SavePanel", "Rest");
    EXPECT_EQ(message(), "Currencies successfully saved...");
    EXPECT_EQ(contentOf(marketFile()), whole);
    click("btnSaveMarket");
    EXPECT_EQ(panelFolder("SavePanel"), "");
}

TEST_F(FileTest, DamagedPortfolioGivesAnEmptyOneAndTheVersionSavedOverIsKept)
{
    loadSample();
    const std::string damaged = folder() + "/PortoFolios/Damaged";
    write(damaged, "no portfolio");
    loadWallet(damaged);
    EXPECT_EQ(message(), "Wallet successfully loaded...");
    EXPECT_EQ(wallet().getNbrAccounts(), 0U);
    click("btnSavePortoFolio");
    EXPECT_EQ(message(), "Wallet successfully saved...");
    EXPECT_NE(contentOf(damaged), "no portfolio");
    std::vector<std::string> kept;
    for (const auto& entry : std::filesystem::recursive_directory_iterator(folder() + "/Backups")) {
        if (entry.is_regular_file())
            kept.push_back(contentOf(entry.path()));
    }
    EXPECT_THAT(kept, ElementsAre("no portfolio"));
}

TEST_F(FileTest, ReinitForgetsThePathAndAsksForAName)
{
    loadSample();
    follow({{{}, "btnReinitPortoFolio", ""}});
    EXPECT_EQ(wallet().getNbrAccounts(), 0U);
    EXPECT_EQ(text("txtTotalDeposit"), "0.00 EUR");
    click("btnSavePortoFolio");
    EXPECT_EQ(panelFolder("SavePanel"), folder() + "/PortoFolios");
    answerPanel("SavePanel", "New");
    EXPECT_EQ(message(), "Wallet successfully saved...");
    const std::string file = folder() + "/PortoFolios/New";
    EXPECT_TRUE(std::filesystem::remove(file));
    std::filesystem::create_directory(file);
    follow({{{}, "btnSavePortoFolio", "Failed to open the file."}}); // its path is known now
}

} // namespace
