#include "foundation/NumberText.h"
#include "platform/DialogAnswers.h"
#include "tests/gui/CatalogueFixture.h"
#include "tests/support/ToolRun.h"
#include "views/ColumnListView.h"

#include <QDialogButtonBox>
#include <QFileDialog>
#include <QMenu>
#include <QMessageBox>
#include <QPushButton>
#include <QTimer>

using testing::ElementsAre;
using testing::HasSubstr;

namespace {

using Lines = std::vector<std::string>;

Lines linesOf(const std::string& text)
{
    std::istringstream stream(text);
    Lines lines;
    for (std::string line; std::getline(stream, line);)
        lines.push_back(line);
    return lines;
}

class ExportWindowTest : public CatalogueTest {
protected:
    ~ExportWindowTest() override { DialogAnswers::current().panel = nullptr; }

    /// What the menu of the page offers; what cannot be chosen stands in brackets.
    Lines offered(Page page)
    {
        show(page);
        QMenu* menu = openMenu();
        Lines labels;
        for (const QAction* action : menu->actions()) {
            const std::string text = action->isSeparator() ? "-" : action->text().toStdString();
            labels.push_back(action->isEnabled() || action->isSeparator() ? text : '(' + text + ')');
        }
        QTest::keyClick(menu, Qt::Key_Escape);
        settle();
        EXPECT_EQ(QApplication::activePopupWidget(), nullptr);
        return labels;
    }
    /// Chooses in the menu of the page in front, by keys.
    void chooseExport(const std::string& label)
    {
        QMenu* menu = openMenu();
        for (qsizetype i = 0; i < menu->actions().size() && menu->activeAction()->text().toStdString() != label; ++i)
            QTest::keyClick(menu, Qt::Key_Down);
        ASSERT_EQ(menu->activeAction()->text().toStdString(), label);
        QTest::keyClick(menu, Qt::Key_Return);
        settle();
    }
    /// The notice behind an export to `path`, whatever is there.
    std::string exportTo(const std::string& path, const std::string& label)
    {
        DialogAnswers::current().panel = [&](const BFilePanel&) { return path; };
        chooseExport(label);
        DialogAnswers::current().panel = nullptr;
        return notice();
    }

private:
    QMenu* openMenu()
    {
        press("btnExport");
        auto* menu = qobject_cast<QMenu*>(QApplication::activePopupWidget());
        if (menu == nullptr)
            throw std::runtime_error("no menu");
        return menu;
    }
};

} // namespace

TEST_F(ExportWindowTest, WhatIsWrittenIsWhatTheCommandLineWrites)
{
    loadSample();
    const TemporaryFolder folder("pelorin-gui-export");
    const std::string files = "'" + marketFile() + "' '" + walletFile() + "' --date 21/11/2024 --to all";
    for (const char* form : {"csv", "ledger", "beancount"})
        ASSERT_EQ(ToolRun(PELORIN_EXPORT, files + " --as " + form, folder).err, "");
    show(kCompanyPage);
    select("lstMarkets", 0);
    select("lstCompanies", 2);
    show(kCurrencyPage);
    select("lstCurrencies", 1);
    show(kPortoFolioPage);
    click("cbxComputeEvolution");
    show(kOperationPage);
    type("txtFilter", "EARM");
    static_cast<ColumnListView&>(list("lstOperations")).sortBy(0);
    static_cast<ColumnListView&>(list("lstOperations")).sortBy(0);
    const auto steps = window().changeSerial();

    const struct {
        Page page;
        const char* label;
        const char* whole; // what the command line has written
        const char* part;  // in the lines that are meant; all when it is empty
        const char* written;
        bool isSimulated; // the same while sales are simulated, which the command line leaves out
        bool isBackwards = false;
    } cases[] = {
        {kCompanyPage, "Quotes of EARM...", "quotes.csv", ",EARM,", "quotes of EARM", true},
        {kCompanyPage, "Events of EARM...", "events.csv", ",EARM,", "event", true},
        {kCompanyPage, "Companies of Paris...", "listing.csv", ",Paris,", "companies of Paris", true},
        {kCompanyPage, "All quotes...", "quotes.csv", "", "quotes written", true},
        {kCurrencyPage, "Rates of USD...", "rates.csv", ",USD,", "rates of USD", true},
        {kCurrencyPage, "All rates...", "rates.csv", "", "rates written", true},
        {kCurrencyPage, "Currencies...", "currencies.csv", "", "currencies", true},
        {kPortoFolioPage, "Holdings at 21/11/2024...", "holdings.csv", "", "holdings at 21/11/2024", false},
        {kPortoFolioPage, "Accounts at 21/11/2024...", "accounts.csv", "", "accounts at 21/11/2024", false},
        {kPortoFolioPage, "Evolution...", "evolution.csv", "", "days of the evolution", false},
        {kPortoFolioPage, "Journal for ledger and hledger...", "portfolio.ledger", "", "", true},
        {kPortoFolioPage, "Journal for Beancount...", "portfolio.beancount", "", "", true},
        {kOperationPage, "Operations shown...", "operations.csv", ",EARM,", "operations", true, true},
        {kOperationPage, "All operations...", "operations.csv", "", "operations", true},
        {kParameterPage, "Parameters...", "parameters.csv", "", "parameters", true},
    };
    const auto expectAll = [&](bool isSimulated) {
        const std::string place = isSimulated ? "simulated/" : "plain/";
        std::filesystem::create_directory(folder / place);
        for (const auto& c : cases) {
            if (isSimulated && !c.isSimulated)
                continue;
            Lines expected = linesOf(folder.content(std::string("all/") + c.whole));
            std::erase_if(expected, [&, head = expected.front()](const std::string& line) {
                return line != head && line.find(c.part) == line.npos;
            });
            if (c.isBackwards)
                std::reverse(expected.begin() + 1, expected.end());
            show(c.page);
            const std::string file = place + c.whole + c.part, count = countText(static_cast<int>(expected.size()) - 1);
            EXPECT_THAT(exportTo(folder / file, c.label),
                        HasSubstr(*c.written != 0 ? count + ' ' + c.written : "trans"));
            EXPECT_GT(expected.size(), 1U) << c.label;
            EXPECT_TRUE(linesOf(folder.content(file)) == expected) << c.label << ' ' << place;
        }
        show(kPortoFolioPage);
        // The second time over the tables of the first one.
        chooseExport("All tables into a folder...");
        answerPanel("SavePanel", folder / "folder");
        EXPECT_EQ(notice(), "11 tables written to folder");
        EXPECT_EQ(ToolRun("diff", "-r -x '*.ledger' -x '*.beancount' all folder", folder).out, "");
    };
    expectAll(false);
    show(kOperationPage);
    click("cbxPrevision");
    ASSERT_THAT(notice(), HasSubstr("simulated sales are in these figures"));
    expectAll(true);
    EXPECT_EQ(window().changeSerial(), steps);
    EXPECT_EQ(window().unsavedChanges(FileKind::kMarkets) + window().unsavedChanges(FileKind::kWallet), 0U);
}

