#include "foundation/Today.h"
#include "net/LatestQuote.h"
#include "net/QuoteServers.h"
#include "net/StoreQuote.h"
#include "tests/support/Peer.h"
#include "tests/support/SmallPortfolio.h"

#include <gtest/gtest.h>

using namespace std::chrono_literals;

namespace {

const Date kToday(20, 11, 2026);

class FetchTest : public testing::Test {
protected:
    FetchTest() { setToday(kToday); }
    ~FetchTest() override
    {
        quoteServers() = before_;
        setToday(Date());
    }

    /// Fetches from a peer with this talk. @return the result.
    int latest(const Peer::Talk& talk)
    {
        const Peer peer(talk);
        quoteServers() = {"localhost", "127.0.0.1", peer.port(), limit_};
        return company_->getInternetLastQuote(quoteServers().latestHost, QuoteServers::kLatestPath, &value_, &date_);
    }
    int history(const Peer::Talk& talk)
    {
        const Peer peer(talk);
        quoteServers() = {"localhost", "127.0.0.1", peer.port(), limit_};
        return company_->setInternetLastThreeMonthsQuote();
    }
    FetchEnd end(const Peer::Talk& talk, const StopCheck& stop = {}, const char* host = "localhost")
    {
        const Peer peer(talk);
        quoteServers() = {host, host, peer.port(), limit_};
        return fetchLatestQuote(*company_, host, QuoteServers::kLatestPath, stop, &value_, &date_);
    }
    /// A talk that takes the request and sends `page` in pieces, every other one of them shorter.
    Peer::Talk sending(const std::string& page, std::size_t piece = 99999, std::chrono::milliseconds pause = 0ms)
    {
        return [=, this](int client) {
            request_ = Peer::receiveLine(client);
            std::size_t size = piece;
            for (std::size_t i = 0; i < page.size() && Peer::send(client, page.substr(i, size));) {
                i += size;
                size = size == piece ? piece / 3 + 1 : piece;
                std::this_thread::sleep_for(pause);
            }
        };
    }
    /// One that sends `page` and keeps the connection open.
    Peer::Talk silentAfter(const std::string& page)
    {
        return [=, this](int client) { sending(page)(client), Peer::waitForEnd(client); };
    }
    std::string quotes() const
    {
        std::string text;
        for (const CompanyQuote* quote : all(*company_, &Company::getAllQuotes))
            text += std::to_string(quote->getDate().getDay()) + '=' +
                    std::to_string(static_cast<int>(quote->getValue())) + ' ';
        return text;
    }

