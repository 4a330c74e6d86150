#include "sample/SampleMarket.h"
#include "sample/SamplePortfolio.h"
#include "tests/support/SmallPortfolio.h"
#include "tests/support/ToolRun.h"
#include "tools/Valuation.h"
#include "valuation/AccountState.h"
#include "valuation/ShareState.h"
#include "valuation/State.h"

#include <gmock/gmock.h>

using testing::HasSubstr;

namespace {

namespace fs = std::filesystem;

const Date kLast(20, 7, 2025); // a Sunday
const Date kFriday(18, 7, 2025);

class SampleTest : public testing::Test {
protected:
    ToolRun make(const std::string& arguments) const { return ToolRun(PELORIN_SAMPLE, arguments, folder_); }

    TemporaryFolder folder_{"pelorin-sample-test"};
};

} // namespace

TEST_F(SampleTest, SameDateGivesTheSameFilesOnEveryRun)
{
    EXPECT_EQ(make("a/b --date 20/07/2025").out, "a/b/Companies/Sample: written\na/b/PortoFolios/Sample: written\n");
    EXPECT_EQ(make("c --date 20/07/2025 --quiet").out, "");
    make("d --date 21/07/2025");
    for (const char* name : {"Companies/Sample", "PortoFolios/Sample"}) {
        EXPECT_EQ(folder_.content(std::string("a/b/") + name), folder_.content(std::string("c/") + name)) << name;
        EXPECT_NE(folder_.content(std::string("a/b/") + name), folder_.content(std::string("d/") + name)) << name;
    }
    Valuation valuation(folder_ / "c/Companies/Sample", folder_ / "c/PortoFolios/Sample");
    valuation.compute(kLast, false, false);
    // A machine that rounds otherwise would show in the end of a walk.
    EXPECT_EQ(valuation.catalogue().getCurrencyByRepresentation("GBP")->getRealQuote(kFriday), 1.1691F);
    EXPECT_EQ(valuation.totals().totalDeposit, 93000);
}

TEST_F(SampleTest, WithoutAFolderItIsTheUsersAndTellsOnlyNewsWhenAsked)
{
    folder_.write("config/user-dirs.dirs", "XDG_DOCUMENTS_DIR=\"$HOME/Texte\"\n");
    const auto told = [this](const std::string& options) {
        return ToolRun("env", "HOME=\"$PWD\" XDG_CONFIG_HOME=\"$PWD/config\" '" PELORIN_SAMPLE "' " + options, folder_)
            .out;
    };
    const std::string market = folder_ / "Texte/Pelorin/Companies/Sample";
    const std::string portfolio = folder_ / "Texte/Pelorin/PortoFolios/Sample";
    EXPECT_EQ(told("--only-news"), market + ": written\n" + portfolio + ": written\n");
    EXPECT_EQ(told("--only-news"), "");
    EXPECT_EQ(told("--quiet --quotes tables"), "");
    EXPECT_FALSE(fs::is_empty(folder_ / "tables"));
    fs::remove(portfolio);
    folder_.write("Texte/Pelorin/Companies/Sample", "mine");
    EXPECT_EQ(told("--only-news"), market + ": is there and left as it is\n" + portfolio + ": written\n");
    EXPECT_THAT(told(""), HasSubstr(market + ": is there and left as it is\n"));
    EXPECT_EQ(contentOf(market), "mine");
    EXPECT_GT(fs::file_size(portfolio), 1000U);
}

TEST(SampleDataTest, NothingIsEverOverdrawnOrSoldShort)
{
    const std::vector<Date> days = sampleDays(kLast);
    EXPECT_EQ(days.size(), 1305U) << "the weekdays of five years";
    Catalogue catalogue;
    Wallet wallet;
    fillSampleMarket(catalogue, days);
    fillSamplePortfolio(wallet, catalogue, days);
    EvolutionOutcome outcome;
    const State* last = refreshStates(wallet, kLast, false, &outcome);
    EXPECT_EQ(wallet.getNbrStates(), 1827U);
    int losers = 0;
    const std::vector<State*> states = all(wallet, &Wallet::getAllStates);
    for (const State* state : states) {
        const std::string day = testing::PrintToString(state->getDate());
        for (const AccountState* account : all(*state, &State::getAllAccountStates))
            EXPECT_GE(account->getCash(), 0) << account->getAccountName().bytes() << ' ' << day;
        for (const ShareState* share : all(*state, &State::getAllShareStates)) {
            EXPECT_GE(share->getQuantity(), 0) << share->getCompanyName().bytes() << ' ' << day;
            losers += state == last && share->getQuantity() > 0 && share->getQuote() < share->getBuyQuote();
        }
    }
    EXPECT_GE(losers, 2);
    EXPECT_GT(Totals(*last, catalogue).profit, 10000);
}
