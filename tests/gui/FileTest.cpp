// Loading, saving and starting anew, by buttons and panels.

#include "foundation/Today.h"
#include "market/Currency.h"
#include "platform/Entry.h"
#include "platform/Message.h"
#include "portfolio/Account.h"
#include "portfolio/Wallet.h"
#include "tests/gui/WindowFixture.h"
#include "tests/support/ToolRun.h"

#include <filesystem>
#include <fstream>
#include <gmock/gmock.h>

namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

constexpr const char* kMarketsQuestion = "This will delete all unsaved changes to the wallet and the markets...";
constexpr const char* kWalletQuestion = "This will delete all unsaved changes to the wallet...";

class FileTest : public WindowTest {
protected:
    void loadMarkets(const std::string& path)
    {
        show(kCompanyPage);
        if (window().catalogue().getNbrCurrencies() > 0)
            answerNextAlert("Continue");
        click("btnLoadMarket");
        answerPanel("OpenPanel", path);
    }

    void loadWallet(const std::string& path)
    {
        show(kPortoFolioPage);
        answerNextAlert("Continue");
        click("btnLoadPortoFolio");
        answerPanel("OpenPanel", path);
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
    const std::string shown = text("txtTotalValue");
    EXPECT_THAT(valued.out, testing::HasSubstr(shown.substr(0, shown.find(' '))));
    const std::string market = contentOf(marketFile());
    const std::string portfolio = contentOf(walletFile());

    click("btnSavePortoFolio");
    EXPECT_EQ(message(), "Wallet successfully saved...");
    show(kCurrencyPage);
    click("btnSaveMarket");
    EXPECT_EQ(message(), "Currencies successfully saved...");
    // The stamps of the day are all that differs: the records are as long as before, and load to the same again.
    EXPECT_EQ(contentOf(marketFile()).size(), market.size());
    EXPECT_EQ(contentOf(walletFile()).size(), portfolio.size());
    show(kPortoFolioPage);
    const std::string total = text("txtTotalValue");
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

    loadMarkets(marketFile());
    show(kCurrencyPage);
    answerNextAlert("Cancel");
    click("btnLoadMarket");
    EXPECT_THAT(alerts(), ElementsAre(kMarketsQuestion));
    EXPECT_FALSE(isPanelOpen("OpenPanel"));

    show(kPortoFolioPage);
    answerNextAlert("Cancel");
    click("btnLoadPortoFolio");
    EXPECT_THAT(alerts(), ElementsAre(kWalletQuestion)) << "also of an empty portfolio";
    EXPECT_FALSE(isPanelOpen("OpenPanel"));
    answerNextAlert("Continue");
    click("btnLoadPortoFolio");
    EXPECT_EQ(panelFolder("OpenPanel"), folder() + "/PortoFolios");
    answerPanel("OpenPanel", "");
}

TEST_F(FileTest, MarketsLoadedTwiceHaveEveryCurrencyTwiceAndEveryMarketOnce)
{
    makeSample();
    loadMarkets(marketFile());
    const unsigned currencies = window().catalogue().getNbrCurrencies();
    const auto markets = window().catalogue().getMarkets().size();
    ASSERT_GT(currencies, 1U);
    loadMarkets(marketFile());
    EXPECT_THAT(alerts(), ElementsAre(kMarketsQuestion));
    EXPECT_EQ(window().catalogue().getNbrCurrencies(), 2 * currencies);
    EXPECT_EQ(window().catalogue().getMarkets().size(), markets);
    EXPECT_EQ(message(), "Markets successfully loaded...");
}

TEST_F(FileTest, MarketLoadThrowsThePortfolioAwayAndPutsItsParametersBack)
{
    loadSample();
    show(kParameterPage);
    enter("txtBuyCost", "12.5");
    show(kCompanyPage);
    loadMarkets(marketFile());
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
    window().PostMessage(&refs);
    settle();
    EXPECT_EQ(message(), "ERROR GETTING REF");

    const entry_ref missing{folder(), "missing"};
    refs.AddRef("refs", &missing);
    for (const Page page : {kCompanyPage, kPortoFolioPage}) {
        show(page);
        clearMessage();
        window().PostMessage(&refs);
        settle();
        EXPECT_EQ(message(), "OPEN FAILED: " + folder() + "/missing");
    }
    show(kParameterPage);
    clearMessage();
    window().PostMessage(&refs);
    settle();
    EXPECT_EQ(message(), "") << "this page has no files";
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
    EXPECT_TRUE(isPanelOpen("SavePanel")) << "no path is known to save to";
    EXPECT_EQ(panelFolder("SavePanel"), folder() + "/Companies");
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
    EXPECT_FALSE(isPanelOpen("SavePanel"));
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
    clearMessage();
    click("btnReinitPortoFolio");
    EXPECT_EQ(message(), "");
    EXPECT_THAT(alerts(), IsEmpty());
    EXPECT_EQ(wallet().getNbrAccounts(), 0U);
    EXPECT_EQ(text("txtTotalDeposit"), "0.00 EUR");
    click("btnSavePortoFolio");
    EXPECT_EQ(panelFolder("SavePanel"), folder() + "/PortoFolios");
    answerPanel("SavePanel", "New");
    EXPECT_EQ(message(), "Wallet successfully saved...");
    EXPECT_TRUE(std::filesystem::exists(folder() + "/PortoFolios/New"));
    click("btnSavePortoFolio"); // its path is known now
    EXPECT_FALSE(isPanelOpen("SavePanel"));
}

TEST_F(FileTest, SaveThatCannotOpenItsFileSaysSo)
{
    loadSample();
    std::filesystem::remove(walletFile());
    std::filesystem::create_directory(walletFile());
    click("btnSavePortoFolio");
    EXPECT_EQ(message(), "Failed to open the file.");
}

TEST_F(FileTest, PagesWithoutFilesDoNothing)
{
    loadSample();
    for (const Page page : {kOperationPage, kParameterPage}) {
        show(page);
        clearMessage();
        for (const uint32 code : {'CBLd', 'WBLd', 'CBSv', 'WBSv'})
            post(code);
        EXPECT_FALSE(isPanelOpen("OpenPanel"));
        EXPECT_FALSE(isPanelOpen("SavePanel"));
        EXPECT_EQ(message(), "");
    }
}

} // namespace
