#include "platform/Entry.h"
#include "platform/Message.h"
#include "tests/gui/CatalogueFixture.h"

#include <filesystem>
#include <fstream>

using testing::Contains;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::StartsWith;

namespace {

/// The window of an import, worked by events as the other one is.
class ImportWindowTest : public CatalogueTest {
protected:
    using Answers = std::vector<std::pair<const char*, const char*>>; // menus or fields, with what is chosen there

    static bool canImport() { return part<QWidget>("btnImport")->isEnabled(); }
    /// Chooses by keys, each of which counts.
    static void answer(const char* name, const std::string& item)
    {
        if (std::string_view(name).starts_with("txt")) {
            part<QLineEdit>(name)->setText("");
            QTest::keyClicks(part<QLineEdit>(name), QString::fromStdString(item));
            QTest::keyClick(part<QLineEdit>(name), Qt::Key_Return);
            return settle();
        }
        ASSERT_NE(part<QComboBox>(name), nullptr) << name;
        const int index = part<QComboBox>(name)->findText(QString::fromStdString(item), Qt::MatchStartsWith);
        ASSERT_GE(index, 0) << name << " has no " << item;
        while (part<QComboBox>(name)->currentIndex() != index) {
            auto* menu = part<QComboBox>(name);
            QTest::keyClick(menu, menu->currentIndex() < index ? Qt::Key_Down : Qt::Key_Up);
            settle();
        }
    }
    static void answer(const Answers& answers)
    {
        for (const auto& [name, item] : answers)
            answer(name, item);
    }
    std::string file(const std::string& name, const std::string& text)
    {
        const std::string path = folder() + '/' + name;
        std::ofstream(path, std::ios::binary) << text;
        return path;
    }
    void open(Page page, const std::string& path)
    {
        show(page);
        press("btnImportTable");
        answerPanel("OpenPanel", path);
        if (dialog() != nullptr)
            QApplication::setActiveWindow(dialog());
    }
    /// The import of what the window shows is one step, which leads back and on to the same bytes.
    void importAndReturn(
        const std::string& before, const std::string& label, const std::function<void()>& look = [] {})
    {
        EXPECT_EQ(bytes(), before) << "changed by looking at it";
        const auto steps = window().changeSerial();
        ASSERT_TRUE(canImport()) << line("txtImportNote");
        pressPart("btnImport");
        ASSERT_EQ(dialog(), nullptr);
        EXPECT_EQ(window().changeSerial(), steps + 1);
        EXPECT_EQ(window().history().undoLabel(), label);
        const std::string after = bytes();
        EXPECT_NE(after, before);
        look(); // at what the pages show
        press("btnUndo");
        EXPECT_EQ(bytes(), before);
        press("btnRedo");
        EXPECT_EQ(bytes(), after);
    }
    void addCatalogueAndCash()
    {
        addSmallCatalogue();
        addAccount(wallet(), "Cash", window().getReferenceCurrency());
        window().showWallet();
        window().noteStep();
    }
};

} // namespace

