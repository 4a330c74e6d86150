#include "exchange/MarketFile.h"
#include "foundation/DateText.h"
#include "foundation/Today.h"
#include "net/QuoteServers.h"
#include "net/Socket.h"
#include "tests/support/ServerRun.h"
#include "tests/support/ToolRun.h"
#include "tools/CommandSource.h"
#include "tools/QuoteTable.h"
#include "tools/SourceAnswer.h"

#include <algorithm>
#include <gmock/gmock.h>
#include <thread>

using testing::ElementsAre;
using testing::HasSubstr;
using testing::StartsWith;

namespace {

/// Has the Perl library Finance::Quote, in all programs that are started from here on, find in `folder` a source of the
/// test's own, "worked", and rates in the place of its own ones. Neither asks a network. The source knows all tickers,
/// at 12.5 on 02/01/2026, but some that its code tells.
void installWorkedSource(const TemporaryFolder& folder)
{
    setenv("PERL5LIB", (folder / "lib").c_str(), 1);
    setenv("FQ_LOAD_QUOTELET", "Worked", 1);
    unsetenv("ALPHAVANTAGE_API_KEY");
    // What the library loads by itself, in front of its own; neither asks a network.
    folder.write("lib/Finance/Quote/Worked.pm", R"(package Finance::Quote::Worked;
sub methods { return (worked => \&worked, yahoo_json => \&worked) }
sub labels { return (worked => ['last', 'isodate', 'currency']) }
sub worked {
    my ($quoter, @tickers) = @_;
    my %of;
    for my $ticker (@tickers) {
        print "a module that chatters,1,2\n";
        die "a module that breaks\n" if $ticker eq 'DIES';
        sleep 60 if $ticker eq 'HANGS';
        $of{$ticker, 'success'} = $ticker ne 'NONE';
        $of{$ticker, 'errormsg'} = 'unknown, there: which takes more than a few words to tell to the end';
        $of{$ticker, $ticker eq 'FUND' ? 'nav' : 'last'} = $ticker eq 'LIES' ? 'free' : 12.5;
        $of{$ticker, 'close'} = 1;
        $of{$ticker, 'currency'} = $ticker eq 'POUND' ? 'GBP' : 'USD';
        $quoter->store_date(\%of, $ticker, {isodate => '2026-01-02'});
    }
    return wantarray() ? %of : \%of;
}
1;
)");
    folder.write("lib/Finance/Quote/CurrencyRates/ECB.pm", R"(package Finance::Quote::CurrencyRates::ECB;
my %units = (EUR => 1, USD => 1.25);
sub new { return bless {}, shift }
sub multipliers { return @units{@_[2, 3]} }
1;
)");
}

class SourcesTest : public testing::Test {
protected:
    SourcesTest()
    {
        std::filesystem::create_directory(folder_ / "q");
        setenv("HOME", folder_.path.c_str(), 1); // where former versions are kept
        unsetenv("XDG_CONFIG_HOME");
        installWorkedSource(folder_);
    }

    /// What a server of the folder "q" answers, without the marks of a page; it is stopped then.
    std::vector<std::string> served(const std::string& source, const std::vector<std::string>& tickers,
                                    const char* limit = "2")
    {
        const ServerRun server(PELORIN_QUOTES, folder_ / "q", 0, source, folder_ / "log", limit);
        std::vector<std::string> pages;
        for (const std::string& ticker : tickers)
            pages.push_back(page(server, ticker));
        return pages;
    }
    static std::string page(const ServerRun& server, const std::string& ticker)
    {
        Socket client;
        client.setTimeLimit(std::chrono::seconds(20));
        EXPECT_EQ(client.connectTo("127.0.0.1", server.port()), 0);
        EXPECT_EQ(client.writeLine(String((QuoteServers::kLatestPath + ticker).insert(0, "GET ").c_str())), 0);
        String line;
        EXPECT_EQ(client.readLine(&line), 0);
        const std::string text(line.bytes());
        const std::size_t begin = text.find("<b>");
        return begin == text.npos ? "" : text.substr(begin + 3, text.find("</b>") - begin - 3);
    }
    /// A script of that name, as a source of commands.
    std::string command(const std::string& name, const std::string& script)
    {
        return "command:'" + folder_.write(name, "#!/bin/sh\n" + script, 0755) + "' {ticker}";
    }
    /// How often one that appends its argument to "asked" was run for it.
    long asked(const std::string& ticker) const
    {
        std::istringstream lines(folder_.content("asked"));
        std::string line;
        long count = 0;
        while (std::getline(lines, line))
            count += line == ticker;
        return count;
    }

