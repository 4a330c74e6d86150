// What a person does with lists: sorting, filtering, widening, copying, and their keys and menus.

#include "market/NoteCompanyEvent.h"
#include "tests/gui/CatalogueFixture.h"
#include "views/ColumnListView.h"

#include <QClipboard>
#include <QContextMenuEvent>
#include <QHelpEvent>
#include <QListView>
#include <QMenu>
#include <QTimer>
#include <QToolTip>

namespace {

using testing::ElementsAre;
using testing::HasSubstr;

constexpr uint32 kUndo = 'HUnd';
constexpr uint32 kRedo = 'HRed';

class ListTest : public CatalogueTest {
protected:
    ListTest()
    {
        addTwoMarkets();
        const auto& currencies = window().catalogue().getCurrencies();
        Account* bank = addAccount(wallet(), "Bank", currencies[1]);
        Account* main = addAccount(wallet(), "M\u00E9nage", currencies[1]);
        new DepositAccountOperation(Date(1, 2, 2023), bank, 2000, false);
        auto* moved = new TransferAccountOperation(Date(5, 3, 2024), bank, main, 1000, false);
        moved->setCost(10);
        new DepositAccountOperation(Date(6, 3, 2024), main, 300, false);
        new DepositAccountOperation(Date(4, 3, 2024), main, 50, false);
        showAccounts();
    }