TEST_F(ImportWindowTest, AStatementIsAssignedShownAndBookedInOneStepAndRememberedForTheNext)
{
    addCatalogueAndCash();
    // Neither the heading of the dates nor the word for a charge is known, nor the second account there.
    const std::string head = "Bank\nTag;Typ;Depot;Symbol;Stück;Kurs;Summe\n";
    const std::string before = bytes();
    open(kOperationPage, file("may.csv", head + "2.5.2024;Einzahlung;;;;;1.000,00\n3.5.2024;Kauf;;AL;10;20,50;\n"
                                                "4.5.2024;Spende;;;;;7,50\n5.5.2024;Einzahlung;Notgroschen;;;;5,00\n"
                                                "6.5.2024;Gabe;;;;;1,00\n"));
    ASSERT_NE(dialog(), nullptr);
    constexpr int kLow = 400; // of a small screen, for this sheet and those that follow
    BWindow::newest()->GiveWay(static_cast<float>(dialog()->width()), kLow);
    EXPECT_EQ(dialog()->height(), kLow);
    EXPECT_THAT(line("txtImportNote"),
                StartsWith("No line has the headings of a statement: there is no column for date"));
    EXPECT_FALSE(canImport());
    EXPECT_THAT(table("lstImport"), ElementsAre());
    answer({{"importColumn", "Date"}, {"importHeading", "Tag"}, {"importAccount", "Cash"}});
    EXPECT_THAT(line("txtImport"), HasSubstr("2 new operations, 0 already there, 3 refused"));
    EXPECT_THAT(table("lstImport"),
                ElementsAre("Refused\t5\t4.5.2024\tSpende\t\t\t\t7,50\tthe type \"Spende\" is not known",
                            "Refused\t6\t5.5.2024\tEinzahlung\tNotgroschen\t\t\t5,00\tthere is no account "
                            "\"Notgroschen\"",
                            "Refused\t7\t6.5.2024\tGabe\t\t\t\t1,00\tthe type \"Gabe\" is not known",
                            "New\t3\t02/05/2024\tDeposit\tCash\t\t\t1,000.00\t",
                            "New\t4\t03/05/2024\tBuy\tCash\tAL\t10\t20.50\t",
                            "Passed over\t1\t\t\t\t\t\t\tbefore the headings: Bank"));
    EXPECT_THAT(line("txtImportNote"), HasSubstr("choose what they leave open"));
    // On the way to the last type each key is an answer, for the word that is shown.
    answer({{"importType", "Charge"}, {"importCurrency", "EUR"}, {"importWord", "Gabe"}, {"importType", "Income"}});
    EXPECT_THAT(line("txtImport"), HasSubstr("5 new operations, 0 already there, 0 refused"));
    EXPECT_THAT(table("lstImportCash"), ElementsAre("Cash\tEUR\t0.00\t788.15", "Notgroschen\tEUR\t0.00\t5.00"));
    EXPECT_GE(part<QAbstractItemView>("lstImport")->viewport()->height(), 3 * 18);
    const auto* import = part<QWidget>("btnImport");
    EXPECT_EQ(import->visibleRegion().boundingRect(), import->rect());
    importAndReturn(before, "Import operations from may.csv");
    show(kOperationPage);
    EXPECT_THAT(rows("lstOperations"), Contains(HasSubstr("Charge")));
    EXPECT_EQ(wallet().accounts().size(), 2U);

    EXPECT_EQ(window().unsavedChanges(FileKind::kWallet), 2U); // with the account

    // Of the next table all is known, and one of its lines is there already.
    open(kPortoFolioPage, file("june.csv", head + "4.5.2024;Spende;;;;;7,50\n5.6.2024;Spende;;;;;1,00\n"));
    EXPECT_THAT(line("txtImportNote"), HasSubstr("as for may"));
    EXPECT_THAT(line("txtImport"), HasSubstr("1 new operation, 1 already there, 0 refused"));
    pressPart("btnImport");
    EXPECT_THAT(notice(), HasSubstr("Imported 1 operation from june.csv; 1 line already there"));
}

