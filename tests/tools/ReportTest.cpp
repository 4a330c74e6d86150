#include "market/NoteCompanyEvent.h"
#include "tests/support/Bytes.h"
#include "tests/support/SmallPortfolio.h"
#include "tests/support/ToolRun.h"

#include <gmock/gmock.h>
#include <regex>

using testing::AllOf;
using testing::HasSubstr;
using testing::Not;

namespace {

class ReportTest : public testing::Test, protected SmallPortfolio {
protected:
    /// What stands in the report, line by line, with single blanks.
    std::string report(const std::string& options)
    {
        folder_.write("market", bytesWritten(catalogue, kStart));
        folder_.write("wallet", bytesWritten(wallet, kStart));
        const ToolRun run(PELORIN_REPORT, "market wallet --force --out r.pdf " + options, folder_);
        EXPECT_EQ(run.status, 0);
        EXPECT_EQ(run.err + run.out, "");
        return std::regex_replace(ask("pdftotext -layout r.pdf -"), std::regex(" +"), " ");
    }
    /// What a program says of it.
    std::string ask(const std::string& program) const { return ToolRun("env", program, folder_).out; }
    static std::size_t count(const std::string& text, const std::string& part)
    {
        std::size_t found = 0;
        for (std::size_t at = text.find(part); at != text.npos; at = text.find(part, at + 1))
            ++found;
        return found;
    }
    /// What an income or a charge is for the file.
    static void move(Account* account, int day, float income)
    {
        const bool isCharge = income < 0;
        withTerms(transfer(account, account, day, isCharge ? -income : 0), isCharge ? 1 : 0, isCharge ? 0 : -income);
    }

    TemporaryFolder folder_{"pelorin-report-test"};
    Account* cash_ = addAccount(wallet, "Cash", euro);
};

} // namespace

// Of 1999: 100 of Alpha bought at 10 and 40 sold at 12, which gains 40 * 2 = 80 and leaves 60, worth 60 * 15 = 900 and
// 300 more than paid. Each trade costs 0.17 %: 1.70 and 0.816. 10 of Beta bought at 7 dollars, at a rate of 2.
TEST_F(ReportTest, AYearIsOnPaperWithItsSumsAndGains)
{
    alpha->setName("Compagnie Internationale des Chemins de Fer et de la Navigation Maritime du Grand Nord");
    Account* york_ = addAccount(wallet, "York", dollar);
    new CompanyQuote(alpha, kStart, 10);
    new CompanyQuote(alpha, Date(31, 12, 1999), 15);
    setTrend(beta, 7); // an estimate behind the last of its two quotes
    deposit(cash_, 0, 5000);
    deposit(cash_, 1, -500.25F);
    deposit(york_, 1, 100);
    trade(new Share(&wallet, alpha), cash_, 2, 100, 10);
    trade(wallet.shares()[0], cash_, 3, -40, 12);
    trade(new Share(&wallet, beta), york_, 3, 10, 7);
    transfer(cash_, york_, 4, 20)->setToCurrencyQuote(2);
    for (int day = 5; day < 100; ++day)
        move(cash_, day, day % 2 == 0 ? 3.5F : -1);
    new NoteCompanyEvent(alpha, Date(9, 1, 1999), "Dividend", "3.50 EUR to Cash"); // tells who has paid
    deposit(cash_, 400, 1);                                                        // of the year behind
    deposit(cash_, 800, 2);

    const std::string text = report("--date 31/12/1999 --name 'Jane Doe' --year 1999");
    for (const char* line : {
             "\nPortfolio on 31/12/1999, in Euro (EUR)\n",
             "\nCash 5,000.00 500.25 164.50 48.00 EUR\n",
             "\nYork 100.00 USD\n",
             "\nTogether 5,200.00 500.25 164.50 48.00 EUR\n",
             "01/01/1999 Deposit Cash 5,000.00 EUR\n",
             "02/01/1999 Withdrawal Cash -500.25 EUR\n",
             "100 10.00 1.70 -1,001.70 EUR\n",
             "04/01/1999 Buy York AC Beta 10 7.00 0.12 -70.12 USD\n",
             "05/01/1999 Transfer Cash to York -20.00 EUR\n York from Cash 10.00 USD\n",
             "\n08/01/1999 Charge Cash -1.00 EUR\n09/01/1999 Income Cash AC Compagnie",
             "\n11/01/1999 Income Cash 3.50 EUR\n",
         })
        EXPECT_THAT(text, HasSubstr(line));
    for (const char* word :
         {"Compagnie", "Chemins", "Maritime", "Grand", " 60 10.00 15.00 900.00 EUR 900.00 ", " 7.00 ~ 06/03/1999 ",
          "~ marks an estimate", " 1,000.00 480.00 2.52 3.50 80.00 300.00 EUR\n"})
        EXPECT_THAT(text, HasSubstr(word));
    EXPECT_EQ(count(text, "Jane Doe Portfolio on 31/12/1999\n"), count(text, "\f"));
    EXPECT_THAT(report("--date 31/12/2001 --from 31/12/1999 --year 2000"),
                AllOf(HasSubstr("\nAccount Deposited\n\nCash 1.00 EUR\n"), HasSubstr("\n05/02/2000 Deposit"),
                      Not(HasSubstr("/1999 Deposit")), Not(HasSubstr("/2001 Deposit")), Not(HasSubstr("Gains of 2000")),
                      HasSubstr("weighted return since 31/12/1999 "), HasSubstr("Gains after 31/12/1999\n")));
}

