// The built program on a real X server, by real mouse and key events alone: a portfolio from an empty window, by hand.

#include "net/QuoteServers.h"
#include "tests/gui/RealProgram.h"
#include "tests/gui/WindowFixture.h"
#include "tests/support/ServerRun.h"
#include "tests/support/ToolRun.h"

#include <QTabBar>

#include <csignal>
#include <filesystem>
#include <optional>

namespace {

namespace fs = std::filesystem;

/// A window of the test tells where the controls stand in that of the program, which has a home of its own.
class EndToEndTest : public WindowTest {
protected:
    EndToEndTest() { start(); }
    void start() { program_.emplace(PELORIN_PROGRAM, home_.path.string()); }

    QPoint place(Page page, const char* name)
    {
        show(page);
        auto& control = find<QWidget>(name);
        return control.mapTo(&window().widget(), control.rect().center());
    }
    void showInProgram(Page page)
    {
        const auto* bar = window().widget().findChild<QTabBar*>();
        program_->click(bar->mapTo(&window().widget(), bar->tabRect(page).center()));
    }
    /// Types into fields of the page that is shown, and presses a button.
    void fillIn(Page page, const Fields& fields, const char* button)
    {
        for (const auto& [field, text] : fields) {
            program_->click(place(page, field));
            program_->key("ctrl+a");
            program_->type(text);
        }
        program_->click(place(page, button));
    }
    /// Chooses the item of a menu that begins with `letter`.
    void pick(const char* menu, const std::string& letter)
    {
        program_->click(place(kOperationPage, menu));
        program_->key(letter + " Return");
    }
    void addOperation(const char* typeLetter, const Fields& fields)
    {
        pick("operationType", typeLetter);
        pick("baseAccount", "c");
        if (*typeLetter == 't')
            pick("transferAccount", "r");
        fillIn(kOperationPage, fields, "btnAddOperation");
    }
    void answerPanelIn(const char* title)
    {
        program_->awaitWindow(title);
        program_->type("Own");
        program_->key("Return");
        program_->awaitNoWindow(title);
    }

    void makeCatalogue()
    {
        const struct {
            Page page;
            Fields fields;
            const char* button;
        } steps[] = {
            {kCurrencyPage, {{"txtCurrencyName", "Euro"}, {"txtCurrencyRepresentation", "EUR"}}, "btnAddCurrency"},
            {kCurrencyPage, {{"txtQuoteDate", "1/1/2024"}, {"txtQuoteValue", "1"}}, "btnAddQuote"},
            {kCompanyPage, {{"txtMarketName", "Paris"}, {"txtMarketCurrencyRepresentation", "EUR"}}, "btnAddMarket"},
            {kCompanyPage, {{"txtAbbreviation", "ACME"}, {"txtName", "Acme"}}, "btnAddCompany"},
            {kCompanyPage, {{"txtQuoteDate", "1/3/2024"}, {"txtQuoteValue", "10"}}, "btnAddQuote"},
            {kCompanyPage, {{"txtQuoteDate", "30/6/2024"}, {"txtQuoteValue", "13"}}, "btnAddQuote"},
        };
        for (const auto& step : steps) {
            showInProgram(step.page);
            fillIn(step.page, step.fields, step.button);
        }
        fillIn(kCompanyPage, {}, "btnSaveMarket");
        answerPanelIn("Save");
    }
    void makePortfolio()
    {
        showInProgram(kPortoFolioPage);
        for (const char* name : {"Cash", "Reserve"})
            fillIn(kPortoFolioPage, {{"txtAccountName", name}, {"txtAccountCurrency", "EUR"}}, "btnAddAccount");
        showInProgram(kOperationPage);
        addOperation("d", {{"txtDate", "1/1/2024"}, {"txtAmount", "10000"}});
        addOperation("b", {{"txtDate", "1/3/2024"},
                           {"txtMarketName", "Paris"},
                           {"txtCompanyAbbreviation", "ACME"},
                           {"txtQuantity", "100"},
                           {"txtQuote", "10"},
                           {"txtShareCost", "5"}});
        // The market, the company and the cost stay in their fields.
        addOperation("s", {{"txtDate", "1/6/2024"}, {"txtQuantity", "40"}, {"txtQuote", "12"}});
        addOperation("t", {{"txtDate", "2/6/2024"}, {"txtAmount", "500"}});
        showInProgram(kPortoFolioPage);
        fillIn(kPortoFolioPage, {}, "btnSavePortoFolio");
        answerPanelIn("Save");
    }
    void load()
    {
        showInProgram(kCompanyPage);
        fillIn(kCompanyPage, {}, "btnLoadMarket");
        answerPanelIn("Load");
        showInProgram(kPortoFolioPage);
        fillIn(kPortoFolioPage, {}, "btnLoadPortoFolio");
        program_->awaitWindow("Warning");
        program_->key("Tab Return"); // Continue
        answerPanelIn("Load");
    }
    /// The portfolio's value when it is not `before`.
    std::string totalOn(const std::string& date, const std::string& before)
    {
        fillIn(kPortoFolioPage, {{"txtDate", date.c_str()}}, "txtTotalValue");
        return program_->textOtherThan(before, place(kPortoFolioPage, "txtTotalValue"));
    }

