#include "exchange/CsvReader.h"
#include "exchange/MarketFile.h"
#include "exchange/MarketImport.h"
#include "foundation/DateText.h"
#include "storage/KeptVersions.h"
#include "tests/support/Bytes.h"
#include "tests/support/SmallPortfolio.h"
#include "tests/support/ToolRun.h"

#include <gmock/gmock.h>
#include <sstream>

using testing::ElementsAre;
using testing::HasSubstr;

namespace {

namespace fs = std::filesystem;

class ImportTest : public testing::Test {
protected:
    ImportTest()
    {
        // Where former versions are kept.
        setenv("HOME", folder_.path.c_str(), 1);
        unsetenv("XDG_CONFIG_HOME");
    }
    std::string zipped(const std::string& name, const std::string& content) const
    {
        gzFile out = gzopen((folder_ / name).c_str(), "wb");
        gzwrite(out, content.data(), static_cast<unsigned>(content.size()));
        gzclose(out);
        return folder_ / name;
    }
    /// "line:field|field" of every record; "line:!" for a malformed one.
    std::vector<std::string> records(const std::string& csv) const
    {
        std::vector<std::string> result;
        CsvReader reader(folder_.write("t.csv", csv));
        while (reader.next()) {
            std::string text = reader.fields().empty() ? "!|" : "";
            for (const auto& field : reader.fields())
                (text += field) += '|';
            text.pop_back();
            result.push_back(std::to_string(reader.line()) + ":" + text);
        }
        return result;
    }
    /// "market/ticker/name/currency date=value ..." of every company.
    std::vector<std::string> companies() const
    {
        std::vector<std::string> result;
        for (const Market* market : catalogue_.getMarkets())
            for (const Company* company : all(*market, &Market::getAllCompanies)) {
                std::ostringstream text;
                text << market->getName().bytes() << '/' << company->getAbbreviation().bytes() << '/'
                     << company->getName().bytes() << '/' << market->getCurrencyRepresentation().bytes();
                result.push_back(text.str() + quotes(*company));
            }
        return result;
    }
    std::string rates(const char* symbol) const { return quotes(*catalogue_.getCurrencyByRepresentation(symbol)); }
    template <class Series>
    static std::string quotes(const Series& series)
    {
        std::ostringstream text;
        for (const auto* quote : all(series, &Series::getAllQuotes))
            text << ' ' << quote->getDate().toString().bytes() << '=' << quote->getValue();
        return text.str();
    }
    MarketImport import(const Catalogue& catalogue)
    {
        TableWatch watch;
        watch.refused = [this](const std::string& path, unsigned long line, const std::string& reason) {
            log_ << path << ", line " << line << ": " << reason << '\n';
        };
        return {options_, catalogue, watch};
    }
    std::string log() const { return log_.str(); }
    int run(const std::string& arguments) const { return ToolRun(PELORIN_IMPORT, arguments, folder_).status; }

