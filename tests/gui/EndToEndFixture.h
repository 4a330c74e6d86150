#pragma once

#include "platform/WindowWidget.h"
#include "tests/gui/RealProgram.h"
#include "tests/gui/WindowFixture.h"
#include "tests/support/ToolRun.h"

#include <QTabBar>

/// The built program on a real X server, by real mouse and key events alone, with a home of its own. A window of the
/// test tells where the controls stand in that of the program.
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

    /// The program's data folder.
    std::string data() const { return (home_.path / "Documents" / "Pelorin").string(); }

    /// Writes the sample into the data folder.
    void makeSampleAtHome(const std::string& options = "") const
    {
        std::filesystem::create_directories(data());
        const ToolRun run(PELORIN_SAMPLE, "'" + data() + "' " + options, TemporaryFolder("pelorin-sample"));
        ASSERT_EQ(run.status, 0) << run.err;
    }

    /// Loads a file by a button of the page; `isAsked` when something could be lost.
    void loadIn(RealProgram& program, Page page, const char* button, const char* name, bool isAsked)
    {
        program.click(tab(page));
        program.click(place(page, button));
        if (isAsked) {
            program.awaitWindow("Warning");
            program.key("Return"); // Continue
        }
        program.awaitWindow("Load");
        program.type(name);
        program.key("Return");
        program.awaitNoWindow("Load");
    }
    /// Loads both files of that name. The page of the portfolio is shown afterwards.
    void loadBothIn(RealProgram& program, const char* name)
    {
        loadIn(program, kCompanyPage, "btnLoadMarket", name, false);
        loadIn(program, kPortoFolioPage, "btnLoadPortoFolio", name, true);
    }

    const TemporaryFolder home_{"pelorin-home"};
};
