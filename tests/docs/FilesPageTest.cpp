// The examples of docs/FILES.md are whole files, and what the program writes of them.

#include "market/Catalogue.h"
#include "portfolio/Wallet.h"
#include "tests/support/Bytes.h"

#include <fstream>
#include <gtest/gtest.h>
#include <vector>

namespace {

/// The bytes of each block of the page that is marked as hex: on every line the digits before the explanation.
std::vector<std::string> examples()
{
    std::vector<std::string> blocks;
    std::ifstream page(PELORIN_FILES_PAGE);
    bool inside = false;
    for (std::string line; std::getline(page, line);) {
        if (line == "```hex")
            blocks.emplace_back();
        inside = line == "```hex" || (inside && line != "```");
        if (inside && line != "```hex")
            blocks.back() += bytesOf(line.substr(0, line.find("   ")));
    }
    return blocks;
}

} // namespace

TEST(FilesPageTest, ExamplesAreReadWholeAndWrittenAgain)
{
    const std::vector<std::string> pages = examples();
    ASSERT_EQ(pages.size(), 2U);
    const Date saved(5, 5, 1999);
    Catalogue catalogue;
    ASSERT_EQ(catalogue.rd(BytesFile(pages[0])), 0);
    EXPECT_EQ(pages[0], bytesWritten(catalogue, saved));
    Wallet wallet;
    wallet.setCatalogue(catalogue);
    Date stamp;
    ASSERT_EQ(wallet.rd(BytesFile(pages[1]), &stamp), 0);
    EXPECT_EQ(pages[1], bytesWritten(wallet, saved));
    EXPECT_EQ(stamp, saved);
}