    ColumnListView& columns(const char* name) { return static_cast<ColumnListView&>(list(name)); }
    QWidget& viewport(const char* name) { return *static_cast<QAbstractItemView*>(list(name).widget())->viewport(); }
    /// The widget of the list's heading, and the place in it of a column's right end.
    QWidget& heading(const char* name)
    {
        BView* list = &columns(name);
        int32 i = 0;
        while (list->Parent()->ChildAt(i) != list)
            ++i;
        return *list->Parent()->ChildAt(i - 1)->widget();
    }
    int endOf(const char* name, std::size_t column)
    {
        float end = -columns(name).LeftEdge();
        for (std::size_t i = 0; i <= column; ++i)
            end += columns(name).columns()[i].shownWidth();
        return static_cast<int>(end);
    }
    void clickHeading(const char* name, std::size_t column)
    {
        QTest::mouseClick(&heading(name), Qt::LeftButton, {}, {endOf(name, column) - 20, 9});
        settle();
    }
    /// One column of all rows that show.
    std::vector<std::string> column(const char* name, std::size_t column)
    {
        std::vector<std::string> texts;
        for (int32 i = 0; i < list(name).CountItems(); ++i)
            texts.push_back(static_cast<ColumnItem*>(list(name).ItemAt(i))->cell(column).text);
        return texts;
    }
    std::vector<std::string> dates() { return column("lstOperations", 0); }
    /// Chooses an item of the menu that comes up on a row.
    void chooseInMenu(const char* name, int32 row, const char* item, QStringList* labels = nullptr)
    {
        QTimer::singleShot(100, [=] {
            auto* menu = qobject_cast<QMenu*>(QApplication::activePopupWidget());
            ASSERT_NE(menu, nullptr);
            for (QAction* action : menu->actions()) {
                if (labels != nullptr)
                    *labels += action->text();
                if (action->text() == item)
                    menu->setActiveAction(action);
            }
            QTest::keyClick(menu, menu->activeAction() != nullptr ? Qt::Key_Return : Qt::Key_Escape);
        });
        auto* view = static_cast<QAbstractItemView*>(list(name).widget());
        const QPoint place = view->visualRect(view->model()->index(row, 0)).center();
        QTest::mouseClick(view->viewport(), Qt::RightButton, {}, place);
        QContextMenuEvent asked(QContextMenuEvent::Mouse, place, view->viewport()->mapToGlobal(place));
        QApplication::sendEvent(view->viewport(), &asked);
        settle();
    }
};

TEST_F(ListTest, AClickOnAHeadingSortsByValueThenTheOtherWayThenNoMore)
{
    const std::vector<std::string> inOrder = dates();
    ASSERT_THAT(inOrder, ElementsAre("01/02/2023", "05/03/2024", "04/03/2024", "06/03/2024")) << "account by account";
    select("lstOperations", 2);
    const char* expected[][4] = {{"50.00", "300.00", "1,000.00", "2,000.00"},
                                 {"2,000.00", "1,000.00", "300.00", "50.00"},
                                 {"2,000.00", "1,000.00", "50.00", "300.00"}};
    for (const auto& totals : expected) {
        clickHeading("lstOperations", 7);
        EXPECT_THAT(column("lstOperations", 7), testing::ElementsAreArray(totals));
        const int32 selected = list("lstOperations").CurrentSelection();
        EXPECT_EQ(column("lstOperations", 7).at(static_cast<std::size_t>(selected)), "50.00") << "it stays selected";
    }
    clickHeading("lstOperations", 0);
    EXPECT_THAT(dates(), ElementsAre("01/02/2023", "04/03/2024", "05/03/2024", "06/03/2024")) << "not as texts";
    addCurrency("Yen", "JPY");
    post(kUndo);
    post(kRedo); // which shows those that were not added by hand, too
    clickHeading("lstCurrencies", 0);
    addCurrency("Franc", "CHF");
    EXPECT_THAT(column("lstCurrencies", 1), ElementsAre("USD", "EUR", "CHF", "JPY"));
    EXPECT_TRUE(window().catalogue().getCurrencies()[3]->getRepresentation() == "CHF") << "an order of the view only";
    select("lstCurrencies", 3);
    answerNextAlert("Continue");
    click("btnRemoveCurrency");
    EXPECT_THAT(column("lstCurrencies", 1), ElementsAre("USD", "EUR", "CHF"));
    post(kUndo);
    EXPECT_THAT(column("lstCurrencies", 1), ElementsAre("USD", "EUR", "CHF", "JPY"));
    EXPECT_EQ(list("lstCurrencies").CurrentSelection(), 3) << "in a sorted list, too";
    QTest::keyClicks(list("lstCurrencies").widget(), "chf");
    settle();
    EXPECT_EQ(list("lstCurrencies").CurrentSelection(), 2) << "typing finds a row, by a later cell, too";
    alerts();
}

TEST_F(ListTest, FiltersCountWhatTheyShowAndHideNothingThatIsMade)
{
    const std::pair<const char*, int> cases[] = {
        {"MENAGE", 3}, {"m\u00C9n deposit", 2}, {"2000", 1}, {"2,000.00", 1}, {"05/03", 1}, {"nothing", 0}, {" ", 4},
    };
    for (const auto& [text, count] : cases) {
        type("txtFilter", text);
        EXPECT_EQ(list("lstOperations").CountItems(), count) << text;
    }
    type("txtFilter", "deposit");
    choose("filterYear", "2024");
    EXPECT_THAT(dates(), ElementsAre("04/03/2024", "06/03/2024"));
    select("lstOperations", 1);
    fill({{"txtAmount", "301"}});
    click("btnUpdateOperation");
    EXPECT_THAT(column("lstOperations", 7), ElementsAre("50.00", "301.00")) << "the filter stays";
    post(kUndo);
    EXPECT_THAT(column("lstOperations", 7), ElementsAre("50.00", "300.00"));
    EXPECT_EQ(list("lstOperations").CurrentSelection(), 1);
    fill({{"txtDate", "7/3/2022"}});
    click("btnAddOperation");
    EXPECT_EQ(list("lstOperations").CountItems(), 5) << "all show again, for one that they would hide";
    EXPECT_EQ(dates().at(static_cast<std::size_t>(list("lstOperations").CurrentSelection())), "07/03/2022");
    EXPECT_EQ(text("txtFilter"), "");
}

TEST_F(ListTest, OfSeveralRowsTheOneInTheFieldsStaysTheOneThatCommandsTake)
{
    select("lstOperations", 1);
    key(Qt::Key_Down, Qt::ShiftModifier);
    EXPECT_EQ(text("txtAmount"), "1000.00");
    clickHeading("lstOperations", 0); // the second one now stands above it
    EXPECT_EQ(list("lstOperations").CountSelected(), 1);
    click("btnRemoveOperation");
    EXPECT_THAT(dates(), ElementsAre("01/02/2023", "04/03/2024", "06/03/2024"));

    addMarket("Lyon", "EUR");
    addCompany("ZZ", "Zulu");
    fill({{"txtCompanyEventDate", "1/2/2024"}});
    click("btnAddCompanyEvent");
    ASSERT_EQ(rows("lstCompanyEvents").size(), 1U);
    addCompany("AA", "Aleph");
    select("lstCompanies", 0);
    select("lstCompanies", 1, true);
    clickHeading("lstCompanies", 0);
    EXPECT_EQ(list("lstCompanies").CountSelected(), 1);
    addQuote("1/3/2024", "10");
    addQuote("2/3/2024", "11");
    EXPECT_EQ(rows("lstQuotes").size(), 2U) << "of the company in the fields";
    select("lstCompanies", 0);
    EXPECT_EQ(rows("lstQuotes").size(), 0U);
    post(kUndo);
    EXPECT_EQ(text("txtName"), "Zulu");
    EXPECT_EQ(rows("lstCompanyEvents").size(), 1U);
}

TEST_F(ListTest, AHiddenRowIsNotAddedAgainByAnUpdate)
{
    select("lstOperations", 3);
    for (const char* hiding : {"1,000", "nothing"}) {
        type("txtFilter", hiding);
        EXPECT_EQ(list("lstOperations").CountSelected(), 0) << hiding;
        type("txtFilter", "");
        EXPECT_EQ(list("lstOperations").CurrentSelection(), 3) << hiding;
    }
    type("txtFilter", "nothing");
    fill({{"txtDate", "7/3/2024"}});
    click("btnUpdateOperation");
    EXPECT_THAT(dates(), ElementsAre("01/02/2023", "05/03/2024", "04/03/2024", "07/03/2024"));
    type("txtFilter", "1,000");
    select("lstOperations", 0);
    list("lstOperations").DeselectAll();
    type("txtFilter", "");
    EXPECT_EQ(list("lstOperations").CountSelected(), 0) << "another one was selected meanwhile";
}

TEST_F(ListTest, OneAccountShowsWhatItReceivesAndItsBalance)
{
    EXPECT_THAT(column("lstOperations", 8), ElementsAre("2,000.00", "-1,000.00", "50.00", "300.00"));
    choose("filterAccount", "M\u00E9nage");
    EXPECT_THAT(dates(), ElementsAre("04/03/2024", "05/03/2024", "06/03/2024"));
    EXPECT_THAT(column("lstOperations", 3), ElementsAre("", "from Bank", ""));
    EXPECT_THAT(column("lstOperations", 8), ElementsAre("50.00", "990.00", "300.00"));
    EXPECT_THAT(column("lstOperations", 9), ElementsAre("50.00", "1,040.00", "1,340.00"));
    clickHeading("lstOperations", 0);
    clickHeading("lstOperations", 0);
    EXPECT_THAT(column("lstOperations", 9), ElementsAre("1,340.00", "1,040.00", "50.00"));
    QTest::keyClick(list("lstOperations").widget(), Qt::Key_A, Qt::ControlModifier);
    QTest::keyClick(list("lstOperations").widget(), Qt::Key_C, Qt::ControlModifier);
    settle();
    EXPECT_EQ(QApplication::clipboard()->text().toStdString(),
              "06/03/2024\tDeposit\t\t\t300.00\t\t300.00\tEUR\t300.00\tEUR\t1340.00\tEUR\n"
              "05/03/2024\tTransfer\tfrom Bank\t\t1000.00\t10.00\t1000.00\tEUR\t990.00\tEUR\t1040.00\tEUR\n"
              "04/03/2024\tDeposit\t\t\t50.00\t\t50.00\tEUR\t50.00\tEUR\t50.00\tEUR");
    EXPECT_EQ(text("txtAmount"), "300.00") << "of several, commands take the first";
    show(kPortoFolioPage);
    EXPECT_EQ(rows("lstAccounts")[1], "M\u00E9nage\t1,340.00\tEUR\t");

    show(kOperationPage);
    choose("filterAccount", "All accounts");
    EXPECT_EQ(columns("lstOperations").columns()[9].isHidden, true);
    show(kPortoFolioPage);
    select("lstAccounts", 0);
    answerNextAlert("Continue");
    click("btnRemoveQuote");
    show(kOperationPage);
    EXPECT_EQ(columns("lstOperations").columns()[9].isHidden, false) << "of the only account";
}

TEST_F(ListTest, SeparatorsWidenAndCutTextsShowInAToolTip)
{
    const auto widthOf = [this](std::size_t i) { return columns("lstOperations").columns()[i].width; };
    const float former = widthOf(3);
    const QPoint separator(endOf("lstOperations", 3), 9);
    QWidget& bar = heading("lstOperations");
    QTest::mousePress(&bar, Qt::LeftButton, {}, separator);
    QTest::mouseMove(&bar, separator - QPoint(70, 0));
    QTest::mouseRelease(&bar, Qt::LeftButton, {}, separator - QPoint(70, 0));
    EXPECT_EQ(widthOf(3), former - 70);
    EXPECT_EQ(dates().front(), "01/02/2023") << "that is no click on a heading";
    columns("lstOperations").setColumnWidth(5, 40);
    QTest::mouseMove(&bar, {endOf("lstOperations", 5) - 20, 9});
    EXPECT_EQ(bar.toolTip(), "Quote/Amount");
    const QPoint what(endOf("lstOperations", 3) - 10, 27);
    QHelpEvent asked(QEvent::ToolTip, what, viewport("lstOperations").mapToGlobal(what));
    QApplication::sendEvent(&viewport("lstOperations"), &asked);
    EXPECT_THAT(QToolTip::text().toStdString(), HasSubstr("to M\u00E9nage"));
    for (int i = 0; i < 2; ++i) // a double click
        QTest::mouseClick(&bar, Qt::LeftButton, {}, {endOf("lstOperations", 3), 9});
    EXPECT_GT(widthOf(3), former - 70);
    EXPECT_EQ(columns("lstOperations").ToolTipAt({static_cast<float>(what.x()), 27}, 1), "");
}

TEST_F(ListTest, KeysAndMenusOfRowsDoWhatTheButtonsDo)
{
    select("lstOperations", 3);
    key(Qt::Key_F2);
    EXPECT_EQ(focus(), "txtDate");
    ctrl(Qt::Key_F);
    EXPECT_EQ(focus(), "txtFilter");
    QTest::keyClicks(QApplication::focusWidget(), "deposit");
    EXPECT_EQ(list("lstOperations").CountItems(), 3);
    key(Qt::Key_Escape);
    EXPECT_EQ(focus(), "lstOperations");
    EXPECT_EQ(list("lstOperations").CountItems(), 4);
    key(Qt::Key_Delete);
    key(Qt::Key_Delete); // nothing is selected any more
    EXPECT_EQ(list("lstOperations").CountItems(), 3);
    select("lstOperations", 0);
    key(Qt::Key_Down, Qt::ShiftModifier);
    EXPECT_EQ(list("lstOperations").CountSelected(), 2);
    click("btnRemoveOperation");
    EXPECT_EQ(list("lstOperations").CountItems(), 2);
    EXPECT_EQ(list("lstOperations").CountSelected(), 0) << "of the second one nothing is in the fields";
    post(kUndo);
    QStringList labels;
    chooseInMenu("lstOperations", 2, "Remove", &labels);
    EXPECT_EQ(labels.join('|').toStdString(), "Edit|Update|Remove|Copy|Select All");
    EXPECT_THAT(dates(), ElementsAre("01/02/2023", "05/03/2024"));
    addMarket("Lyon", "EUR");
    answerNextAlert("Cancel");
    select("lstMarkets", 0);
    key(Qt::Key_Delete);
    EXPECT_EQ(alerts().size(), 1U);
    chooseInMenu("lstMarkets", 0, "Edit");
    EXPECT_EQ(focus(), "txtMarketName");
}

TEST_F(ListTest, HoldingsShowTheirPartAndHaveTheRoomOfAChartThatIsNotAskedFor)
{
    buy(beta()); // 10 at 11 from 02/03/2024; they quote at 10
    show(kPortoFolioPage);
    EXPECT_EQ(column("lstShares", 7).at(0), "100.00");
    EXPECT_EQ(column("lstShares", 8).at(0), "4.3%") << "of 2,340 in cash, less 110, and 100";
    EXPECT_LE(endOf("lstShares", 9), list("lstShares").widget()->width() - 16) << "room up to the gain";
    for (std::size_t i = 0; i < 10; ++i) {
        QTest::mouseMove(&heading("lstShares"), {endOf("lstShares", i) - 20, 9});
        EXPECT_EQ(heading("lstShares").toolTip(), "") << i << ": no title is cut";
    }
    const int former = list("lstShares").widget()->height();
    click("cbxComputeEvolution");
    EXPECT_LT(list("lstShares").widget()->height(), former);
    type("txtFilter", "alpha");
    EXPECT_EQ(list("lstShares").CountItems(), 0);

    // In dollars, half a euro each: 10 bought at 11, 4 sold at 12, each at 1 and 0.17 %, and 6 left, at 8 then.
    constexpr int kBought = 9191; // days after the start: 01/03/2024
    Company* alpha = window().catalogue().getMarkets()[0]->companies().front();
    Account* dollars = addAccount(wallet(), "Dollars", alpha->market()->currency());
    auto* share = new Share(&wallet(), alpha);
    new CompanyQuote(alpha, daysAfterStart(kBought), 8);
    trade(share, dollars, kBought, 10, 11, 1);
    trade(share, dollars, kBought + 1, -4, 12, 1);
    transfer(dollars, dollars, kBought + 2, 0)->setCost(-30);
    new NoteCompanyEvent(alpha, daysAfterStart(kBought + 2), "Dividend", "30.00 USD to Dollars");
    window().UpdateState();
    EXPECT_EQ(
        rows("lstShares").at(0),
        "AAA\tAlpha\t6\t11.00\t8.00\t01/03/2024\t48.00 USD\t24.00\t1.0%\t-27.3%\t110.00 USD\t48.00 USD\t2.27 USD\t"
        "30.00 USD\t4.00 USD\t-18.00 USD\t55.00\t24.00\t1.13\t15.00\t2.00\t-9.00");
}

} // namespace
