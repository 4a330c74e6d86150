// Copies of what is not saved: when they are made, what a later start offers, and what restoring gives.

#include "app/Rescue.h"
#include "market/Company.h"
#include "platform/DialogAnswers.h"
#include "portfolio/Account.h"
#include "portfolio/Wallet.h"
#include "tests/gui/WindowFixture.h"
#include "tests/support/ToolRun.h"

#include <filesystem>

namespace {

namespace fs = std::filesystem;
using testing::EndsWith;
using testing::HasSubstr;
using testing::MatchesRegex;

/// Before the first window comes.
struct ShortInterval {
    ShortInterval() { Rescue::pace() = {std::chrono::milliseconds(kMilliseconds), 1}; }
    ~ShortInterval() { Rescue::pace() = {}; }
    static constexpr int kMilliseconds = 30;
};

class RescueTest : protected ShortInterval, public WindowTest {
protected:
    /// The kinds that have copies, with their generations.
    std::string copies() const
    {
        std::string all;
        for (const char* kind : {"Companies", "PortoFolios"}) {
            std::error_code none;
            for (const auto& entry : fs::directory_iterator(folder() + "/Backups/Unsaved/" + kind, none)) {
                const std::string name = entry.path().filename();
                all += std::string(all.empty() ? "" : " ") + kind + ' ' + name.substr(name.find('('));
            }
        }
        return all;
    }
    bool awaitCopies(const std::string& expected)
    {
        constexpr int kPatience = 20000;
        return QTest::qWaitFor([&] { return copies() == expected; }, kPatience);
    }
    std::string notice()
    {
        dismissOffer();
        return WindowTest::notice();
    }
    void restoreUnsaved() { press("btnNotice1"); }
    void throwAway() { press("btnNotice2"); }

