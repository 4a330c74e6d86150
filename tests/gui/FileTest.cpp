// Loading, saving and starting anew, by buttons and panels.

#include "platform/DialogAnswers.h"
#include "platform/Entry.h"
#include "platform/FilePanel.h"
#include "platform/Message.h"
#include "portfolio/Account.h"
#include "portfolio/Share.h"
#include "portfolio/Wallet.h"
#include "tests/gui/WindowFixture.h"
#include "tests/support/ToolRun.h"

#include <filesystem>
#include <fstream>
#include <functional>
#include <sys/stat.h>

namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::MatchesRegex;
using testing::SizeIs;

class FileTest : public WindowTest {
protected:
    void receive(const BMessage& refs, const std::string& expected)
    {
        clearMessage();
        window().PostMessage(&refs);
        settle();
        EXPECT_EQ(message(), expected);
    }

    /// Presses a button for saving; a panel is answered with `path`, or left when that is empty.
    /// @return the path that the panel came with; empty when there was none.
    std::string savedTo(const char* button, const std::string& path)
    {
        std::string offered;
        DialogAnswers::current().panel = [&](const BFilePanel& panel) {
            offered = panel.PanelDirectory() + '/' + panel.SaveText();
            return path;
        };
        click(button);
        DialogAnswers::current().panel = nullptr;
        return offered;
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

TEST_F(FileTest, AnEmptyWindowOffersTheSampleAndTheFilesThatWereSavedLast)
{
    EXPECT_EQ(notice(), "Nothing is open yet.");
    press("btnNotice1");
    EXPECT_EQ(message(), "Wallet successfully loaded...");
    EXPECT_EQ(text("txtTotalDeposit"), "93,000.00 EUR") << "on the portfolio's page";
    EXPECT_EQ(notice(), "");
    press("btnUndo");
    EXPECT_EQ(window().catalogue().getNbrCurrencies() + wallet().getNbrAccounts(), 0U) << "both were one step";
    EXPECT_EQ(notice(), "Saved last: Sample and Sample");

    // By their times, and not what lies beside them.
    namespace fs = std::filesystem;
    const auto now = fs::file_time_type::clock::now();
    fs::copy_file(walletFile(), folder() + "/PortoFolios/Other");
    fs::last_write_time(folder() + "/PortoFolios/Other", now - std::chrono::hours(1));
    fs::copy_file(walletFile(), folder() + "/PortoFolios/Mine");
    fs::last_write_time(folder() + "/PortoFolios/Mine", now + std::chrono::hours(1));
    write(folder() + "/PortoFolios/.Hidden", "");
    fs::last_write_time(folder() + "/PortoFolios/.Hidden", now + std::chrono::hours(2));
    fs::create_directory(folder() + "/Companies/Folder");
    restart();
    EXPECT_EQ(notice(), "Saved last: Sample and Mine");
    QTest::keyClick(&window().widget(), Qt::Key_O, Qt::ControlModifier | Qt::ShiftModifier);
    settle();
    EXPECT_EQ(text("txtTotalDeposit"), "93,000.00 EUR");
    show(kPortoFolioPage);
    EXPECT_EQ(openFile(), "Mine");
    answerNextAlert("Cancel");
    QTest::keyClick(&window().widget(), Qt::Key_O, Qt::ControlModifier | Qt::ShiftModifier);
    settle();
    EXPECT_THAT(alerts(), SizeIs(1)) << "what is here would go";
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
        page == kCompanyPage ? loadMarkets(pipe) : loadWallet(pipe);
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

    // The remains do not go into the place of the file that was loaded before either, until a name is given.
    loadMarkets(marketFile());
    loadMarkets(damaged);
    click("btnSaveMarket");
    answerPanel("SavePanel", "Rest");
    EXPECT_EQ(message(), "Currencies successfully saved...");
    EXPECT_EQ(contentOf(marketFile()), whole);
    click("btnSaveMarket");
    EXPECT_EQ(panelFolder("SavePanel"), "");
}

TEST_F(FileTest, PortfolioThatCannotBeReadGivesAnEmptyOneAndANoticeOfItsCause)
{
    loadSample();
    const std::string damaged = folder() + "/PortoFolios/Damaged";
    write(damaged, contentOf(walletFile()).substr(0, 100));
    loadWallet(damaged);
    EXPECT_EQ(message(), "Wallet successfully loaded...");
    EXPECT_EQ(wallet().getNbrAccounts(), 0U);
    EXPECT_THAT(notice(), MatchesRegex("Damaged was not loaded: the file ends in the middle of holding [0-9]+"));
    loadWallet(marketFile());
    EXPECT_EQ(notice(), "Sample was not loaded: this is a market file");
    loadWallet(walletFile());
    EXPECT_EQ(notice(), "");

    window().RemoveMarket(window().catalogue().getMarkets()[0], false);
    answerNextAlert("Continue");
    loadWallet(walletFile());
    EXPECT_THAT(notice(), MatchesRegex("Sample needs .* operations?\\).*; the market file Sample has none of them"));
    savedTo("btnSavePortoFolio", "");
    EXPECT_THAT(notice(), MatchesRegex("Save asks for a name: Sample was not loaded: Sample needs .*"));
    loadMarkets(walletFile());
    EXPECT_EQ(message(), "Failed to load the markets");
    EXPECT_EQ(notice(), "Sample was not loaded: this is a portfolio file");
}

TEST_F(FileTest, TransferThatHasLostItsRecipientIsToldOfAndThePortfolioStays)
{
    loadSample();
    std::string bytes = contentOf(walletFile());
    const TransferAccountOperation* sent = nullptr;
    for (const Account* account : wallet().accounts())
        for (const TransferAccountOperation* received : account->transferOperations())
            sent = received;
    ASSERT_NE(sent, nullptr);
    const std::string name(sent->recipient()->getName().bytes());
    std::string other = name;
    other.back() = '?';
    bytes.replace(bytes.rfind(name), name.size(), other);
    const unsigned accounts = wallet().getNbrAccounts();
    write(folder() + "/PortoFolios/Lost", bytes);
    loadWallet(folder() + "/PortoFolios/Lost");
    EXPECT_EQ(wallet().getNbrAccounts(), accounts);
    EXPECT_THAT(notice(), MatchesRegex("Lost: the transfers? of .* lost .*"));
    EXPECT_THAT(notice(), HasSubstr(other));
    EXPECT_EQ(savedTo("btnSavePortoFolio", ""), "") << "it is no failure";
}

TEST_F(FileTest, NextSaveAsksWhereItWouldWriteOverAFileByMistake)
{
    const std::string damaged = folder() + "/PortoFolios/Damaged";
    const std::string changed = "Sample was changed by another program or window since it was loaded or saved here";
    const auto touch = [](const std::string& path) { write(path, contentOf(path)); };
    const struct {
        const char* page;
        std::string path;
        std::function<void()> prepare;
        std::string reason;
    } cases[] = {
        {"portfolio", damaged,
         [&] {
             write(damaged, "no portfolio");
             loadWallet(damaged);
         },
         "Damaged was not loaded: this is no portfolio file"},
        {"portfolio", walletFile(), [&] { loadMarkets(marketFile()); },
         "the portfolio is empty since a market file was loaded, and Sample is not"},
        {"portfolio", walletFile(), [&] { touch(walletFile()); }, changed},
        {"portfolio", walletFile(),
         [&] {
             savedTo("btnSavePortoFolio", "");
             touch(walletFile());
         },
         changed},
        {"market", marketFile(), [&] { touch(marketFile()); }, changed},
        {"market", marketFile(),
         [&] {
             write(marketFile(), contentOf(marketFile()).substr(0, 100));
             loadMarkets(marketFile());
         },
         "Sample was loaded only in part: the file ends in the middle of company 1 of the market Paris"},
    };
    for (const auto& c : cases) {
        restart();
        loadSample();
        c.prepare();
        const bool isMarket = std::string_view(c.page) == "market";
        const char* button = isMarket ? "btnSaveMarket" : "btnSavePortoFolio";
        show(isMarket ? kCompanyPage : kPortoFolioPage);
        const std::string before = contentOf(c.path);
        clearMessage();
        EXPECT_EQ(savedTo(button, ""), c.path) << c.reason;
        EXPECT_EQ(notice(), "Save asks for a name: " + c.reason);
        EXPECT_EQ(contentOf(c.path), before) << "nothing was chosen: " << c.reason;
        EXPECT_EQ(message(), "");
        EXPECT_EQ(savedTo(button, c.path), c.path) << "asked once more: " << c.reason;
        EXPECT_THAT(message(), HasSubstr("successfully saved"));
        EXPECT_EQ(notice(), "");
        EXPECT_EQ(savedTo(button, ""), "") << "settled by the name: " << c.reason;
    }
}

TEST_F(FileTest, OtherSavesAreSilent)
{
    const auto clear = [this] {
        while (wallet().getNbrAccounts() > 0)
            delete wallet().getAccount(0);
        while (wallet().getNbrShares() > 0)
            delete wallet().shares().front();
    };
    loadSample();
    EXPECT_EQ(savedTo("btnSavePortoFolio", ""), "") << "just loaded";
    EXPECT_EQ(savedTo("btnSavePortoFolio", ""), "") << "just saved";
    loadMarkets(marketFile());
    (new Account("New"))->setWallet(&wallet());
    wallet().getAccount(0)->setCurrency(window().getReferenceCurrency());
    show(kPortoFolioPage);
    EXPECT_EQ(savedTo("btnSavePortoFolio", ""), "") << "not empty, though a market file was loaded";
    clear();
    window().UpdateState();
    EXPECT_EQ(savedTo("btnSavePortoFolio", ""), "") << "emptied by hand";
    loadMarkets(marketFile());
    show(kPortoFolioPage);
    EXPECT_EQ(savedTo("btnSavePortoFolio", ""), "") << "both are empty";
    std::filesystem::remove(walletFile());
    EXPECT_EQ(savedTo("btnSavePortoFolio", ""), "") << "deleted meanwhile";
    EXPECT_TRUE(std::filesystem::exists(walletFile()));
    EXPECT_EQ(notice(), "");
}

TEST_F(FileTest, ANewPortfolioComesToThePanelWithoutAName)
{
    loadSample();
    follow({{{}, "btnReinitPortoFolio", ""}});
    EXPECT_EQ(text("txtTotalDeposit"), "0.00 EUR");
    EXPECT_EQ(savedTo("btnSavePortoFolio", ""), folder() + "/PortoFolios/");
    click("btnSavePortoFolio");
    answerPanel("SavePanel", "New.2026");
    EXPECT_EQ(message(), "Wallet successfully saved...");
    const std::string file = folder() + "/PortoFolios/New.2026";
    EXPECT_TRUE(std::filesystem::remove(file)) << "no ending is added";
    std::filesystem::create_directory(file);
    follow({{{}, "btnSavePortoFolio", "Failed to open the file."}}); // its path is known now
}

} // namespace