TEST_F(ExportWindowTest, TheMenuOffersWhatThereIsAndEscapeLeavesIt)
{
    EXPECT_THAT(offered(kCompanyPage), ElementsAre("(Quotes of a company...)", "(Events of a company...)",
                                                   "(Companies of a market...)", "(All quotes...)"));
    EXPECT_THAT(offered(kCurrencyPage), ElementsAre("(Rates of a currency...)", "(All rates...)", "(Currencies...)"));
    EXPECT_THAT(offered(kOperationPage),
                ElementsAre("(Operations shown...)", "(All operations...)", "-", "Report on paper..."));
    EXPECT_THAT(offered(kParameterPage), ElementsAre("Parameters..."));
    EXPECT_THAT(offered(kPortoFolioPage),
                ElementsAre("(Holdings at 21/11/2024...)", "(Accounts at 21/11/2024...)", "(Evolution...)", "-",
                            "(All tables into a folder...)", "(Journal for ledger and hledger...)",
                            "(Journal for Beancount...)", "-", "Report on paper..."));
    loadSample();
    type("txtFilter", "USD");
    EXPECT_THAT(offered(kPortoFolioPage),
                ElementsAre("Holdings shown at 21/11/2024...", "Holdings at 21/11/2024...", "Accounts at 21/11/2024...",
                            "(Evolution...)", "-", "All tables into a folder...", "Journal for ledger and hledger...",
                            "Journal for Beancount...", "-", "Report on paper..."));
    enter("txtDate", "31/2/2024");
    EXPECT_THAT(offered(kPortoFolioPage), testing::Contains("(All tables into a folder...)"));
    EXPECT_THAT(offered(kOperationPage), testing::Contains("All operations..."));
    // What was chosen is gone when the panel answers.
    show(kCompanyPage);
    select("lstMarkets", 0);
    chooseExport("Companies of Paris...");
    window().RemoveAllCurrencies();
    answerPanel("SavePanel", folder() + "/gone.csv");
    EXPECT_EQ(notice(), "Not written: what was chosen is no longer shown");
    EXPECT_FALSE(std::filesystem::exists(folder() + "/gone.csv"));
}