    /// Whether the process whose number a script has left in "pid" ends soon.
    bool isGone() const
    {
        const std::string status = "/proc/" + std::to_string(std::stoi(folder_.content("pid"))) + "/stat";
        for (int tries = 0; tries < 200; ++tries) {
            const std::string text = contentOf(status);
            // Whoever inherits it may not have taken notice yet.
            if (text.empty() || text.find(") Z ") != text.npos)
                return true;
            std::this_thread::sleep_for(std::chrono::milliseconds(10));
        }
        return false;
    }

    TemporaryFolder folder_{"pelorin-sources-test"};
};

TEST_F(SourcesTest, OnlyWhatIsADateAndACloseIsTaken)
{
    const QuoteSource::Run one{{"A"}, {}, false};
    const QuoteSource::Run named{{"A", "B"}, {}, true};
    const struct {
        const QuoteSource::Run& run;
        std::string output;
        std::size_t closes; // of A
        float latest;
        const char* reason;
    } cases[] = {
        {one, "2026-01-02,5\n2026-01-01,4,USD\n", 2, 5, ""},
        {one, "Date,Close\r\n2026-01-02, 5.25\r\n\r\n", 1, 5.25F, ""},
        {one, "2026-01-05,7\n", 1, 7, ""}, // tomorrow
        {one, "2026-01-06,7\n", 0, 0, "line 1 is of a day to come: \"2026-01-06,7\""},
        {one, "2026-01-02,5\noops\n2026-01-03,6\n", 2, 6, "line 2 is no date,close: \"oops\""},
        {one, "2026-01-02,5", 0, 0, ""}, // was perhaps to be 50
        {one, "02/01/2026,5\n", 0, 0, "is no date"},
        {one, "2026-01-02,-5\n", 0, 0, "is no date"},
        {one, "2026-01-02,0\n", 0, 0, "is no date"},
        {one, "2026-01-02,nan\n", 0, 0, "is no date"},
        {one, "2026-01-02,1e39\n", 0, 0, "is no date"},
        {one, "2026-01-02,5 EUR\n", 0, 0, "is no date"},
        {one, "2026-01-02,4,5,6,7\n", 0, 0, "is no date"}, // open, high, ...
        {one, std::string("\0\x1b[2J\n", 6), 0, 0, "is no date,close: \"??[2J\""},
        {named, "B,2026-01-02,9\nA,2026-01-02,5,USD\nC,2026-01-03,8\n", 1, 5, ""},
        {named, "A,,no such, really\nB,2026-01-02,9\n", 0, 0, "no such, really"},
        {named, "A\n,\nA,,\nA,, \n", 0, 0, ""},
    };
    for (const auto& c : cases) {
        const SourceAnswer answer = readAnswer(c.output, c.run, Date(4, 1, 2026)).at("A");
        EXPECT_EQ(answer.closes.size(), c.closes) << c.output;
        EXPECT_EQ(answer.closes.empty() ? 0 : answer.closes.rbegin()->second, c.latest) << c.output;
        EXPECT_THAT(answer.reason, HasSubstr(c.reason)) << c.output;
    }
}

TEST_F(SourcesTest, ACommandIsWordsAndNoShellText)
{
    const CommandSource source(R"x(a 'b c' "{ticker};$(x)" d"e f"{ticker}{ticker} '')x");
    EXPECT_THAT(source.quotesOf({"IBM"}).arguments, ElementsAre("a", "b c", "IBM;$(x)", "de fIBMIBM", ""));
    EXPECT_EQ(source.ratesOf({"USD"}, "EUR").arguments[2], "USDEUR=X;$(x)");
    for (const char* bad : {"", "command", "command:", "command:a", "command:{ticker} b", "command:a '{ticker}",
                            "finance-quote:", "finance-quote:a b", "finance-quote:-e", "file:x"})
        EXPECT_THROW(quoteSource(bad, std::chrono::seconds(1)), std::runtime_error) << bad;
    for (const char* good : {"IBM", "BRK.B", "^GSPC", "USDEUR=X", "A-B_2", "7203.T"})
        EXPECT_TRUE(isTicker(good)) << good;
    for (const char* bad : {"", "-e", ".x", "a b", "a;b", "a/b", "$x", "`x`", "a\nb", "'", "\xc3\xa4", "a&b", "@x"})
        EXPECT_FALSE(isTicker(bad)) << bad;
}

TEST_F(SourcesTest, ATableKeepsItsLinesAndItsForm)
{
    const std::pair<std::string, std::string> cases[] = {
        {"", "Date,Close\n2026-01-02,5.5\n2026-01-03,6\n"},
        {"2026-01-02,5\n", "2026-01-02,5\n2026-01-02,5.5\n2026-01-03,6\n"},
        {"2026-01-03,6\n02/01/2026,5.5", "2026-01-03,6\n02/01/2026,5.5"},
        {"Date;Open;Close;Volume\r\n02.01.2026;1;5,5;7",
         "Date;Open;Close;Volume\r\n02.01.2026;1;5,5;7\r\n2026-01-03;;6;\r\n"},
        {"Close\tSymbol\tDate\nodd\n", "Close\tSymbol\tDate\nodd\n5.5\tA\t2026-01-02\n6\tA\t2026-01-03\n"},
        {"\x1F\x8B", ""},                  // compressed
        {"Date,Open\n2026-01-02,5\n", ""}, // no closes
    };
    for (const auto& [before, after] : cases) {
        const std::string file = folder_.write("A.csv", before);
        const Closes closes = {{Date(2, 1, 2026), 5.5F}, {Date(3, 1, 2026), 6.F}};
        if (after.empty())
            EXPECT_THROW(addToQuoteTable(file, "A", closes), std::runtime_error);
        else
            addToQuoteTable(file, "A", closes);
        EXPECT_EQ(contentOf(file), after.empty() ? before : after);
    }
}

TEST_F(SourcesTest, ATickerIsAskedForOnceADay)
{
    const std::string today_ = dateText(today());
    const std::string source =
        command("ask", "echo \"$1\" >>'" + (folder_ / "asked") + "'; [ $1 != BAD ] && echo 2026-01-02,12.5\n");
    folder_.write("q/HERE.csv", today_ + ",7\n");
    folder_.write("q/OLD.csv", "2026-01-01,7\nodd,\n");
    EXPECT_THAT(served(source, {"OLD", "OLD", "NEW", "NEW", "HERE", "BAD", "BAD"}),
                ElementsAre("12 <sup>1</sup>/<sub>2</sub>", "12 <sup>1</sup>/<sub>2</sub>",
                            "12 <sup>1</sup>/<sub>2</sub>", "12 <sup>1</sup>/<sub>2</sub>", "7", "", ""));
    for (const auto& [ticker, times] : {std::pair("OLD", 1), {"NEW", 1}, {"HERE", 0}, {"BAD", 1}})
        EXPECT_EQ(asked(ticker), times) << ticker;
    EXPECT_EQ(folder_.content("q/OLD.csv"), "2026-01-01,7\nodd,\n2026-01-02,12.5\n");
    EXPECT_EQ(folder_.content("q/NEW.csv"), "Date,Close\n2026-01-02,12.5\n");
    EXPECT_THAT(folder_.content("log"), HasSubstr("BAD: has ended with status 1\n"));
    EXPECT_EQ(std::ranges::count(folder_.content("log"), '\n'), 3) << "the odd line is told with each of two answers";
    served(source, {"x;y", "-e", "../a", "a b", "$(id)", ".a", "a/b"});
    EXPECT_EQ(std::ranges::count(folder_.content("asked"), '\n'), 3) << "what is no ticker is not passed on";
}

TEST_F(SourcesTest, AHistoryIsWhatHasComeAndWhatWasThere)
{
    folder_.write("q/A.csv", "2026-01-01,7\n");
    const ServerRun server(PELORIN_QUOTES, folder_ / "q", 0, command("days", "echo 2026-01-02,8; echo 2026-01-05,9"));
    const QuoteServers before = quoteServers();
    quoteServers() = {"localhost", "localhost", server.port(), std::chrono::seconds(20)};
    Market market("NYSE");
    auto* company = new Company(&market, "Company", "A"); // owned by the market
    EXPECT_EQ(company->setInternetLastThreeMonthsQuote(), 0);
    quoteServers() = before;
    std::vector<float> closes;
    for (const auto* quote : company->quotes())
        closes.push_back(quote->getValue());
    EXPECT_THAT(closes, ElementsAre(7, 8, 9));
}

TEST_F(SourcesTest, ABadSourceLeavesTheLastClose)
{
    const struct {
        const char* name;
        std::string script;
        const char* told;
    } cases[] = {
        {"fails", "echo 2026-01-02,9; echo 'no network' >&2; exit 3", "has ended with status 3: no network"},
        {"dies", "echo 2026-01-02,9; kill -9 $$", "was ended by signal 9"},
        {"silent", "", "no close came"},
        {"garbage", "head -c 3000 /dev/urandom | tr '0-9' 'x'", "A: "},
        {"million", "yes 2026-01-02,9 | head -n 1000000", "prints more than 1048576 bytes"},
        {"endless", "yes >&2", "has not ended within 2 seconds"},
        {"hangs", "echo 2026-01-02,9; sleep 60 & echo $! >'" + (folder_ / "pid") + "'; wait", "has not ended within 2"},
        {"lies", "echo 2999-01-02,9", "is of a day to come"},
    };
    folder_.write("q/A.csv", "2026-01-01,7\n");
    for (const auto& c : cases) {
        std::filesystem::remove(folder_.path / "log");
        EXPECT_THAT(served(command(c.name, c.script), {"A"}), ElementsAre("7")) << c.name;
        EXPECT_THAT(folder_.content("log"), HasSubstr(c.told)) << c.name;
    }
    EXPECT_THAT(served("command:no-such-program {ticker}", {"A"}), ElementsAre("7"));
    EXPECT_THAT(folder_.content("log"), HasSubstr("no-such-program cannot be run: No such file"));
    EXPECT_EQ(folder_.content("q/A.csv"), "2026-01-01,7\n");
    EXPECT_TRUE(isGone()) << "all of it is killed";
}

TEST_F(SourcesTest, NothingThatASourceHasStartedLivesOn)
{
    const struct {
        const char* why;
        std::string script;
        bool isEnded;
    } cases[] = {
        {"left behind by one that ends", "sleep 60 >&- 2>&- & echo $! >'{pid}'; echo 2026-01-02,9", true},
        {"under way when the terminal is closed", "echo $$ >'{pid}'; exec sleep 60", false},
    };
    for (const auto& c : cases) {
        std::string script = c.script;
        script.replace(script.find("{pid}"), 5, folder_ / "pid");
        folder_.write("pid", "");
        ServerRun server(PELORIN_QUOTES, folder_ / "q", 0, command("start", script), folder_ / "log", "20");
        Socket client;
        client.setTimeLimit(std::chrono::seconds(10));
        ASSERT_EQ(client.connectTo("127.0.0.1", server.port()), 0);
        ASSERT_EQ(client.writeLine(String((QuoteServers::kLatestPath + std::string("A")).insert(0, "GET ").c_str())),
                  0);
        String line;
        if (c.isEnded) {
            EXPECT_EQ(client.readLine(&line), 0);
        }
        for (int tries = 0; tries < 500 && folder_.content("pid").empty(); ++tries)
            std::this_thread::sleep_for(std::chrono::milliseconds(10));
        if (!c.isEnded) {
            EXPECT_EQ(server.stop(SIGHUP), 0);
        }
        EXPECT_TRUE(isGone()) << c.why;
        std::filesystem::remove(folder_.path / "q" / "A.csv");
    }
}

TEST_F(SourcesTest, ASlowSourceHoldsUpOnlyThoseWhoAskIt)
{
    folder_.write("q/SLOW.csv", "2026-01-01,7\n");
    folder_.write("q/HERE.csv", dateText(today()) + ",8\n");
    const ServerRun server(PELORIN_QUOTES, folder_ / "q", 0, command("hang", "sleep 60"), folder_ / "log", "3");
    std::string slow;
    const auto start = std::chrono::steady_clock::now();
    const auto since = [&] { return std::chrono::steady_clock::now() - start; };
    std::thread waiting([&] { slow = page(server, "SLOW"); });
    std::this_thread::sleep_for(std::chrono::milliseconds(200));
    EXPECT_EQ(page(server, "HERE"), "8");
    EXPECT_LT(since(), std::chrono::milliseconds(2500)) << "before the limit of the source";
    waiting.join();
    EXPECT_EQ(slow, "7");
    EXPECT_GE(since(), std::chrono::seconds(3));
    EXPECT_EQ(page(server, "OTHER"), "");
    EXPECT_LT(since(), std::chrono::milliseconds(5500)) << "one that was silent is left alone for a while";
    EXPECT_EQ(folder_.content("log"), "SLOW: has not ended within 3 seconds\n"
                                      "OTHER: is not asked for: the source has been silent\n");
}

TEST_F(SourcesTest, FinanceQuoteFillsTheTables)
{
    EXPECT_THAT(served("finance-quote:worked", {"IBM", "FUND", "NONE", "LIES", "DIES", "HANGS"}, "4"),
                ElementsAre("12 <sup>1</sup>/<sub>2</sub>", "12 <sup>1</sup>/<sub>2</sub>", "", "", "", ""));
    EXPECT_EQ(folder_.content("q/IBM.csv"), "Date,Close\n2026-01-02,12.5\n");
    EXPECT_EQ(folder_.content("log"), "NONE: unknown, there: which takes more than a few words to tell to the end\n"
                                      "LIES: line 1 is no date,close: \"LIES,2026-01-02,free,USD\"\n"
                                      "DIES: a module that breaks\n"
                                      "HANGS: has not ended within 4 seconds\n");
    served("finance-quote:none", {"A"}, "4");
    EXPECT_THAT(folder_.content("log"), HasSubstr("A: has ended with status 255: Finance::Quote has no method none\n"));
}

TEST_F(SourcesTest, AnUpdateBringsTheLatestIntoTheMarketFile)
{
    folder_.write("quotes",
                  "Date,Ticker,Close,Market,Currency\n2026-01-01,IBM,9,NYSE,USD\n2026-01-02,FUND,12.5,NYSE,USD\n"
                  "2026-01-01,POUND,9,NYSE,USD\n2026-01-01,NONE,9,NYSE,USD\n2026-01-01,a;b,9,NYSE,USD\n"
                  "2026-01-01,HANGS,9,NYSE,USD\n"
                  "2026-01-01,TWO,9,NYSE,USD\n2026-01-01,TWO,9,Paris,EUR\n2026-01-01,X,9,Paris,EUR\n");
    folder_.write("rates", "Date,Currency,Rate\n2026-01-01,USD,1\n2026-01-01,CHF,1\n");
    ASSERT_EQ(ToolRun(PELORIN_IMPORT, "f --quotes quotes --rates rates", folder_).status, 0);
    const std::string before = folder_.content("f");
    const ToolRun run(PELORIN_QUOTES, "--update f --source finance-quote:worked --time-limit 2", folder_);
    EXPECT_EQ(run.status, 0);
    EXPECT_EQ(run.out, "quotes: 2 new, 0 changed, 1 equal\nrates: 1 new, 0 changed, 0 equal\nrefused: 6\n");
    EXPECT_EQ(run.err, "a;b: has other signs than those of a ticker\nHANGS: has not answered within 2 seconds\nNONE: "
                       "unknown, there: which takes more than a few "
                       "words to tell to the end\n"
                       "POUND: comes in \"GBP\", and its market trades in \"USD\"\n"
                       "X: comes in \"USD\", and its market trades in \"EUR\"\nCHF: has no rate\n");
    MarketFile file(folder_ / "f");
    std::vector<std::string> latest;
    for (const Currency* currency : file.catalogue().getCurrencies()) {
        const std::string symbol(currency->getRepresentation().bytes());
        latest.push_back(symbol + shortestText(currency->getRealQuote(today()), std::chars_format::fixed));
        for (const Market* market : currency->markets())
            for (const Company* company : market->companies())
                latest.push_back(symbol + std::string(company->getAbbreviation().bytes()) +
                                 shortestText(company->getRealQuote(Date(2, 1, 2026)), std::chars_format::fixed));
    }
    EXPECT_THAT(latest,
                testing::UnorderedElementsAre("EUR1", "CHF1", "USD0.8", "USDIBM12.5", "USDFUND12.5", "USDTWO12.5",
                                              "EURTWO9", "USDPOUND9", "USDNONE9", "USDHANGS9", "USDa;b9", "EURX9"));
    std::vector<std::string> kept;
    for (const auto& entry : std::filesystem::recursive_directory_iterator(folder_.path / "Documents"))
        if (entry.is_regular_file())
            kept.push_back(contentOf(entry.path()));
    EXPECT_THAT(kept, testing::Contains(before)) << "the former version is kept";
    const std::string updated = folder_.content("f");
    EXPECT_EQ(ToolRun(PELORIN_QUOTES, "--update f --time-limit 2", folder_).out,
              "quotes: 0 new, 0 changed, 3 equal\nrates: 0 new, 0 changed, 1 equal\nrefused: 6\n");
    folder_.write("hang", "#!/bin/sh\nsleep 60\n", 0755);
    const auto start = std::chrono::steady_clock::now();
    const ToolRun hanging(PELORIN_QUOTES, "--update f --time-limit 1 --source 'command:./hang {ticker}'", folder_);
    EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::seconds(6));
    EXPECT_EQ(hanging.status, 1);
    EXPECT_THAT(hanging.err, HasSubstr("f: no quote and no rate has come, and it is left as it is\n"));
    // Scripts ignore that signal, and so do the programs that they start.
    const std::string ignoring = std::string("--ignore-signal=CHLD '") + PELORIN_QUOTES + "' ";
    EXPECT_THAT(ToolRun("env", ignoring + "--update f --time-limit 1 --source 'command:false {ticker}'", folder_).err,
                HasSubstr("has ended with status 1"));
    EXPECT_EQ(folder_.content("f"), updated);
}

} // namespace
