// The built program and pelorin-quotes, on the port that the build names.

#include "net/QuoteServers.h"
#include "tests/gui/EndToEndFixture.h"
#include "tests/support/ServerRun.h"

#include <fstream>

namespace {

namespace fs = std::filesystem;

using EndToEndQuotesTest = EndToEndTest;

/// "12,345.67 EUR" is 12345.67.
double amountOf(std::string shown)
{
    std::erase(shown, ',');
    return std::stod(shown);
}

/// Leaves the last row of a table, with twice its price: then no chance leaves the holdings worth the same.
void doubleLastPrice(const fs::path& table)
{
    std::string last;
    std::ifstream in(table);
    for (std::string line; std::getline(in, line);)
        last = line;
    const auto price = last.find(',') + 1;
    std::ofstream(table) << last.substr(0, price) << 2 * std::stod(last.substr(price)) << '\n';
}

TEST_F(EndToEndQuotesTest, FetchedQuotesCountFromTheNextRefreshOn)
{
    const fs::path tables = home_.path / "quotes";
    ASSERT_NO_FATAL_FAILURE(makeSampleAtHome("--quotes '" + tables.string() + "'"));
    for (const auto& table : fs::directory_iterator(tables))
        doubleLastPrice(table.path());
    const ServerRun server(PELORIN_QUOTES, tables, quoteServers().port);
    if (server.address().empty())
        GTEST_SKIP() << "port " << quoteServers().port << " is taken, so the built program cannot be served";

    RealProgram program(PELORIN_PROGRAM, home_.path.string());
    loadBothIn(program, "Sample");
    const QPoint total = place(kPortoFolioPage, "txtTotalValue");
    const std::string before = program.textOtherThan("", total);
    program.click(place(kPortoFolioPage, "btnUpdateAllQuotes"));
    // Read when the fetches are through: a program that waits for them gives no text.
    EXPECT_EQ(program.textOtherThan("", total), before) << "the holdings stay as they were valued";
    program.click(place(kPortoFolioPage, "cbxComputeEvolution")); // values them anew
    EXPECT_GT(amountOf(program.textOtherThan(before, total)), 1.2 * amountOf(before));
    EXPECT_EQ(program.quit(), 0);
}

} // namespace