TEST_F(ExportWindowTest, NothingIsReplacedUnaskedAndAFailureLeavesAllAsItWas)
{
    loadSample();
    const TemporaryFolder place("pelorin-gui-export");
    place.write("mine.csv", "mine");
    place.write("folder/quotes.csv", "mine");
    show(kParameterPage);
    for (const auto answer : {QMessageBox::No, QMessageBox::Yes}) {
        EXPECT_EQ(place.content("mine.csv"), "mine");
        chooseExport("Parameters...");
        QTimer::singleShot(100, [answer] {
            auto* question = qobject_cast<QMessageBox*>(QApplication::activeModalWidget());
            ASSERT_NE(question, nullptr);
            question->button(answer)->click();
        });
        auto* panel = qobject_cast<QFileDialog*>(QApplication::activeModalWidget());
        ASSERT_NE(panel, nullptr);
        auto* field = panel->findChild<QLineEdit*>("fileNameEdit");
        EXPECT_EQ(field->text().toStdString(), "parameters.csv");
        field->setText(QString::fromStdString(place / "mine")); // the ending is added
        QTest::keyClick(field, Qt::Key_Return);
        settle();
        panel->reject();
    }
    EXPECT_THAT(place.content("mine.csv"), testing::StartsWith("Parameter,Value\n"));
    EXPECT_EQ(notice(), "10 parameters written to mine.csv");

    // A folder that is selected in the list, and not named, is gone into.
    show(kPortoFolioPage);
    chooseExport("All tables into a folder...");
    auto* panel = qobject_cast<QFileDialog*>(QApplication::activeModalWidget());
    ASSERT_NE(panel, nullptr);
    panel->setDirectory(QString::fromStdString(place.path));
    auto* list = panel->findChild<QAbstractItemView*>("treeView");
    ASSERT_TRUE(QTest::qWaitFor([list] { return list->model()->rowCount(list->rootIndex()) > 0; }));
    list->setCurrentIndex(list->model()->index(0, 0, list->rootIndex()));
    ASSERT_EQ(list->currentIndex().data().toString(), "folder");
    QTest::mouseClick(panel->findChild<QDialogButtonBox*>("buttonBox")->buttons().front(), Qt::LeftButton);
    settle();
    EXPECT_TRUE(panel->isVisible());
    EXPECT_EQ(panel->directory().dirName(), "folder");
    panel->reject();

    const std::string market = contentOf(marketFile());
    const struct {
        Page page;
        std::string path;
        const char *label, *reason;
    } cases[] = {
        {kParameterPage, place / "none/new.csv", "Parameters...", "new.csv: "},
        {kParameterPage, place / "folder", "Parameters...", "folder: "},
        {kParameterPage, marketFile(), "Parameters...", "Sample is a file that is open here"},
        {kPortoFolioPage, walletFile(), "Journal for Beancount...", "Sample is a file that is open here"},
        {kPortoFolioPage, place / "mine.csv", "All tables into a folder...", "mine.csv: cannot be made: "},
        {kPortoFolioPage, place / "folder", "All tables into a folder...",
         "folder/quotes.csv: is there already, was not made by an export, and is left as it is"},
    };
    window().showNotice({"other", "a notice that waits for its time", {}});
    for (const auto& c : cases) {
        show(c.page);
        EXPECT_THAT(exportTo(c.path, c.label), HasSubstr(std::string("Not written: ") + c.reason)) << c.path;
    }
    EXPECT_TRUE(contentOf(marketFile()) == market);
    std::vector<std::string> left;
    for (const auto& file : std::filesystem::recursive_directory_iterator(place.path))
        left.push_back(file.path().filename());
    EXPECT_THAT(left, testing::UnorderedElementsAre("mine.csv", "folder", "quotes.csv"));
    EXPECT_EQ(place.content("folder/quotes.csv"), "mine");
    window().dropNotice("other");
    // A success takes the notice of the failure away.
    show(kPortoFolioPage);
    EXPECT_THAT(exportTo(place / "accounts.csv", "Accounts at 21/11/2024..."), HasSubstr("4 accounts"));
    press("txtNotice");
    EXPECT_EQ(notice(), "");
}

TEST_F(ExportWindowTest, TheReportOfAYearIsWhatTheCommandLineMakes)
{
    loadSample();
    show(kOperationPage);
    click("cbxPrevision"); // which is no part of it
    const TemporaryFolder place("pelorin-gui-report");
    const auto save = [&](const std::string& path) {
        DialogAnswers::current().panel = [&](const BFilePanel& panel) {
            EXPECT_EQ(panel.SaveText(), "Sample 2024-11-21.pdf");
            return path;
        };
        pressPart("btnSavePdf");
        return line("txtReport");
    };
    QTest::keyClick(&window().widget(), Qt::Key_P, Qt::ControlModifier);
    settle();
    ASSERT_NE(dialog(), nullptr);
    QTest::keyClicks(part<QWidget>("reportYear"), "2023");
    QTest::keyClicks(part<QWidget>("reportPaper"), "L");
    settle();
    const std::string market = contentOf(marketFile());
    EXPECT_EQ(save(marketFile()), "Not written: Sample is a file that is open here");
    EXPECT_TRUE(contentOf(marketFile()) == market);
    EXPECT_EQ(save(place / "window.pdf"), "Report written to window.pdf");
    pressPart("btnCloseReport");
    EXPECT_EQ(dialog(), nullptr);
    EXPECT_EQ(notice(), "Report written to window.pdf");

    const std::string files = "'" + marketFile() + "' '" + walletFile() + "'";
    ASSERT_EQ(
        ToolRun(PELORIN_REPORT, files + " --date 21/11/2024 --year 2023 --paper letter --out tool.pdf", place).err, "");
    const std::string text = ToolRun("pdftotext", "-layout tool.pdf -", place).out;
    EXPECT_THAT(text, HasSubstr("Operations of 2023"));
    EXPECT_EQ(ToolRun("pdftotext", "-layout window.pdf -", place).out, text);
}