    const TemporaryFolder home_{"pelorin-home"};
    std::optional<RealProgram> program_;
};

TEST_F(EndToEndTest, EmptyWindowToAPortfolioThatIsThereAfterARestartAndGetsQuotes)
{
    // 10,000 deposited; 100 bought at 10 and 40 sold at 12, each with 0.17 % and 5: 9,467.48 in cash, and 60 shares
    // at 13. The transfer moves cash from one account to the other.
    const std::string deposited = "10,000.00 EUR", expected = "10,247.48 EUR";
    makeCatalogue();
    makePortfolio();
    EXPECT_EQ(totalOn("1/1/2024", ""), deposited);
    EXPECT_EQ(totalOn("30/6/2024", deposited), expected);
    EXPECT_EQ(program_->quit(), 0);

    start();
    load();
    const std::string today = program_->textAt(place(kPortoFolioPage, "txtDate"));
    EXPECT_EQ(totalOn("1/1/2024", ""), deposited);
    EXPECT_EQ(totalOn("30/6/2024", deposited), expected);
    EXPECT_EQ(program_->textAt(place(kPortoFolioPage, "txtTotalDeposit")), deposited);

    home_.write("quotes/ACME.csv", "Date,Close\n2024-11-21,100\n");
    const ServerRun server(PELORIN_QUOTES, home_ / "quotes", quoteServers().port);
    if (server.address().empty())
        GTEST_SKIP() << "port " << quoteServers().port << " is taken, so the built program cannot be served";
    const std::string before = totalOn(today, expected);
    fillIn(kPortoFolioPage, {}, "btnUpdateAllQuotes");
    // Read when the fetches are through: a program that waits for them gives no text.
    EXPECT_EQ(program_->textOtherThan("", place(kPortoFolioPage, "txtTotalValue")), before) << "as it was valued";
    fillIn(kPortoFolioPage, {}, "cbxComputeEvolution"); // values it anew
    EXPECT_EQ(program_->textOtherThan(before, place(kPortoFolioPage, "txtTotalValue")), "15,467.48 EUR");
    EXPECT_EQ(program_->quit(), 0);
}

TEST_F(EndToEndTest, HoweverTheSessionEndsThereIsACopyOfWhatIsNotSaved)
{
    std::ptrdiff_t ends = 0;
    for (const int signal : {SIGTERM, SIGHUP, SIGINT, 0}) {
        SCOPED_TRACE(signal);
        start();
        showInProgram(kCurrencyPage);
        fillIn(kCurrencyPage, {{"txtCurrencyName", "Euro"}, {"txtCurrencyRepresentation", "EUR"}}, "btnAddCurrency");
        if (signal == SIGHUP) { // nobody is left to answer
            fillIn(kCurrencyPage, {}, "btnLoadMarket");
            program_->awaitWindow("Warning");
        }
        program_->end(signal);
        const fs::directory_iterator copies(home_.path / "Documents/Pelorin/Backups/Unsaved/Companies");
        EXPECT_EQ(std::distance(begin(copies), end(copies)), ++ends) << "and the others stay";
    }
}

} // namespace
