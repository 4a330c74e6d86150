#include "foundation/Today.h"
#include "market/Company.h"
#include "market/Market.h"
#include "net/QuoteServers.h"
#include "net/StoreQuote.h"
#include "tests/support/Peer.h"

#include <gtest/gtest.h>
#include <memory>
#include <random>

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
    int latest(Peer::Talk talk)
    {
        const Peer peer = Peer(std::move(talk));
        use(peer);
        return company_->getInternetLastQuote(quoteServers().latestHost, QuoteServers::kLatestPath, &value_, &date_);
    }
    int history(Peer::Talk talk)
    {
        const Peer peer = Peer(std::move(talk));
        use(peer);
        return company_->setInternetLastThreeMonthsQuote();
    }
    void use(const Peer& peer) const { quoteServers() = {"localhost", "127.0.0.1", peer.port(), limit_}; }
    /// A talk that takes the request and sends `page` in pieces.
    Peer::Talk sending(const std::string& page, std::size_t piece = ~std::size_t{0},
                       std::chrono::milliseconds pause = 0ms)
    {
        return [=, this](int client) {
            request_ = Peer::receiveLine(client);
            for (std::size_t i = 0; i < page.size() && Peer::send(client, page.substr(i, piece)); i += piece)
                std::this_thread::sleep_for(pause);
        };
    }
    std::string quotes() const
    {
        std::string text;
        for (unsigned i = 0; i < company_->getNbrQuotes(); ++i)
            text += std::to_string(company_->getQuote(i)->getDate().getDay()) + '=' +
                    std::to_string(static_cast<int>(company_->getQuote(i)->getValue())) + ' ';
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

TEST_F(FetchTest, TheRequestIsOneBareLine)
{
    EXPECT_EQ(latest(sending(kLatestPage)), 0);
    EXPECT_EQ(request_, "GET /quotes?symbol=IBM\r\n");
    EXPECT_EQ(history(sending(kHistoryPage)), 0);
    EXPECT_EQ(request_, "GET /idc/nasdgraph.idc?usymbol=IBM&umos=03&site=nasdaq\r\n");
}

TEST_F(FetchTest, ThePageIsTheSameHoweverItArrives)
{
    const std::string longer = std::string(700, '-') + kLatestPage;
    const std::string table = std::string(300, '-') + kHistoryPage;
    for (const std::size_t piece : {1, 7, 100, 255, 256, 257}) {
        value_ = 0;
        EXPECT_EQ(latest(sending(longer, piece, piece == 1 ? 0ms : 2ms)), 0) << piece;
        EXPECT_EQ(value_, 112.375F) << piece;
        company_->getNbrQuotes() > 0 ? delete company_->getQuote(0U) : void();
        EXPECT_EQ(history(sending(table, piece, piece == 1 ? 0ms : 2ms)), 0) << piece;
        EXPECT_EQ(quotes(), "3=45 4=47 ") << piece;
    }
}

TEST_F(FetchTest, PeersThatGiveNoPageFailInTime)
{
    limit_ = 100ms;
    std::mt19937 random(6);
    std::string rubbish(20000, '\0');
    for (char& c : rubbish)
        c = static_cast<char>(random());
    const auto endless = [](const std::string& piece, std::chrono::milliseconds pause) {
        return [=](int client) {
            while (Peer::send(client, piece))
                std::this_thread::sleep_for(pause);
        };
    };
    const struct {
        Peer::Talk talk;
        const char* why;
    } cases[] = {
        {[](int) {}, "closes at once"},
        {[](int client) { Peer::receiveLine(client); }, "closes after the request"},
        {[](int client) { Peer::waitForEnd(client); }, "is silent"},
        {[this](int client) { sending("<html>")(client), Peer::waitForEnd(client); }, "goes silent after some text"},
        {sending("<html>no marker</html>"), "has no marker"},
        {sending(rubbish), "sends rubbish"},
        {endless("<td nowrap>", 0ms), "never ends"},
        {endless(std::string(300, '\0'), 0ms), "never ends, with zeros"},
        {endless("x", 20ms), "never ends, but trickles"},
    };
    for (const auto& c : cases) {
        const auto start = std::chrono::steady_clock::now();
        EXPECT_EQ(latest(c.talk), -1) << c.why;
        EXPECT_EQ(date_, kToday) << c.why;
        EXPECT_EQ(value_, 0) << c.why << ": set once the connection is there";
        EXPECT_EQ(history(c.talk), -1) << c.why;
        EXPECT_LT(std::chrono::steady_clock::now() - start, 10s) << c.why;
    }
    EXPECT_EQ(company_->getNbrQuotes(), 0U);
}

TEST_F(FetchTest, WithoutAConnectionOnlyTheDateIsSet)
{
    EXPECT_EQ(latest([](int) {}), -1);
    value_ = -7; // the port is closed by now
    EXPECT_EQ(company_->getInternetLastQuote("127.0.0.1", "/", &value_, &date_), -1);
    EXPECT_EQ(company_->setInternetLastThreeMonthsQuote(), -1);
    EXPECT_EQ(value_, -7);
    EXPECT_EQ(date_, kToday);
}

TEST_F(FetchTest, APageEndsAtItsLimit)
{
    const auto padded = [](std::size_t size) { return std::string(size, '-') + kLatestPage + std::string(9999, '-'); };
    // The first multiple of 256 beyond 5000 is 5120; what is cut off there is the denominator's cell.
    EXPECT_EQ(latest(sending(padded(5120 - 57))), 0);
    EXPECT_EQ(value_, 112.375F);
    EXPECT_EQ(latest(sending(padded(5120 - 29))), 0);
    EXPECT_EQ(value_, 112) << "cut behind the whole part";
    EXPECT_EQ(latest(sending(padded(5120 - 19))), -1) << "cut inside the marker";
    // A connection that stays open makes no difference once the page is full.
    const auto open = [&](int client) { sending(padded(0))(client), Peer::waitForEnd(client); };
    EXPECT_EQ(latest(open), 0);
}

TEST_F(FetchTest, AHistoryCutAtTheLimitKeepsItsRows)
{
    std::string page = "(00s)</b>\n";
    for (int day = 1; day <= 1000; ++day)
        page += "5/" + std::to_string(day) + "/1999 45.25 - - - - -\n";
    EXPECT_EQ(history(sending(page)), -1);
    unsigned rows = 0; // that are whole up to the price's end
    for (std::size_t end = page.find(" -"); end < 6144; end = page.find(" -", page.find('\n', end)))
        ++rows;
    EXPECT_EQ(company_->getNbrQuotes(), rows);
    EXPECT_GT(rows, 200U);
}

TEST_F(FetchTest, AHistoryChangesTheQuotesThatAreThere)
{
    auto* existing = new CompanyQuote(company_, Date(4, 5, 1999), 1);
    new CompanyQuote(company_, Date(9, 5, 1999), 9);
    EXPECT_EQ(history(sending(kHistoryPage)), 0);
    EXPECT_EQ(quotes(), "3=45 4=47 9=9 ");
    EXPECT_EQ(company_->getQuote(1), existing);
}

TEST_F(FetchTest, OnlyThreeMarketsHaveAHistory)
{
    for (const char* name : {"NASDAQ", "NYSE", "AMEX", "Nasdaq", "", "NYSE "}) {
        market_.setName(name);
        bool called = false;
        const int result = history([&](int client) {
            called = true;
            sending(kHistoryPage)(client);
        });
        const bool served =
            std::string_view(name) == "NASDAQ" || std::string_view(name) == "NYSE" || std::string_view(name) == "AMEX";
        EXPECT_EQ(result, served ? 0 : -1) << name;
        EXPECT_EQ(called, served) << name;
    }
    Company alone;
    EXPECT_EQ(alone.setInternetLastThreeMonthsQuote(), -1);
}

TEST_F(FetchTest, APriceIsStoredOncePerDay)
{
    const struct {
        float price;
        StoreOutcome outcome;
    } cases[] = {{45, StoreOutcome::kAdded},
                 {45, StoreOutcome::kSame},
                 {46, StoreOutcome::kChanged},
                 {0, StoreOutcome::kChanged}};
    CompanyQuote* quote = nullptr;
    for (const auto& c : cases) {
        EXPECT_EQ(storeQuote(company_, kToday, c.price, &quote), c.outcome) << c.price;
        ASSERT_EQ(company_->getNbrQuotes(), 1U);
        EXPECT_EQ(quote, company_->getQuote(0U));
        EXPECT_EQ(quote->getValue(), c.price);
    }
}

} // namespace