    TemporaryFolder folder_{"pelorin-import-test"};
    std::ostringstream log_;
    ImportOptions options_;
    Catalogue catalogue_;
};

TEST_F(ImportTest, CsvRecordsFollowRfc4180WithLineNumbers)
{
    EXPECT_THAT(records("a,b\n\n,,\nc,d"), ElementsAre("1:a|b", "4:c|d")) << "blank lines are left out";
    EXPECT_THAT(records("\xEF\xBB\xBFx;1,5\r\nb;\"2\"\r\n"), ElementsAre("1:x|1,5", "2:b|2"));
    EXPECT_THAT(records("\"a;b\",c\n"), ElementsAre("1:a;b|c")) << "a quoted semicolon separates nothing";
    EXPECT_THAT(records("\"a \"\"b\"\"\",\"\",\ne,f\"g\n"), ElementsAre("1:a \"b\"||", "2:e|f\"g"));
    EXPECT_THAT(records("\"a\"b,c\nd,e\n"), ElementsAre("1:!", "2:d|e")) << "text behind the closing quote";
    EXPECT_THROW(records("a,b\n" + std::string(1'000'001, '\n') + "c,d"), std::runtime_error) << "no end of blanks";
    const std::string longest(CsvReader::kLongestLine, 'x');
    EXPECT_THAT(records("a,b\n" + longest + "\nc"), ElementsAre("1:a|b", "2:" + longest, "3:c"));
}

TEST_F(ImportTest, DatesAreIsoOrDayMonthYear)
{
    for (const char* good : {"2004-02-29", "29/02/2004", "29/2/2004", "2004-2-29"})
        EXPECT_EQ(parseDate(good).value_or(Date()), Date(29, 2, 2004)) << good;
    for (const char* bad :
         {"", "2005-02-29", "12/25/2005", "05-01-03", "03/01/05", "2005/01/03", "03-01-2005", "2005-01", "2005-01-03 ",
          "2005-01-03T00", "2005-001-3", "12005-01-03", "2005-01--3", "0/1/2005", "//"})
        EXPECT_FALSE(parseDate(bad)) << bad;
}

TEST_F(ImportTest, QuotesAreOrderedAndTheLaterLineOfADayCounts)
{
    MarketImport importer = import(catalogue_);
    importer.addQuotes(folder_.write("a.csv", "2005-01-04,A,2\n2005-01-03,A,1\n04/01/2005,A,3\n2005-01-03,B,.5\n"));
    importer.addQuotes(zipped("b.csv.gz", "Adj. Close;CLOSE;Symbol;date\n9;1,5;A;2005-01-03\n;8,25;A;05/01/2005\n"
                                          "9;1.234;A;2005-01-03\n"));
    importer.addRates(folder_.write("r.csv", "2005-01-03,USD,2\n"));
    MarketPlan plan = importer.plan();
    EXPECT_EQ(importer.latestDay(), Date(5, 1, 2005));
    plan.carryOut(catalogue_);
    EXPECT_THAT(companies(),
                ElementsAre("NYSE/A/A/USD 03/01/2005=1.5 04/01/2005=3 05/01/2005=8.25", "NYSE/B/B/USD 03/01/2005=0.5"));
    EXPECT_EQ(plan.replaced, 2U);
    EXPECT_EQ(plan.quoteCounts.added, 4U);
    EXPECT_THAT(log(), HasSubstr("line 4: \"1.234\" is no positive number with decimal ','\n")) << "could be thousands";
    EXPECT_EQ(rates("EUR"), " 03/01/2005=1");
}

TEST_F(ImportTest, LinesThatCannotBeUsedAreCountedWithTheirNumbers)
{
    const char* bad[] = {"2005-13-03,A,1",    "2005-01-03,,1",      "2005-01-03,A",     "2005-01-03,A,0",
                         "2005-01-03,A,-1",   "2005-01-03,A,x",     "2005-01-03,A,nan", "2005-01-03,A,inf",
                         "2005-01-03,A,1e39", "2005-01-03,A,1e-60", "2005-01-03,A,1,5", "2005-01-03,\"A\"B,1"};
    std::string csv;
    for (const char* line : bad)
        (csv += line) += '\n';
    MarketImport importer = import(catalogue_);
    importer.addQuotes(folder_.write("a.csv", csv));
    for (std::size_t i = 1; i <= std::size(bad); ++i)
        EXPECT_THAT(log(), HasSubstr("a.csv, line " + std::to_string(i) + ": ")) << bad[i - 1];
    EXPECT_THROW(importer.plan(), std::runtime_error) << "nothing usable";
}

TEST_F(ImportTest, RatesBecomePricesInTheReference)
{
    const char* rows = "2005-01-03,USD,1.25\n2005-01-04,CHF,0.5\n2005-01-05,EUR,1\n2005-01-05,EUR,2\n";
    const struct {
        const char* heading;
        std::optional<bool> option;
        const char* usd;
        const char* why;
    } cases[] = {
        {"", {}, " 03/01/2005=0.8", "units unless said otherwise"},
        {"date,currency,rate\n", false, " 03/01/2005=1.25", "the option"},
        {"Date,Symbol,Value in EUR\n", {}, " 03/01/2005=1.25", "the heading"},
        {"date,currency,units_per_eur\n", true, " 03/01/2005=0.8", "both, in agreement"},
        {"date,currency,units_per_eur\n", false, nullptr, "both, in contradiction"},
        {"date,currency,units_per_gbp\n", {}, nullptr, "of another reference"},
        {"date,currency\n", {}, nullptr, "a currency but no rate"},
    };
    for (const auto& c : cases) {
        options_.ratesAreUnits = c.option;
        Catalogue made;
        MarketImport importer = import(made);
        const std::string table = folder_.write("r.csv", std::string(c.heading) + rows);
        if (c.usd == nullptr) {
            EXPECT_THROW(importer.addRates(table), std::runtime_error) << c.why;
            continue;
        }
        importer.addRates(table);
        MarketPlan plan = importer.plan();
        plan.carryOut(made);
        EXPECT_EQ(quotes(*made.getCurrencyByRepresentation("USD")), c.usd) << c.why;
        EXPECT_EQ(quotes(*made.getReferenceCurrency()), " 03/01/2005=1 04/01/2005=1 05/01/2005=1") << c.why;
        EXPECT_EQ(plan.refused, 1U) << "a reference is not worth 2";
    }
}

TEST_F(ImportTest, TheRowComesBeforeTheListingAndThatBeforeTheOptions)
{
    MarketImport importer = import(catalogue_);
    importer.addListing(
        folder_.write("l.csv", "SAP,XETRA,,SAP SE\nBMW,XETRA,EUR,BMW AG\nVOW,XETRA,USD,VW\nABB,,CHF,ABB\n,X,,\nIBM\n"));
    importer.addQuotes(folder_.write("q.csv",
                                     "date,ticker,close,market,currency,name\n3/1/2005,SAP,1,,,\n3/1/2005,BMW,2,,,BMW\n"
                                     "3/1/2005,IBM,3,,,\n3/1/2005,BMW,4,Wien,,\n3/1/2005,ABB,5,SIX,CHF,\n"
                                     "3/1/2005,ABB,6,SIX,EUR,\n3/1/2005,VOW,7,XETRA,EUR,\n"));
    importer.addRates(folder_.write("r.csv", "2005-01-03,USD,1\n2005-01-03,CHF,1\n"));
    MarketPlan plan = importer.plan();
    plan.carryOut(catalogue_);
    EXPECT_THAT(companies(), ElementsAre("XETRA/SAP/SAP SE/EUR 03/01/2005=1", "XETRA/BMW/BMW/EUR 03/01/2005=2",
                                         "XETRA/VOW/VOW/EUR 03/01/2005=7", "NYSE/IBM/IBM/USD 03/01/2005=3",
                                         "Wien/BMW/BMW AG/USD 03/01/2005=4", "SIX/ABB/ABB/CHF 03/01/2005=5"));
    EXPECT_EQ(plan.refused, 4U) << "XETRA in USD, CHF without a market, no ticker, SIX in EUR";
}

TEST_F(ImportTest, AWideTableHasAColumnACurrencyOrTicker)
{
    MarketImport importer = import(catalogue_);
    // As a central bank publishes them: the newest first, and a separator behind the last column.
    importer.addRates(folder_.write("r.csv", "Date, USD,JPY,CHF,\n2005-01-04,1.25,N/A,0.5,\n2005-01-03,NA,100,-,\n"
                                             "2005-01-02,x,200,y,\n"));
    importer.addQuotes(folder_.write("q.csv", "date;BRK.B;A;Z\n3/1/2005;;;7\n4/1/2005;2,5;.5\n"));
    MarketPlan plan = importer.plan();
    plan.carryOut(catalogue_);
    EXPECT_EQ(rates("USD") + rates("JPY") + rates("CHF"),
              " 04/01/2005=0.8 02/01/2005=0.005 03/01/2005=0.01 04/01/2005=2");
    EXPECT_EQ(rates("EUR"), " 02/01/2005=1 03/01/2005=1 04/01/2005=1");
    EXPECT_THAT(companies(), ElementsAre("NYSE/BRK.B/BRK.B/USD 04/01/2005=2.5", "NYSE/Z/Z/USD 03/01/2005=7"))
        << "the headings are the first mention";
    EXPECT_THAT(log(), HasSubstr("r.csv, line 4: USD: \"x\" is no positive number with decimal '.'; CHF: \"y\""));
    EXPECT_THAT(log(), HasSubstr("q.csv, line 3: A: \".5\" is no positive number"));
    EXPECT_EQ(plan.refused, 2U);
    EXPECT_EQ(plan.rateCounts.added, 4U) << "without those of the reference";
}

TEST_F(ImportTest, DatesAndTextsAreTakenAsOtherProgramsWriteThem)
{
    MarketImport importer = import(catalogue_);
    // The daily table of a central bank, and a spreadsheet of a Windows program.
    importer.addRates(folder_.write("r.csv", "Date, USD, \n3 January 2005, 1.25, \n"));
    importer.addQuotes(folder_.write("q.csv",
                                     "date;ticker;close;name\n03.01.2005;A;1,5;Caf\xE9\n20050104;A;2\n"
                                     "2005-01-05T00:00:00;A;3\n05-01-2005;A;4\n01/02/05;A;4\n31.02.2005;A;4\n"));
    MarketPlan plan = importer.plan();
    plan.carryOut(catalogue_);
    EXPECT_THAT(companies(), ElementsAre("NYSE/A/Caf\xC3\xA9/USD 03/01/2005=1.5 04/01/2005=2 05/01/2005=3"));
    EXPECT_EQ(plan.refused, 3U) << "which could be other days, or are none";
}

/// A catalogue in which names come several times. The pound has no rate, the yen none that counts.
void fillWithNamesakes(Catalogue& catalogue)
{
    for (const char* symbol : {"EUR", "USD", "GBP", "EUR", "JPY"})
        catalogue.addCurrency(new Currency(symbol, symbol, nullptr));
    catalogue.setReferenceCurrency(catalogue.getCurrencies()[0]);
    const Date day(3, 1, 2005);
    new CurrencyQuote(catalogue.getCurrencies()[0], day, 1);
    new CurrencyQuote(catalogue.getCurrencies()[1], day, 0.8F);
    new CurrencyQuote(catalogue.getCurrencies()[4], day, 0);
    const std::tuple<int, const char*, std::vector<const char*>> markets[] = {
        {0, "Paris", {"ALP"}}, {0, "LSE", {"DUO", "DUO"}}, {1, "LSE", {"DUO", "ONE"}}, {2, "LSE", {"PND"}}};
    for (const auto& [currency, name, tickers] : markets) {
        auto* market = new Market(name);
        market->setCurrency(catalogue.getCurrencies()[static_cast<std::size_t>(currency)]);
        for (const char* ticker : tickers)
            new CompanyQuote(new Company(market, "Name", ticker), day, 1);
    }
}

TEST_F(ImportTest, ARowMeansTheFirstThatBearsItsNames)
{
    const std::string refused = "refused";
    const struct {
        const char* row; // ticker, close, market, currency, name
        std::string place;
        const char* why;
    } cases[] = {
        {"ALP,2,,,Other", "1 Paris/ALP/Name/EUR", "the only company of that ticker, which keeps its name"},
        {"ONE,2,,,", "2 LSE/ONE/Name/USD", "the same in another market"},
        {"DUO,2,,,", "3 NYSE/DUO/DUO/USD", "one of several: the option's market"},
        {"DUO,2,LSE,,", "2 LSE/DUO/Name/EUR", "the first market, and its first company"},
        {"DUO,2,LSE,USD,", "1 LSE/DUO/Name/USD", "the first in that currency"},
        {"ONE,2,LSE,,", "2 LSE/ONE/Name/USD", "one that has the ticker comes before the first"},
        {"NEW,2,LSE,,Nu", "4 LSE/NEW/Nu/EUR", "else the first"},
        {"NEW,2,LSE,USD,", "3 LSE/NEW/NEW/USD", "or the first in that currency"},
        {"NEW,2,Rome,EUR,", "4 Rome/NEW/NEW/EUR", "a new market of the first euro"},
        {"PND,2,LSE,GBP,", "no rate of \"GBP\", in which \"PND\" is quoted", "worth nothing"},
        {"NEW,2,Tokyo,JPY,", "no rate of \"JPY\", in which \"NEW\" is quoted", "the same"},
        {"NEW,2,LSE,CHF,", refused, "no market of that name trades in it"},
        {"ALP,2,,USD,", refused, "the only company is quoted in another"},
        {"NEW,2,,CHF,", refused, "no market, and not the option's currency"},
        {"ALP,1,,,", "equal", "nothing to do"},
    };
    for (const auto& c : cases) {
        Catalogue catalogue;
        fillWithNamesakes(catalogue);
        MarketImport importer = import(catalogue);
        // A rate that is there already, so that there always is something that can be used.
        importer.addRates(folder_.write("r.csv", "2005-01-03,USD,1.25\n"));
        importer.addQuotes(
            folder_.write("q.csv", std::string("date,ticker,close,market,currency,name\n3/1/2005,") + c.row + "\n"));
        std::string place;
        try {
            MarketPlan plan = importer.plan();
            place = plan.refused > 0 ? refused : "equal";
            EXPECT_EQ(plan.isEmpty(), c.place == place) << c.why;
            plan.carryOut(catalogue);
        } catch (const MissingRate& reason) {
            place = reason.what();
        }
        // Its place among the companies of its currency, from 1 on, and its names.
        for (const Currency* currency : catalogue.getCurrencies()) {
            int number = 0;
            for (const Market* market : currency->markets())
                for (const Company* company : market->companies())
                    if (++number; company->getRealQuote(Date(3, 1, 2005)) == 2)
                        place = std::to_string(number) + ' ' + market->getName().getCharacterArray() + '/' +
                                company->getAbbreviation().getCharacterArray() + '/' +
                                company->getName().getCharacterArray() + '/' +
                                company->getCurrencyRepresentation().getCharacterArray();
        }
        EXPECT_EQ(place, c.place) << c.why;
    }
}

/// Two currencies, the reference second. What readers pass over stands here, too: a quote in front of an earlier one,
/// two of a day, an event of no known type, a zero byte in a name, and something behind the end.
std::string oddFile(const std::string& quotesOfA, const std::string& moreRates, const std::string& more,
                    const char* stamp)
{
    const std::string note = "02 00 04 00 05 00 CF 07 00 00  02 00 00 00 'Hi'  01 00 00 00 '!' ";
    return bytesOf("03 00 00 00 'EUR' " + std::string(more.empty() ? "02" : "03") + " 00 00 00 " + stamp +
                   "06 00 00 00 'Dol' 00 'ar'  03 00 00 00 'USD'  01 00 00 00  04 00 00 00 'NYSE'  02 00 00 00 "
                   "01 00 00 00 'A'  01 00 00 00 'A' " +
                   quotesOfA + " 02 00 00 00 " + note +
                   " 09 00 "
                   "01 00 00 00 'B'  01 00 00 00 'B'  03 00 00 00 "
                   "04 00 01 00 D5 07 00 00 00 00 C0 3F  03 00 01 00 D5 07 00 00 00 00 C0 3F "
                   "04 00 01 00 D5 07 00 00 00 00 80 3F  01 00 00 00 01 00 03 00 05 00 CF 07 00 00 02 00 01 00 " +
                   moreRates + stamp +
                   "00 00 00 00  03 00 00 00 'EUR'  00 00 00 00  01 00 00 00 "
                   "03 00 01 00 D5 07 00 00 00 00 80 3F " +
                   more + "'rest'");
}

TEST_F(ImportTest, IntoAFileGoesWhatIsNewAndNothingElseChanges)
{
    const std::string stamp = "05 00 01 00 D5 07 00 00 ";
    const std::string oneRate = "01 00 00 00  03 00 01 00 D5 07 00 00 00 00 00 3F ";
    const std::string before =
        oddFile("01 00 00 00  03 00 01 00 D5 07 00 00 00 00 80 3F", oneRate, "", "03 00 01 00 D5 07 00 00 ");
    const std::string file = folder_.write("f", before);
    folder_.write("q.csv", "date,ticker,close,market,name\n2005-01-05,A,2,,Ah\n2005-01-03,A,1.5\n2005-01-06,A\n");
    folder_.write("r.csv", "Date,USD,JPY\n2005-01-03,2,0.5\n");
    const std::string counts = "quotes: 1 new, 1 changed, 0 equal\nrates: 1 new, 0 changed, 1 equal\nrefused: 1\n";
    const std::string arguments = "--into f --quotes q.csv --rates r.csv";
    const auto backups = [&] { return KeptVersions(DataFolder(folder_ / "Documents/Pelorin")).versionsOf(file); };

    const ToolRun dry(PELORIN_IMPORT, arguments + " --dry-run", folder_);
    EXPECT_EQ(dry.out, counts) << dry.err;
    EXPECT_THAT(dry.err, HasSubstr("q.csv, line 4: "));
    EXPECT_EQ(folder_.content("f"), before);

    EXPECT_EQ(ToolRun(PELORIN_IMPORT, arguments, folder_).out, counts);
    const std::string after =
        oddFile("02 00 00 00  03 00 01 00 D5 07 00 00 00 00 C0 3F  05 00 01 00 D5 07 00 00 00 00 00 40", oneRate,
                stamp + "03 00 00 00 'JPY'  03 00 00 00 'JPY'  00 00 00 00 "
                        "01 00 00 00  03 00 01 00 D5 07 00 00 00 00 00 40 ",
                stamp.c_str());
    EXPECT_EQ(folder_.content("f"), after);
    ASSERT_EQ(backups().size(), 1U) << "the former version is kept";
    EXPECT_EQ(contentOf(backups().front()), before);

    EXPECT_EQ(ToolRun(PELORIN_IMPORT, arguments, folder_).out,
              "quotes: 0 new, 0 changed, 2 equal\nrates: 0 new, 0 changed, 2 equal\nrefused: 1\n");
    EXPECT_EQ(folder_.content("f"), after);
    EXPECT_EQ(backups().size(), 1U) << "nothing has changed";

    // A series in disorder that does change: on its own days only.
    folder_.write("b.csv", "date,ticker,close\n2005-01-03,B,1.5\n2005-01-02,B,2\n2005-01-09,B,2\n");
    EXPECT_EQ(ToolRun(PELORIN_IMPORT, "--into f --quotes b.csv", folder_).status, 0);
    EXPECT_THAT(
        folder_.content("f"),
        HasSubstr(bytesOf("05 00 00 00  02 00 01 00 D5 07 00 00 00 00 00 40  04 00 01 00 D5 07 00 00 00 00 C0 3F "
                          "03 00 01 00 D5 07 00 00 00 00 C0 3F  04 00 01 00 D5 07 00 00 00 00 80 3F "
                          "09 00 01 00 D5 07 00 00 00 00 00 40 ")))
        << "of two quotes of a day that nobody named both stay";
    folder_.write("b.csv", "date,ticker,close\n2005-01-04,B,2\n");
    EXPECT_EQ(ToolRun(PELORIN_IMPORT, "--into f --quotes b.csv", folder_).status, 0);
    EXPECT_THAT(folder_.content("f"), HasSubstr(bytesOf("04 00 01 00 D5 07 00 00 00 00 00 40 "
                                                        "03 00 01 00 D5 07 00 00 00 00 C0 3F "
                                                        "04 00 01 00 D5 07 00 00 00 00 00 40 ")))
        << "and of the day that is named both change";
}

TEST_F(ImportTest, TablesInPartsGiveWhatTheyGiveInOneGo)
{
    std::mt19937 random(5);
    const std::string headings = "date,ticker,market,currency,close\n";
    std::string all = headings;
    folder_.write("r.csv", "3/1/2005,USD,2\n");
    EXPECT_EQ(run("parts --rates r.csv"), 0);
    for (int part = 0; part < 4; ++part) {
        std::string rows;
        for (int row = 0; row < 60; ++row) {
            const unsigned ticker = below(random, 6);
            const std::string date = daysAfterStart(below(random, 20)).toString().getCharacterArray();
            rows += date + ',' + std::string(1, static_cast<char>('A' + ticker)) + ",M" + std::to_string(ticker % 2) +
                    (ticker % 2 == 0 ? ",EUR," : ",USD,") + std::to_string(below(random, 900) + 1) + '\n';
        }
        all += rows;
        folder_.write("part.csv", headings + rows);
        EXPECT_EQ(run("--into parts --quotes part.csv"), 0);
    }
    folder_.write("all.csv", all);
    EXPECT_EQ(run("whole --rates r.csv --quotes all.csv"), 0);
    EXPECT_EQ(folder_.content("parts"), folder_.content("whole"));
}

TEST_F(ImportTest, TheReferenceGetsTheDaysThatItLacks)
{
    const struct {
        std::vector<float> own; // rates from the 3rd on
        const char* tables;
        const char* rates;
        const char* why;
    } cases[] = {
        {{1, 1}, "2005-01-02,USD,2\n2005-01-04,USD,2\n", " 02/01/2005=1 03/01/2005=1 04/01/2005=1", "all are 1"},
        {{1, 2}, "2005-01-02,USD,2\n", " 03/01/2005=1 04/01/2005=2", "it means something else"},
        {{}, "2005-01-02,USD,2\n", " 02/01/2005=1", "it had none"},
        {{}, "date,ticker,close,market,currency\n2005-01-02,Q,2,Rome,EUR\n", " 02/01/2005=1", "it is quoted in"},
        {{}, "date,ticker,close\n2005-01-02,Q,2\n", "", "no table names it"},
    };
    for (const auto& c : cases) {
        Catalogue catalogue;
        auto* euro = new Currency("Euro", "EUR", nullptr);
        catalogue.addCurrency(euro);
        catalogue.setReferenceCurrency(euro);
        auto* dollar = new Currency("Dollar", "USD", nullptr);
        catalogue.addCurrency(dollar);
        new CurrencyQuote(dollar, Date(1, 1, 2005), 0.5F);
        for (short day = 3; const float rate : c.own)
            new CurrencyQuote(euro, Date(day++, 1, 2005), rate);
        MarketImport importer = import(catalogue);
        const std::string table = folder_.write("t.csv", c.tables);
        std::string_view(c.tables).starts_with("date") ? importer.addQuotes(table) : importer.addRates(table);
        importer.plan().carryOut(catalogue);
        EXPECT_EQ(quotes(*euro), c.rates) << c.why;
    }
}

TEST_F(ImportTest, WhatIsNoTableEndsTheImportInOneLineAndChangesNothing)
{
    folder_.write("good.csv", "2005-01-03,USD,1.25\n");
    EXPECT_EQ(run("f --rates good.csv"), 0);
    const std::string before = folder_.content("f");
    fs::create_directory(folder_.path / "folder");
    const std::string row = "2005-01-04,USD,2\n";
    folder_.write("utf16", std::string("\xFF\xFE") + bytesOf("32 00 30 00 0A 00"));
    folder_.write("nul", row + std::string("2005-01-05,U\0D,2\n", 18));
    folder_.write("long", row + std::string(10'000'000, '1') + "\n" + row);
    folder_.write("quote", row + "2005-01-05,\"U\nSD\",2\n");
    folder_.write("month", "date,symbol,rate,ticker,close\n01/05/2005,USD,2,A,2\n01/14/2005,USD,2,A,2\n");
    folder_.write("empty", "");
    folder_.write("mark", "\xEF\xBB\xBF");
    folder_.write("headings", "date,currency,rate\n");
    zipped("bomb", std::string(100'000'000, '\0'));
    zipped("ones", std::string(100'000'000, '1'));
    zipped("cut", row + row);
    fs::resize_file(folder_ / "cut", fs::file_size(folder_ / "cut") - 9);
    for (const std::string kind : {"utf16", "nul", "long", "quote", "month", "empty", "mark", "headings", "bomb",
                                   "ones", "cut", "folder", "none"})
        for (const std::string table : {"--rates ", "--quotes "}) {
            const ToolRun tool(PELORIN_IMPORT, "--into f " + table + kind, folder_);
            EXPECT_EQ(tool.status, 1) << table << kind;
            EXPECT_EQ(std::ranges::count(tool.err, '\n'), 1) << table << kind << ": " << tool.err;
            EXPECT_THAT(tool.err, testing::StartsWith("pelorin-import: ")) << table << kind;
            EXPECT_EQ(folder_.content("f"), before) << table << kind;
        }
}

TEST_F(ImportTest, TheProgramWritesAFileThatTheCatalogueReads)
{
    folder_.write("IBM.csv", "Date,Close\n2005-01-03,97.75\n");
    folder_.write("r.csv", "2005-01-03,USD,1.25\n");
    EXPECT_EQ(run("made --quotes IBM.csv --ticker-from-name --rates r.csv --market AMEX"), 0);
    const std::string once = folder_.content("made");
    EXPECT_EQ(catalogue_.rd(BytesFile(once)), 0);
    EXPECT_THAT(companies(), ElementsAre("AMEX/IBM/IBM/USD 03/01/2005=97.75"));
    EXPECT_EQ(catalogue_.getReferenceCurrency()->getRepresentation(), "EUR");
    EXPECT_EQ(rates("USD"), " 03/01/2005=0.8");

    EXPECT_EQ(run("made --rates r.csv"), 1);
    EXPECT_EQ(folder_.content("made"), once) << "nothing is overwritten unasked";
    EXPECT_EQ(run("made --rates r.csv --force"), 0);
    EXPECT_NE(folder_.content("made"), once);
}

} // namespace