TEST_F(ReportTest, PagesAreNumberedHeadingsRepeatedAndNothingIsAPicture)
{
    new CompanyQuote(alpha, kStart, 10);
    deposit(cash_, 0, 5000);
    trade(new Share(&wallet, alpha), cash_, 2, 100, 10);
    for (int day = 5; day < 205; ++day)
        move(cash_, day, -1);
    const struct {
        const char *paper, *size;
    } cases[] = {{"a4", "595 x 842 pts (A4)"}, {"letter", "612 x 792 pts (letter)"}};
    for (const auto& c : cases) {
        const std::string text = report(std::string("--date 31/12/1999 --paper ") + c.paper);
        const std::size_t pages = count(text, "\f");
        EXPECT_GT(pages, 4U);
        for (std::size_t page = 1; page <= pages; ++page)
            EXPECT_EQ(count(text, std::to_string(page) + " of " + std::to_string(pages) + '\n'), 1U) << page;
        EXPECT_GE(count(text, "Operations of 1999 continued\nDate Type Account "), pages - 3) << c.paper;
        EXPECT_THAT(ask("pdfinfo r.pdf"), HasSubstr(c.size));
        // A row for each font and picture, below two of headings.
        EXPECT_EQ(count(ask("pdfimages -list r.pdf"), "\n"), 2U);
        const std::string fonts = ask("pdffonts r.pdf");
        EXPECT_GT(count(fonts, "\n"), 2U);
        EXPECT_EQ(count(fonts, " yes "), 2 * (count(fonts, "\n") - 2)) << fonts; // embedded, and with its letters
        EXPECT_EQ(count(text, "Profit"), 1U);                                    // and not with "fi" in one sign
    }
}

TEST_F(ReportTest, WhatItReadsIsNotReplaced)
{
    report("");
    const std::string before = folder_.content("wallet");
    std::filesystem::create_symlink("wallet", folder_ / "link");
    for (const char* out : {"wallet", "link", "market"})
        EXPECT_EQ(ToolRun(PELORIN_REPORT, std::string("market wallet --force --out ") + out, folder_).err,
                  std::string("pelorin-report: ") + out + ": is read here, and is left as it is\n");
    EXPECT_EQ(folder_.content("wallet"), before);
}

TEST_F(ReportTest, WhatIsNotThereIsLeftOutAndSaid)
{
    const auto nothing =
        AllOf(HasSubstr("Total value Total deposit Profit First operation\n0.00 EUR"),
              HasSubstr("No operations up to the day"), Not(HasSubstr("return")), Not(HasSubstr("Holdings")));
    EXPECT_THAT(report(""), nothing);
    trade(new Share(&wallet, alpha), cash_, 2, 100, 10);
    EXPECT_THAT(report("--year 2001"), AllOf(HasSubstr("AC 100 10.00 no quote"), HasSubstr("no rate"),
                                             HasSubstr("No operations in 2001"), Not(HasSubstr("Operations of"))));
    catalogue.setReferenceCurrency(nullptr);
    EXPECT_THAT(report("--year all"),
                AllOf(HasSubstr("Without totals, returns and chart: the market data has no reference currency"),
                      HasSubstr("All operations\n"), Not(HasSubstr("Together"))));
}
