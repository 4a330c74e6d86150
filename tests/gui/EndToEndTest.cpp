// The built program, from its files to what it shows.

#include "tests/gui/EndToEndFixture.h"

#include <gmock/gmock.h>
#include <nlohmann/json.hpp>

namespace {

TEST_F(EndToEndTest, FromLoadToTheShownTotal)
{
    ASSERT_NO_FATAL_FAILURE(makeSampleAtHome());
    const std::string files = "'" + data() + "/Companies/Sample' '" + data() + "/PortoFolios/Sample'";
    const ToolRun valued(PELORIN_VALUE, files + " --date 30/06/2024 --json", TemporaryFolder("pelorin-value"));
    ASSERT_EQ(valued.status, 0) << valued.err;
    const auto value = nlohmann::json::parse(valued.out);

    RealProgram program(PELORIN_PROGRAM, home_.path.string());
    loadSampleIn(program);
    const QPoint total = place(kPortoFolioPage, "txtTotalValue");
    const std::string today = program.textOtherThan("", total);

    program.click(place(kPortoFolioPage, "txtDate"));
    program.key("ctrl+a");
    program.type("30/06/2024");
    program.key("Return");
    std::string shown = program.textOtherThan(today, total);
    std::erase(shown, ',');
    EXPECT_NEAR(std::stod(shown), value["totalValue"].get<double>(), 0.005);
    EXPECT_EQ(shown.substr(shown.find(' ') + 1), value["reference"].get<std::string>());
    EXPECT_EQ(program.quit(), 0);
}

} // namespace