    const QuoteServers before_ = quoteServers();
    std::chrono::milliseconds limit_ = 20s;
    Market market_{"AMEX"};
    Company* company_ = new Company(&market_, "International", "IBM"); // owned by the market
    float value_ = -7;
    Date date_;
    std::string request_;
};

const std::string kLatestPage = "<html><tr><td nowrap><b>112 <sup>3</sup>/<sub>8</sub></b></td></tr></html>\n";
const std::string kHistoryPage = "<pre><b>Date Close Volume (00s)</b>\n5/3/1999 45 46 100\n5/4/1999 47 48 9\n</pre>\n";

TEST_F(FetchTest, ThePageIsTheSameHoweverItArrives)
{
    const std::string longer = std::string(700, '-') + kLatestPage;
    const std::string table = std::string(300, '-') + kHistoryPage;
    for (const std::size_t piece : {1, 7, 40, 256, 257}) {
        value_ = 0;
        EXPECT_EQ(latest(sending(longer, piece, piece == 1 ? 0ms : 2ms)), 0) << piece;
        EXPECT_EQ(value_, 112.375F) << piece;
        EXPECT_EQ(request_, "GET /quotes?symbol=IBM\r\n");
        delete company_->getQuote(0U);
        EXPECT_EQ(history(sending(table, piece, piece == 1 ? 0ms : 2ms)), 0) << piece;
        EXPECT_EQ(quotes(), "3=45 4=47 ") << piece;
        EXPECT_EQ(request_, "GET /idc/nasdgraph.idc?usymbol=IBM&umos=03&site=nasdaq\r\n");
    }
}

TEST_F(FetchTest, APageCutAnywhereGivesTheTruePriceOrNone)
{
    const std::string before(256, '7'); // what the next chunk does not cover of this one would go on with a number
    const std::string table = "(00s)</b>\n5/3/1999 12.50 1 2 3\n5/4/1999 13.25 1 2 3\n</pre>";
    const std::pair<std::string, float> pages[] = {
        {kLatestPage, 112.375F}, {"<td nowrap><b>12.50</b></td>\n", 12.5F}, {table, 0}};
    const struct {
        std::chrono::milliseconds limit, pause; // behind the cut, and behind the next character
        bool goesOn;
        std::size_t step;
    } cases[] = {{10ms, 0ms, false, 1}, {100ms, 60ms, true, 9}, {20s, 0ms, false, 1}};
    for (const auto& [limit, pause, goesOn, step] : cases)
        for (const auto& [page, price] : pages)
            for (std::size_t size = page.size() % step; size <= page.size(); size += step) {
                SCOPED_TRACE(page.substr(0, size) + " with pauses of " + std::to_string(pause.count()));
                const auto talk = [&, limited = limit < 1s](int client) {
                    Peer::receiveLine(client);
                    for (const std::string& part : {before + page.substr(0, size), page.substr(size, 1),
                                                    page.substr(std::min(size + 1, page.size()))}) {
                        Peer::send(client, part);
                        if (!goesOn)
                            break;
                        std::this_thread::sleep_for(pause);
                    }
                    if (limited)
                        Peer::waitForEnd(client);
                };
                limit_ = limit;
                value_ = 0;
                const int result = price == 0 ? history(talk) : latest(talk);
                EXPECT_TRUE(result == 0 || size < page.size() || limit < 1s);
                EXPECT_EQ(value_, result == 0 ? price : 0);
                for (const CompanyQuote* quote : all(*company_, &Company::getAllQuotes))
                    EXPECT_EQ(quote->getValue(), quote->getDate() == Date(3, 5, 1999) ? 12.5F : 13.25F);
            }
    EXPECT_EQ(quotes(), "3=12 4=13 ");
}

TEST_F(FetchTest, PeersThatGiveNoPageFailInTime)
{
    limit_ = 100ms;
    const auto endless = [](const std::string& piece, std::chrono::milliseconds pause) {
        return [=](int client) {
            while (Peer::send(client, piece))
                std::this_thread::sleep_for(pause);
        };
    };
    const struct {
        Peer::Talk talk;
        const char* why;
        FetchEnd end;
    } cases[] = {
        {[](int) {}, "closes at once", FetchEnd::kClosed},
        {[](int client) { Peer::receiveLine(client); }, "closes after the request", FetchEnd::kClosed},
        {[](int client) { Peer::waitForEnd(client); }, "is silent", FetchEnd::kSilent},
        {silentAfter("<html>"), "goes silent after some text", FetchEnd::kSilent},
        {silentAfter("<td nowrap><b>45</b>\n"), "goes silent where a fraction may follow", FetchEnd::kSilent},
        {silentAfter("(00s)</b>\n5/3/1999 45 46 100\n"), "goes silent in a table, of which nothing is stored",
         FetchEnd::kSilent},
        {sending("<html>no marker</html>"), "has no marker", FetchEnd::kNoPrice},
        {endless("<td nowrap>", 0ms), "never ends", FetchEnd::kNoPrice},
        {endless("x", 20ms), "never ends, but trickles", FetchEnd::kSilent},
    };
    for (const auto& c : cases) {
        const auto start = std::chrono::steady_clock::now();
        EXPECT_EQ(latest(c.talk), -1) << c.why;
        EXPECT_EQ(date_, kToday) << c.why;
        EXPECT_EQ(value_, 0) << c.why << ": set once the connection is there";
        EXPECT_EQ(history(c.talk), -1) << c.why;
        EXPECT_EQ(end(c.talk), c.end) << c.why;
        EXPECT_LT(std::chrono::steady_clock::now() - start, 10s) << c.why;
    }
    value_ = -7; // the port is closed by now
    EXPECT_EQ(company_->getInternetLastQuote("127.0.0.1", "/", &value_, &date_), -1) << "nobody listens";
    EXPECT_EQ(value_, -7);
    EXPECT_EQ(date_, kToday);
    EXPECT_EQ(company_->getNbrQuotes(), 0U);
}

TEST_F(FetchTest, AWaitCanBeStoppedAndNoHostToldFromNoServer)
{
    const auto start = std::chrono::steady_clock::now();
    int asked = 0;
    const StopCheck third = [&asked] { return ++asked == 3; };
    EXPECT_EQ(end(silentAfter("<html>"), third), FetchEnd::kStopped);
    EXPECT_EQ(end(silentAfter(kLatestPage), [] { return true; }), FetchEnd::kFetched) << "there is no wait to stop";
    EXPECT_EQ(end([](int) {}, {}, "256.0.0.1"), FetchEnd::kNoHost);
    quoteServers().port = 1;
    EXPECT_EQ(fetchLatestQuote(*company_, "127.0.0.1", "/", {}, &value_, &date_), FetchEnd::kRefused);

    const int full = socket(AF_INET, SOCK_STREAM, 0); // that takes no more connections
    sockaddr_in address{};
    address.sin_family = AF_INET;
    address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    socklen_t size = sizeof address;
    ASSERT_EQ(bind(full, reinterpret_cast<sockaddr*>(&address), size) + listen(full, 0), 0);
    getsockname(full, reinterpret_cast<sockaddr*>(&address), &size);
    std::vector<int> clients;
    for (int i = 0; i < 4; ++i) {
        clients.push_back(socket(AF_INET, SOCK_STREAM | SOCK_NONBLOCK, 0));
        connect(clients.back(), reinterpret_cast<sockaddr*>(&address), size);
    }
    quoteServers().port = ntohs(address.sin_port);
    asked = 0;
    EXPECT_EQ(fetchLatestQuote(*company_, "127.0.0.1", "/", third, &value_, &date_), FetchEnd::kStopped);
    EXPECT_LT(std::chrono::steady_clock::now() - start, limit_ / 2);
    quoteServers().limit = 100ms;
    EXPECT_EQ(fetchLatestQuote(*company_, "127.0.0.1", "/", {}, &value_, &date_), FetchEnd::kSilent);
    clients.push_back(full);
    for (const int client : clients)
        close(client);
}

TEST_F(FetchTest, APageEndsAtItsLimit)
{
    // The first multiple of 256 beyond 5000 is 5120.
    const std::pair<int, float> cases[] = {{57, 112.375F}, {29, -1}, {19, -1}}; // the fraction, the price, the marker
    for (const auto& [left, price] : cases) {
        value_ = -1;
        const std::string page = std::string(static_cast<std::size_t>(5120 - left), '-') + kLatestPage;
        const auto stayOpen = [&](int client) {
            sending(page + std::string(999, '-'))(client);
            Peer::waitForEnd(client);
        };
        EXPECT_EQ(latest(stayOpen), price < 0 ? -1 : 0) << "cut " << left << " characters behind the start";
        EXPECT_EQ(value_, std::max(price, 0.0F)) << left;
    }
}

TEST_F(FetchTest, ADayHasOneQuoteHoweverOftenItIsFetched)
{
    const std::pair<float, StoreOutcome> cases[] = {{45, StoreOutcome::kAdded},
                                                    {45, StoreOutcome::kSame},
                                                    {46, StoreOutcome::kChanged},
                                                    {0, StoreOutcome::kChanged}};
    CompanyQuote* quote = nullptr;
    for (const auto& [price, outcome] : cases) {
        EXPECT_EQ(storeQuote(company_, Date(4, 5, 1999), price, &quote), outcome) << price;
        EXPECT_EQ(quote->getValue(), price);
    }
    const auto start = std::chrono::steady_clock::now();
    EXPECT_EQ(history(silentAfter(kHistoryPage)), 0);
    EXPECT_LT(std::chrono::steady_clock::now() - start, limit_ / 2) << "a whole page needs no end of its connection";
    EXPECT_EQ(quotes(), "3=45 4=47 ");
    EXPECT_EQ(company_->getQuote(1), quote) << "it was changed, not replaced";
    market_.setName("Nasdaq");
    EXPECT_EQ(history(sending(kHistoryPage)), -1) << "only NASDAQ, NYSE and AMEX have a history";
}

} // namespace
