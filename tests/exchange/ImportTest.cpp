#include "exchange/CsvReader.h"
#include "exchange/Importer.h"
#include "foundation/DateText.h"
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
    EXPECT_THAT(records("a,\"b\n\"\nc,d"), ElementsAre("1:!", "2:!", "3:c|d")) << "an open quote costs one line";
    const std::string longest(CsvReader::kLongestLine, 'x');
    EXPECT_THAT(records("a,b\n" + longest + "x\nc,d\n"), ElementsAre("1:a|b", "2:!", "3:c|d"));
}

TEST_F(ImportTest, GzippedDataThatEndTooEarlyAreAnError)
{
    zipped("t.gz", "2005-01-03,A,1\n2005-01-04,A,2\n");
    fs::resize_file(folder_ / "t.gz", fs::file_size(folder_ / "t.gz") - 9);
    Importer importer(options_, catalogue_, log_);
    EXPECT_THROW(importer.addQuotes(folder_ / "t.gz"), std::runtime_error);
    EXPECT_THROW(importer.addQuotes(folder_ / "none"), std::runtime_error);
    EXPECT_THROW(importer.addQuotes(folder_.path), std::runtime_error);
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
    Importer importer(options_, catalogue_, log_);
    importer.addQuotes(folder_.write("a.csv", "2005-01-04,A,2\n2005-01-03,A,1\n04/01/2005,A,3\n2005-01-03,B,.5\n"));
    importer.addQuotes(zipped("b.csv.gz", "Adj. Close;CLOSE;Symbol;date\n9;1,5;A;2005-01-03\n;8,25;A;05/01/2005\n"
                                          "9;1.234;A;2005-01-03\n"));
    EXPECT_EQ(importer.finish(), Date(5, 1, 2005));
    EXPECT_THAT(companies(),
                ElementsAre("NYSE/A/A/USD 03/01/2005=1.5 04/01/2005=3 05/01/2005=8.25", "NYSE/B/B/USD 03/01/2005=0.5"));
    EXPECT_EQ(importer.counts().replaced, 2U);
    EXPECT_EQ(importer.counts().quotes, 4U);
    EXPECT_THAT(log(), HasSubstr("line 4: \"1.234\" is no positive number with decimal ','\n")) << "could be thousands";
    EXPECT_THAT(log(), HasSubstr("no rate of USD")) << "EUR is the reference";
    EXPECT_EQ(rates("EUR"), " 03/01/2005=1");
}

TEST_F(ImportTest, LinesThatCannotBeUsedAreCountedWithTheirNumbers)
{
    const char* bad[] = {"2005-13-03,A,1",    "2005-01-03,,1",      "2005-01-03,A",     "2005-01-03,A,0",
                         "2005-01-03,A,-1",   "2005-01-03,A,x",     "2005-01-03,A,nan", "2005-01-03,A,inf",
                         "2005-01-03,A,1e39", "2005-01-03,A,1e-60", "2005-01-03,A,1,5", "2005-01-03,\"A,1"};
    std::string csv;
    for (const char* line : bad)
        (csv += line) += '\n';
    Importer importer(options_, catalogue_, log_);
    importer.addQuotes(folder_.write("a.csv", csv));
    for (std::size_t i = 1; i <= std::size(bad); ++i)
        EXPECT_THAT(log(), HasSubstr("a.csv, line " + std::to_string(i) + ": ")) << bad[i - 1];
    EXPECT_EQ(importer.counts().skipped, std::size(bad));
    EXPECT_THROW(importer.finish(), std::runtime_error) << "nothing usable";
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
    };
    for (const auto& c : cases) {
        options_.ratesAreUnits = c.option;
        Catalogue made;
        Importer importer(options_, made, log_);
        const std::string table = folder_.write("r.csv", std::string(c.heading) + rows);
        if (c.usd == nullptr) {
            EXPECT_THROW(importer.addRates(table), std::runtime_error) << c.why;
            continue;
        }
        importer.addRates(table);
        importer.finish();
        EXPECT_EQ(quotes(*made.getCurrencyByRepresentation("USD")), c.usd) << c.why;
        EXPECT_EQ(quotes(*made.getReferenceCurrency()), " 03/01/2005=1 04/01/2005=1 05/01/2005=1") << c.why;
        EXPECT_EQ(importer.counts().skipped, 1U) << "a reference is not worth 2";
    }
}

TEST_F(ImportTest, TheRowComesBeforeTheListingAndThatBeforeTheOptions)
{
    Importer importer(options_, catalogue_, log_);
    importer.addListing(
        folder_.write("l.csv", "SAP,XETRA,,SAP SE\nBMW,XETRA,EUR,BMW AG\nVOW,XETRA,USD,VW\nABB,,CHF,ABB\n,X,,\nIBM\n"));
    importer.addQuotes(folder_.write("q.csv",
                                     "date,ticker,close,market,currency,name\n3/1/2005,SAP,1,,,\n3/1/2005,BMW,2,,,BMW\n"
                                     "3/1/2005,IBM,3,,,\n3/1/2005,BMW,4,Wien,,\n3/1/2005,ABB,5,SIX,CHF,\n"
                                     "3/1/2005,ABB,6,SIX,EUR,\n3/1/2005,VOW,7,XETRA,EUR,\n"));
    importer.finish();
    EXPECT_THAT(companies(), ElementsAre("XETRA/SAP/SAP SE/EUR 03/01/2005=1", "XETRA/BMW/BMW/EUR 03/01/2005=2",
                                         "XETRA/VOW/VOW/EUR 03/01/2005=7", "NYSE/IBM/IBM/USD 03/01/2005=3",
                                         "Wien/BMW/BMW AG/USD 03/01/2005=4", "SIX/ABB/ABB/CHF 03/01/2005=5"));
    EXPECT_EQ(importer.counts().skipped, 4U) << "XETRA in USD, CHF without a market, no ticker, SIX in EUR";
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