TEST_F(ImportWindowTest, NothingIsBookedUnlessAPersonSaysSoForWhatIsThere)
{
    addCatalogueAndCash();
    const std::string before = bytes();
    const std::string path =
        file("s.csv", "Date,Type,Account,Amount\n2024-05-02,Deposit,Cash,5\n2024-05-03,Deposit,Cash,no\n");
    open(kOperationPage, path);
    // With a refused line the keyboard is at Cancel, and the others take a tick.
    EXPECT_FALSE(canImport());
    EXPECT_THAT(part<QWidget>("btnImport")->toolTip().toStdString(), HasSubstr("while lines are refused"));
    QTest::keyClick(dialog()->focusWidget(), Qt::Key_Return);
    settle();
    ASSERT_EQ(dialog(), nullptr);
    open(kOperationPage, path);
    pressPart("cbxImportOthers");
    EXPECT_TRUE(canImport());
    QTest::keyClick(dialog()->focusWidget(), Qt::Key_Escape);
    settle();
    ASSERT_EQ(dialog(), nullptr);
    EXPECT_EQ(bytes(), before);

    // What is not as it was when it was shown is left alone.
    open(kOperationPage, path);
    pressPart("cbxImportOthers");
    window().PostMessage('HUnd'); // takes back the account
    settle();
    const std::string undone = bytes();
    ASSERT_NE(undone, before);
    pressPart("btnImport");
    EXPECT_EQ(bytes(), undone);
    EXPECT_THAT(notice(), HasSubstr("have changed meanwhile"));
    press("btnRedo");
    open(kOperationPage, path);
    pressPart("cbxImportOthers");
    importAndReturn(before, "Import operations from s.csv");
}

TEST_F(ImportWindowTest, PricesAndRatesComeInWithAllThatIsNew)
{
    addSmallCatalogue();
    show(kCompanyPage);
    select("lstMarkets", 0);
    select("lstCompanies", 0);
    const std::string before = bytes();
    open(kCompanyPage, file("prices.csv", "Tag;Ticker;Schluss;Market;Currency\n2024-03-01;AL;11;Paris;EUR\n"
                                          "2024-03-06;AL;12,5;Paris;EUR\n2024-03-07;NEU;5;Zürich;CHF\n"));
    answer(
        {{"importColumn", "Date"}, {"importHeading", "Tag"}, {"importColumn", "Price"}, {"importHeading", "Schluss"}});
    EXPECT_THAT(line("txtImportNote"),
                HasSubstr("No rate of \"CHF\", in which \"NEU\" is quoted: import its rates first"));
    EXPECT_FALSE(canImport());
    pressPart("btnCancel");
    EXPECT_EQ(bytes(), before);

    // The page says what a table without headings is of; the second line is none.
    open(kCurrencyPage, file("rates.csv", "2024-01-01,CHF,2\n2024-01-02,CHF,x\n2024-01-03,USD,3\n"));
    EXPECT_THAT(table("lstImport"),
                ElementsAre(StartsWith("Refused\t2\t\t\t\t\t\t\t\"x\" is no positive number"),
                            "New\t\tCurrency\tCHF\t\t\t\t\t", StartsWith("New\t\tRates\tCHF\t\t1\t0\t0"),
                            StartsWith("Changed\t\tRates\tUSD\t\t1\t0\t0"),
                            StartsWith("Changed\t\tRates\tEUR\t\t1\t0\t1")));
    answer("importRates", "EUR for one unit");
    importAndReturn(before, "Import rates from rates.csv",
                    [this] { EXPECT_THAT(rows("lstQuotes"), ElementsAre("01/01/2024\t2.00", "03/01/2024\t3.00")); });
    EXPECT_EQ(window().getCurrencyByRepresentation("CHF")->quotes().back()->getValue(), 2);

    const std::string withRates = bytes();
    open(kCompanyPage, folder() + "/prices.csv");
    answer(
        {{"importColumn", "Date"}, {"importHeading", "Tag"}, {"importColumn", "Price"}, {"importHeading", "Schluss"}});
    EXPECT_THAT(line("txtImport"), HasSubstr("1 new, 1 changed, 1 equal quotes, 0 lines refused"));
    EXPECT_THAT(table("lstImport"),
                ElementsAre("New\t\tMarket\tZürich\tCHF\t\t\t\t",
                            "Changed\t\tCompany\tAL\tParis, EUR\t0\t1\t1\tlast: 11.00 on 01/03/2024",
                            "New\t\tCompany\tNEU\tZürich, CHF\t1\t0\t0\tlast: 5.00 on 07/03/2024"));
    // A click from a field that was typed in shows first what that changes.
    part<QLineEdit>("txtImportMarket")->setFocus();
    QTest::keyClicks(part<QLineEdit>("txtImportMarket"), "X");
    pressPart("btnImport");
    ASSERT_NE(dialog(), nullptr);
    importAndReturn(withRates, "Import quotes from prices.csv", [this] {
        EXPECT_THAT(rows("lstMarkets"), Contains(StartsWith("Zürich")));
        EXPECT_THAT(rows("lstQuotes"), Contains("01/03/2024\t11.00"));
    });
}

