#include "market/Company.h"
#include "market/Market.h"
#include "net/LatestQuote.h"
#include "net/QuoteHistory.h"
#include "net/QuoteServers.h"
#include "net/Socket.h"
#include "tests/support/ServerRun.h"
#include "tests/support/ToolRun.h"
#include "tools/QuoteFolder.h"

#include <gmock/gmock.h>
#include <memory>
#include <sys/stat.h>
#include <thread>

using testing::HasSubstr;
using testing::StartsWith;

namespace {

namespace fs = std::filesystem;

class QuotesTest : public testing::Test {
protected:
    ~QuotesTest() override { quoteServers() = before_; }
    float latest(const ServerRun& server, const char* ticker)
    {
        quoteServers() = {"localhost", "localhost", server.port(), std::chrono::seconds(20)};
        company_->setAbbreviation(ticker);
        float value = -1;
        Date date;
        const int result = company_->getInternetLastQuote("localhost", QuoteServers::kLatestPath, &value, &date);
        return result == 0 ? value : -1;
    }

    const QuoteServers before_ = quoteServers();
    TemporaryFolder folder_{"pelorin-quotes-test"};
    Market market_{"NYSE"};
    Company* company_ = new Company(&market_, "Company", "A"); // owned by the market
};

TEST_F(QuotesTest, APageReadsBackToTheVeryPrice)
{
    std::vector<float> prices = {0.0001F, 1e-7F,    1e-31F,     1e-32F, 1e-45F, 1.0F / 3,
                                 97.765F, 16777218, 123456.78F, 1e10F,  3e38F};
    for (int cents = 1; cents < 30000; ++cents)
        prices.push_back(static_cast<float>(cents / 100.0));
    const Date day(5, 1, 2005);
    for (const float price : prices) {
        float latest = 0;
        EXPECT_EQ(parseLatestQuotePage(latestQuotePage(price), &latest), 0);
        EXPECT_EQ(latest, price) << latestQuotePage(price);
        std::vector<DatedPrice> rows;
        EXPECT_EQ(parseHistoryPage(historyPage({{day, price}}), &rows), 0);
        ASSERT_EQ(rows.size(), 1U) << price;
        EXPECT_EQ(rows[0].price, price) << historyPage({{day, price}});
        EXPECT_EQ(rows[0].date, day);
    }
}

TEST_F(QuotesTest, TheProgramServesWhatTheFetchesRead)
{
    std::string table = "Date;Open;Close\n";
    std::map<Date, float> closes; // of the three months before 31 May
    int cents = 4511;
    for (Date day(1, 12, 2004); day <= Date(31, 5, 2005); day + 1) {
        cents += (cents * 7) % 31 - 15;
        const std::string digits = std::to_string(cents);
        (table += day.toString().bytes()) += ";1;" + digits.substr(0, 2) + "," + digits.substr(2) + "\n";
        if (day >= Date(1, 3, 2005))
            closes[day] = static_cast<float>(cents / 100.0);
    }
    folder_.write("BRK.B.csv", table);
    folder_.write("^X&Y.csv", "2005-01-04,8.25\r\n2005-01-03,7.75\r\n");
    ServerRun server(PELORIN_QUOTES, folder_.path);
    EXPECT_THAT(server.address(), StartsWith("127.0.0.1:"));
    EXPECT_EQ(latest(server, "^X&Y"), 8.25F) << "of the last day, not of the last line";
    EXPECT_EQ(latest(server, "BRK.B"), closes.rbegin()->second);
    EXPECT_EQ(company_->setInternetLastThreeMonthsQuote(), 0);
    ASSERT_EQ(company_->getNbrQuotes(), closes.size());
    for (const auto& [day, close] : closes)
        EXPECT_EQ(company_->getRealQuote(day), close) << day.toString().bytes();
    folder_.write("BRK.B.csv", "2005-06-01,9.5\n");
    EXPECT_EQ(latest(server, "BRK.B"), 9.5F) << "files are read anew";
    EXPECT_EQ(server.stop(SIGTERM), 0);
}

TEST_F(QuotesTest, ClientsThatDoNotAskOrDoNotListenHoldUpNobody)
{
    folder_.write("A.csv", "2005-01-03,97.75\n");
    const ServerRun server(PELORIN_QUOTES, folder_.path);
    const auto connected = [&server] {
        auto client = std::make_unique<Socket>();
        EXPECT_EQ(client->connectTo("127.0.0.1", server.port()), 0);
        return client;
    };
    std::vector<std::unique_ptr<Socket>> idle;
    const auto start = std::chrono::steady_clock::now();
    for (const int clients : {20, 200}) { // more than there is room for
        while (static_cast<int>(idle.size()) < clients)
            idle.push_back(connected());
        EXPECT_EQ(latest(server, "A"), 97.75F);
    }
    EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::seconds(4)) << "the limit of a single client is 5";
    // One that sends a character now and then, and a request without an end.
    for (const auto& [piece, pause] : {std::pair(1, 20), {1000, 0}}) {
        const auto client = connected();
        const std::string text(static_cast<std::size_t>(piece), 'x');
        const auto end = std::chrono::steady_clock::now() + std::chrono::seconds(pause > 0 ? 12 : 4);
        while (client->putCharacterArray(text.data(), piece) == 0 && std::chrono::steady_clock::now() < end)
            std::this_thread::sleep_for(std::chrono::milliseconds(pause));
        EXPECT_LT(std::chrono::steady_clock::now(), end) << piece << ": it is sent away";
    }
    EXPECT_EQ(latest(server, "A"), 97.75F);
}

TEST_F(QuotesTest, OtherRequestsGetAPageWithoutAPrice)
{
    fs::create_directories(folder_ / "in/FOLDER.csv");
    mkfifo((folder_ / "in/PIPE.csv").c_str(), 0600);
    for (const char* name : {"out.csv", "in/A.csv", "in/.hidden.csv", "in/.csv"})
        folder_.write(name, "2005-01-03,97.75\n");
    folder_.write("in/BAD.csv", "Date,Close\n2005-01-03,none\n");
    std::ostringstream log;
    const QuoteFolder folder(folder_ / "in", log);
    EXPECT_EQ(folder.answer("GET /quotes?symbol=A\r\n"), latestQuotePage(97.75F));
    const std::string absolute = folder_ / "out";
    for (const std::string ticker : {"B", "", "a", "../out", "../in/A", "in/../A", "./A", "/A", ".hidden", "FOLDER",
                                     "PIPE", "BAD", "A.csv", "A ", "..", absolute.c_str()})
        for (const std::string& request :
             {"GET /quotes?symbol=" + ticker, "GET /idc/nasdgraph.idc?usymbol=" + ticker + "&umos=03&site=nasdaq"})
            EXPECT_EQ(folder.answer(request + "\r\n"), noQuotesPage()) << request;
    for (const char* request : {"", "GET", "get /quotes?symbol=A", "GET /idc/nasdgraph.idc?usymbol=A"})
        EXPECT_EQ(folder.answer(request), noQuotesPage()) << request;
    EXPECT_THAT(log.str(), HasSubstr("BAD.csv, line 2: "));
    EXPECT_THAT(log.str(), HasSubstr("PIPE.csv: is not an ordinary file\n"));
    float price = 0;
    EXPECT_EQ(parseLatestQuotePage(noQuotesPage(), &price), -1);
    EXPECT_THROW(QuoteFolder(folder_ / "out.csv", log), std::runtime_error);
}

} // namespace
