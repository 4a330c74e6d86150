// The built program on a real X server, by real mouse and key events alone.

#include "platform/WindowWidget.h"
#include "tests/gui/RealProgram.h"
#include "tests/gui/WindowFixture.h"
#include "tests/support/ToolRun.h"

#include <QTabBar>
#include <gmock/gmock.h>
#include <nlohmann/json.hpp>

namespace {

/// A window of this test's own tells where the controls stand in that of the program.
class EndToEndTest : public WindowTest {
protected:
    QPoint tab(Page page)
    {
        const auto* bar = window().widget().findChild<QTabBar*>();
        return bar->mapTo(&window().widget(), bar->tabRect(page).center());
    }

    QPoint place(Page page, const char* name)
    {
        show(page);
        auto& control = find<QWidget>(name);
        return control.mapTo(&window().widget(), control.rect().center());
    }

    const TemporaryFolder home_{"pelorin-home"};
};

TEST_F(EndToEndTest, FromLoadToTheShownTotal)
{
    const std::string data = (home_.path / "Documents" / "Pelorin").string();
    std::filesystem::create_directories(data);
    ASSERT_EQ(ToolRun(PELORIN_SAMPLE, "'" + data + "'", TemporaryFolder("pelorin-sample")).status, 0);
    const std::string files = "'" + data + "/Companies/Sample' '" + data + "/PortoFolios/Sample'";
    const ToolRun valued(PELORIN_VALUE, files + " --date 30/06/2024 --json", TemporaryFolder("pelorin-value"));
    ASSERT_EQ(valued.status, 0) << valued.err;
    const auto value = nlohmann::json::parse(valued.out);

    RealProgram program(PELORIN_PROGRAM, home_.path.string());
    program.click(place(kCompanyPage, "btnLoadMarket"));
    program.awaitWindow("Load");
    program.type("Sample");
    program.key("Return");
    program.awaitNoWindow("Load");
    program.click(tab(kPortoFolioPage));
    program.click(place(kPortoFolioPage, "btnLoadPortoFolio"));
    program.awaitWindow("Warning");
    program.key("Return"); // Continue
    program.awaitWindow("Load");
    program.type("Sample");
    program.key("Return");
    program.awaitNoWindow("Load");
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