TEST_F(ImportWindowTest, AnEmptyCatalogueGetsItsReferenceFromAnImport)
{
    open(kCompanyPage, file("ALP.csv", "Date,Close\n2024-01-02,40\n"));
    EXPECT_THAT(line("txtImportNote"), HasSubstr("or make it the reference currency"));
    answer({{"txtImportReference", "USD"}, {"txtImportMarket", "New York"}});
    importAndReturn(bytes(), "Import quotes from ALP.csv");
    ASSERT_EQ(window().catalogue().getMarkets().size(), 1U);
    EXPECT_EQ(window().catalogue().getMarkets()[0]->companies()[0]->getAbbreviation().bytes(), "ALP");
    EXPECT_EQ(window().getReferenceCurrency()->getRepresentation().bytes(), "USD");
    // Of a wide table the date has to be told, or its prices would pass for tickers.
    open(kCompanyPage, file("wide.csv", "Tag;AAA;BBB\n2024-01-02;40,5;50\n"));
    EXPECT_FALSE(canImport()) << line("txtImport");
    answer("importHeading", "Tag");
    EXPECT_THAT(line("txtImport"), HasSubstr("2 new, 0 changed, 0 equal quotes"));
    pressPart("btnCancel");
    show(kParameterPage);
    EXPECT_FALSE(anywhere("btnImportTable").isEnabled());
}

TEST_F(ImportWindowTest, AFileThatCannotBeReadIsToldAndChangesNothing)
{
    const std::string before = bytes();
    const struct {
        std::string bytes;
        const char* told;
    } cases[] = {
        {"", "no "},
        {std::string("D\0a\0t\0e\0\n\0", 10), "zero byte"},
        {"Date,Type,Amount\n2024-01-02,\"Deposit\n", "quote"},
    };
    for (const auto& c : cases)
        for (const Page page : {kCompanyPage, kOperationPage}) {
            open(page, file("bad.csv", c.bytes));
            if (dialog() != nullptr) {
                EXPECT_THAT(line("txtImportNote"), HasSubstr(c.told));
                EXPECT_FALSE(canImport());
                pressPart("btnCancel");
            } else {
                EXPECT_THAT(notice(), HasSubstr("bad.csv")) << c.told;
                EXPECT_THAT(notice(), HasSubstr(c.told));
            }
            EXPECT_EQ(bytes(), before);
        }
    for (const Page page : {kCompanyPage, kOperationPage}) {
        const std::string path = file("gone.csv", "Date,Type,Amount,Close\n1/2/2024,Deposit,5,3\n");
        open(page, path);
        std::filesystem::remove(path);
        answer(page == kCompanyPage ? "importKind" : "importDates", page == kCompanyPage ? "exchange" : "with the day");
        EXPECT_THAT(line("txtImportNote"), HasSubstr("No such file"));
        EXPECT_FALSE(canImport());
        pressPart("btnCancel");
    }
    const std::filesystem::path place(folder());
    const entry_ref ref{place.parent_path(), place.filename()};
    BMessage message(ImportAssistant::kChosen);
    message.AddRef("refs", &ref);
    window().OpenImport(&message);
    EXPECT_EQ(dialog(), nullptr);
    EXPECT_THAT(notice(), HasSubstr("Not imported"));
}