    void addQuote()
    {
        show(kCompanyPage);
        select("lstMarkets", 0);
        select("lstCompanies", 0);
        fill({{"txtQuoteDate", "20/11/2024"}, {"txtQuoteValue", std::to_string(++price_).c_str()}});
        click("btnAddQuote");
    }
    void addAccount()
    {
        show(kPortoFolioPage);
        const std::string symbol(window().catalogue().getCurrencies().front()->getRepresentation().bytes());
        fill({{"txtAccountName", "Unsaved"}, {"txtAccountCurrency", symbol.c_str()}});
        click("btnAddAccount");
    }
    void undo() { press("btnUndo"); }

private:
    int price_ = 40;
};

TEST_F(RescueTest, WhatAClosedWindowHadNotSavedIsOfferedAndComesBackToItsFiles)
{
    loadSample();
    const std::string files = contentOf(marketFile()) + contentOf(walletFile());
    addQuote();
    addAccount();
    const std::string before = bytes();
    restart();
    EXPECT_EQ(contentOf(marketFile()) + contentOf(walletFile()), files) << "the user's files are left alone";
    EXPECT_EQ(window().catalogue().getNbrCurrencies(), 0U) << "nothing is loaded by itself";
    EXPECT_THAT(notice(), MatchesRegex("Not saved on ../../...., ..:..: market data Sample, portfolio Sample"));

    // Something else is here by then: it goes, and does not stay beside what is restored.
    show(kCurrencyPage);
    fill({{"txtCurrencyName", "Other"}, {"txtCurrencyRepresentation", "O"}});
    click("btnAddCurrency");
    EXPECT_EQ(notice(), "Added currency Other");
    press("txtNotice"); // what was done goes by itself later
    restoreUnsaved();
    EXPECT_EQ(message(), "Unsaved changes successfully restored...");
    EXPECT_EQ(bytes() == before, true);
    EXPECT_EQ(notice(), "");
    EXPECT_GT(window().unsavedChanges(FileKind::kMarkets), 0U);
    EXPECT_GT(window().unsavedChanges(FileKind::kWallet), 0U);

    show(kCompanyPage);
    follow({{{}, "btnSaveMarket", "Currencies successfully saved..."}});
    EXPECT_THAT(copies(), MatchesRegex("Companies \\(1\\) PortoFolios \\(.\\)"))
        << "of the other currency, which was left in turn, and of the portfolio";
    show(kPortoFolioPage);
    follow({{{}, "btnSavePortoFolio", "Wallet successfully saved..."}});
    EXPECT_EQ(contentOf(marketFile()) + "\n--\n" + contentOf(walletFile()) == before, true);
    restart();
    EXPECT_THAT(notice(), MatchesRegex("Not saved on .*: a new market data")) << "that of the other currency";
    throwAway();
    EXPECT_EQ(copies(), "");
    restart();
    EXPECT_EQ(notice(), "");
}

TEST_F(RescueTest, OnlyWhatChangedIsCopiedAndTheRestComesFromItsFile)
{
    loadSample();
    addAccount();
    const std::string before = bytes();
    restart();
    EXPECT_THAT(copies(), MatchesRegex("PortoFolios \\(.\\)"));
    EXPECT_THAT(notice(), MatchesRegex(".*: portfolio Sample"));
    restoreUnsaved();
    EXPECT_EQ(bytes() == before, true);
    EXPECT_EQ(window().unsavedChanges(FileKind::kMarkets), 0U);
    EXPECT_GT(window().unsavedChanges(FileKind::kWallet), 0U);
    undo(); // to what it was before: the offer, too
    EXPECT_EQ(window().catalogue().getNbrCurrencies(), 0U);
    EXPECT_TRUE(QTest::qWaitFor([this] { return notice() != ""; }, 5000));

    fs::rename(marketFile(), folder() + "/Companies/Moved");
    restoreUnsaved();
    EXPECT_THAT(notice(), HasSubstr("portfolio Sample. " + marketFile() + ": cannot be opened"));
    EXPECT_EQ(window().catalogue().getNbrCurrencies(), 0U) << "nothing has changed";
    fs::rename(folder() + "/Companies/Moved", marketFile());
    restart(); // nobody has said anything: it is offered again
    restoreUnsaved();
    EXPECT_EQ(bytes() == before, true);

    // A name that the portfolio's file has changes, and the portfolio does not.
    show(kPortoFolioPage);
    follow({{{}, "btnSavePortoFolio", "Wallet successfully saved..."}});
    show(kCompanyPage);
    select("lstMarkets", 0);
    type("txtMarketName", "Renamed");
    click("btnUpdateMarket");
    const std::string renamed = bytes();
    ASSERT_GT(window().unsavedChanges(FileKind::kMarkets), 0U);
    ASSERT_GT(window().unsavedChanges(FileKind::kWallet), 0U);
    restart();
    EXPECT_THAT(notice(), HasSubstr("market data Sample, portfolio Sample")) << "else it would not fit any more";
    restoreUnsaved();
    EXPECT_EQ(bytes() == renamed, true);
    // Saved market data leave the portfolio's file behind, with the old name.
    show(kCompanyPage);
    click("btnSaveMarket");
    restart();
    EXPECT_THAT(notice(), HasSubstr(": portfolio Sample"));
    restoreUnsaved();
    EXPECT_EQ(bytes() == renamed, true);
}

TEST_F(RescueTest, ARestoredPortfolioIsNotSavedOverANewerFileUnasked)
{
    loadSample();
    addAccount();
    restart();
    fs::last_write_time(walletFile(), fs::file_time_type::clock::now() + std::chrono::hours(1));
    const std::string newer = contentOf(walletFile());
    restoreUnsaved();
    show(kPortoFolioPage);
    click("btnSavePortoFolio");
    EXPECT_EQ(panelFolder("SavePanel"), folder() + "/PortoFolios");
    answerPanel("SavePanel", "");
    EXPECT_EQ(contentOf(walletFile()) == newer, true);
}

TEST_F(RescueTest, AnAccountWithoutCurrencyCostsOnlyThePortfolioItsCopy)
{
    loadSample();
    show(kCurrencyPage);
    select("lstCurrencies", 1);
    answerNextAlert("Continue");
    click("btnRemoveCurrency");
    restart();
    EXPECT_THAT(notice(), EndsWith(": market data Sample"));
}

TEST_F(RescueTest, CopiesComeAtIntervalsAndOnlyOfChanges)
{
    loadSample();
    QTest::qWait(4 * kMilliseconds);
    EXPECT_EQ(copies(), "") << "all is as the files have it";
    addQuote();
    ASSERT_TRUE(awaitCopies("Companies (1)")) << copies();
    QTest::qWait(20 * kMilliseconds);
    EXPECT_EQ(copies(), "Companies (1)") << "an idle window writes nothing";
    addAccount();
    ASSERT_TRUE(awaitCopies("Companies (1) PortoFolios (2)")) << copies() << ": the market data is as it was";

    bool isCopied = false;
    DialogAnswers::current().alert = [&](const char*, const char*) {
        isCopied = awaitCopies("Companies (3) PortoFolios (3)");
        return 0;
    };
    addQuote();
    show(kPortoFolioPage);
    click("btnLoadPortoFolio");
    DialogAnswers::current().alert = nullptr;
    EXPECT_TRUE(isCopied) << "also while an alert waits: " << copies();

    undo();
    undo();
    EXPECT_TRUE(awaitCopies("Companies (4)")) << copies();
    undo();
    EXPECT_TRUE(awaitCopies("")) << copies() << ": all is as the files have it again";
}

TEST_F(RescueTest, WhatHasNoNameYetIsAskedForOneByTheNextSave)
{
    show(kCurrencyPage);
    fill({{"txtCurrencyName", "Euro"}, {"txtCurrencyRepresentation", "EUR"}});
    click("btnAddCurrency");
    addAccount();
    const std::string before = bytes();
    restart();
    EXPECT_THAT(notice(), HasSubstr("a new market data, a new portfolio"));
    press("txtNotice"); // dismissed is not refused
    EXPECT_EQ(notice(), "");
    restart();
    restoreUnsaved();
    EXPECT_EQ(bytes() == before, true);
    click("btnSaveMarket");
    EXPECT_EQ(panelFolder("SavePanel"), folder() + "/Companies");
    answerPanel("SavePanel", folder() + "/Companies/Mine");
    EXPECT_EQ(message(), "Currencies successfully saved...");
    EXPECT_THAT(copies(), MatchesRegex("PortoFolios \\(.\\)"));
    restart(); // the portfolio goes with the file that the market data has by now
    restoreUnsaved();
    EXPECT_EQ(bytes() == before, true);
}

} // namespace
