#include "net/QuoteHistory.h"
#include "tests/support/SmallPortfolio.h"
#include "tests/support/ToolRun.h"
#include "tools/QuoteFolder.h"
#include "tools/SampleMarket.h"
#include "tools/SamplePortfolio.h"
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

TEST_F(SampleTest, FilesThatAreThereAreLeftAlone)
{
    folder_.write("a/Companies/Sample", "mine");
    EXPECT_THAT(make("a").out, HasSubstr("a/Companies/Sample: is there and left as it is\n"));
    EXPECT_EQ(folder_.content("a/Companies/Sample"), "mine");
    EXPECT_GT(fs::file_size(folder_ / "a/PortoFolios/Sample"), 1000U);
}

TEST_F(SampleTest, TablesOfQuotesGoOnWhereTheMarketFileEnds)
{
    make("a --date 16/07/2025 --quotes q");
    EXPECT_THAT(make("a --date 20/07/2025 --quotes q").out, HasSubstr("q: quotes up to 20/07/2025 written\n"));
    std::ostringstream log;
    const QuoteFolder served(folder_ / "q", log);
    const Valuation valuation(folder_ / "a/Companies/Sample", folder_ / "a/PortoFolios/Sample");
    for (const Market* market : valuation.catalogue().getMarkets())
        for (const Company* company : all(*market, &Market::getAllCompanies)) {
            const std::string ticker(company->getAbbreviation().bytes());
            const std::string page = served.answer("GET /idc/nasdgraph.idc?usymbol=" + ticker + "&umos=03&site=nasdaq");
            std::vector<DatedPrice> rows;
            ASSERT_EQ(parseHistoryPage(page, &rows), 0) << ticker << log.str();
            for (const auto& [day, price] : rows)
                EXPECT_TRUE(day > Date(16, 7, 2025) || price == company->getRealQuote(day)) << ticker;
            // Thursday and Friday, and the Sunday itself.
            ASSERT_GT(rows.size(), 60U);
            EXPECT_EQ(rows.end()[-4].date, Date(16, 7, 2025));
            EXPECT_EQ(rows.end()[-2].date, kFriday);
            EXPECT_EQ(rows.end()[-1].date, kLast);
            EXPECT_NEAR(rows.end()[-1].price / rows.end()[-4].price, 1, 0.25) << ticker;
        }
    folder_.write("a/Companies/Sample", "mine");
    EXPECT_EQ(make("a --quotes q").err, "pelorin-sample: a/Companies/Sample: cannot be read as a market file\n");
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
    for (const State* state : all(wallet, &Wallet::getAllStates)) {
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
