// The window itself, the portfolio page and the parameter page.

#include "app/MessageView.h"
#include "chart/GraphLine.h"
#include "chart/GraphView.h"
#include "market/Company.h"
#include "market/Currency.h"
#include "market/Market.h"
#include "platform/ListView.h"
#include "platform/Message.h"
#include "platform/StringView.h"
#include "platform/TabView.h"
#include "platform/WindowWidget.h"
#include "portfolio/Account.h"
#include "portfolio/Share.h"
#include "portfolio/Wallet.h"
#include "tests/gui/WindowFixture.h"
#include "valuation/State.h"
#include "views/DateText.h"

#include <QAbstractButton>
#include <QAbstractItemView>
#include <QComboBox>
#include <QLineEdit>
#include <QPixmap>
#include <QPlainTextEdit>
#include <QTabBar>
#include <QTest>
#include <gmock/gmock.h>

namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::SizeIs;

class MainWindowTest : public WindowTest {};

TEST_F(MainWindowTest, OpensEmptyOnTodayWithFiveTabs)
{
    EXPECT_STREQ(window().Title(), "Pelorin");
    EXPECT_EQ(window().widget().size(), QSize(800, 800));
    EXPECT_EQ(window().widget().minimumSize(), window().widget().maximumSize());
    auto* tabs = static_cast<BTabView*>(window().FindView("TabView"));
    std::vector<std::string> labels;
    for (int32 i = 0; i < tabs->CountTabs(); ++i)
        labels.emplace_back(tabs->TabAt(i)->Label());
    EXPECT_THAT(labels, ElementsAre("Company", "Currency", "PortoFolio", "Operations", "Parameters"));
    EXPECT_EQ(message(), "No Company...");
    show(kPortoFolioPage);
    EXPECT_EQ(text("txtDate"), "21/11/2024");
    EXPECT_EQ(text("txtTotalValue"), "") << "without a reference currency nothing is shown";
}

TEST_F(MainWindowTest, EveryControlHasANameForTestsAndForAssistiveTools)
{
    for (const Page page : {kCompanyPage, kCurrencyPage, kPortoFolioPage, kOperationPage, kParameterPage}) {
        show(page);
        for (const QWidget* widget : window().widget().findChildren<QWidget*>()) {
            const bool isControl = qobject_cast<const QAbstractButton*>(widget) != nullptr ||
                                   qobject_cast<const QLineEdit*>(widget) != nullptr ||
                                   qobject_cast<const QComboBox*>(widget) != nullptr ||
                                   qobject_cast<const QPlainTextEdit*>(widget) != nullptr ||
                                   qobject_cast<const QAbstractItemView*>(widget) != nullptr;
            if (!isControl || !widget->isVisible() || widget->parentWidget()->inherits("QTabBar"))
                continue;
            const std::string name = widget->objectName().toStdString();
            EXPECT_NE(name, "") << "on page " << page;
            EXPECT_NE(widget->accessibleName().toStdString(), "") << name;
            EXPECT_NE(widget->focusPolicy() & Qt::TabFocus, 0) << name;
        }
    }
}

TEST_F(MainWindowTest, KeysWalkThroughTheTabs)
{
    auto* tabs = static_cast<BTabView*>(window().FindView("TabView"));
    QTest::keyClick(&window().widget(), Qt::Key_PageUp, Qt::ControlModifier);
    EXPECT_EQ(tabs->Selection(), kParameterPage);
    QTest::keyClick(&window().widget(), Qt::Key_PageDown, Qt::ControlModifier);
    EXPECT_EQ(tabs->Selection(), kCompanyPage);
    EXPECT_NE(window().widget().findChild<QTabBar*>()->focusPolicy() & Qt::TabFocus, 0);
}

TEST_F(MainWindowTest, UnknownCodesAndTypingChangeNothing)
{
    loadSample();
    const State* state = window().getState();
    clearMessage();
    for (const uint32 code : {'Xxxx', 'WTTd', 'WTAn', 'CTMn', 'RTNa', 'OTDa'})
        post(code);
    show(kPortoFolioPage);
    enter("txtAccountName", "Somebody");
    EXPECT_EQ(window().getState(), state);
    EXPECT_EQ(message(), "");
}

TEST_F(MainWindowTest, StatusLineIsOnTheScreenWhileItsCommandStillRuns)
{
    auto& line = *window().FindView("MessageView")->widget();
    const auto shown = [&] { return window().widget().screen()->grabWindow(window().widget().winId()).toImage(); };
    const QRect place(line.mapTo(&window().widget(), QPoint(0, 0)), line.size());
    window().SetMessage("");
    const QImage empty = shown().copy(place);
    window().SetMessage("Getting the latest quote on the Internet... Please stand by."); // no event is handled here
    EXPECT_NE(shown().copy(place), empty);
}

TEST_F(MainWindowTest, StatusLineReplacesClearsAndCutsItsMessage)
{
    auto* line = static_cast<MessageView*>(window().FindView("MessageView"));
    window().SetMessage("first");
    window().SetMessage("other"); // of the same length
    EXPECT_STREQ(line->Message(), "other");
    window().SetMessage(std::string(1000, 'x').c_str());
    EXPECT_EQ(message().size(), 1000U);
    line->SetMessage(line->Message());
    EXPECT_EQ(message().size(), 1000U);
    line->SetMessage(nullptr);
    EXPECT_EQ(line->Message(), nullptr);
    EXPECT_EQ(line->Frame(), BRect(0, 776, 800, 800));
}

TEST_F(MainWindowTest, QuitMessageClosesTheWindow)
{
    auto* second = new PLWindow({50, 50, 850, 850}, DataFolder(folder()));
    const auto token = second->token();
    second->PostMessage(B_QUIT_REQUESTED);
    settle();
    EXPECT_EQ(BHandler::withToken(token), nullptr);
}

class PortoFolioPageTest : public WindowTest {
protected:
    PortoFolioPageTest() { loadSample(); }
};

TEST_F(PortoFolioPageTest, DateRevaluesAndAWrongOneStopsTheValuation)
{
    enter("txtDate", "31.12.2022");
    EXPECT_EQ(window().getState()->getDate(), Date(31, 12, 2022));
    EXPECT_NE(text("txtTotalValue"), "");
    enter("txtDate", "31/2/2022");
    EXPECT_EQ(window().getState(), nullptr);
    EXPECT_EQ(text("txtTotalValue"), "");
    EXPECT_THAT(rows("lstAccounts"), SizeIs(0));
    // Leaving the field commits it as well.
    type("txtDate", "1-1-2023");
    QTest::keyClick(&find<QLineEdit>("txtDate"), Qt::Key_Tab);
    settle();
    EXPECT_EQ(window().getState()->getDate(), Date(1, 1, 2023));
}

TEST_F(PortoFolioPageTest, SelectionAndScrollingSurviveARecomputation)
{
    select("lstShares", 9);
    select("lstAccounts", 1);
    const int32 top = list("lstShares").TopRow();
    ASSERT_GT(top, 0);
    enter("txtDate", "1/6/2024");
    EXPECT_EQ(list("lstAccounts").CurrentSelection(), 1);
    EXPECT_EQ(list("lstShares").CurrentSelection(), 9);
    EXPECT_EQ(list("lstShares").TopRow(), top);
    // Also over a date that was mistyped.
    enter("txtDate", "1/6");
    enter("txtDate", "2/6/2024");
    EXPECT_EQ(list("lstShares").CurrentSelection(), 9);
}

TEST_F(PortoFolioPageTest, EvolutionIsBuiltAndEmptied)
{
    auto* chart = static_cast<GraphView*>(window().FindView("grvEvolution"));
    unsigned n;
    auto* line = static_cast<GraphLine*>(chart->getAllGraphElements(&n)[0]);
    click("cbxComputeEvolution");
    EXPECT_GT(wallet().getNbrStates(), 300U);
    EXPECT_EQ(line->getNbrGraphPoints(), wallet().getNbrStates());
    EXPECT_STREQ(chart->getXLegend().getCharacterArray(), "Value in EUR");
    window().setReferenceCurrency(nullptr);
    enter("txtDate", "20/11/2024");
    EXPECT_EQ(line->getNbrGraphPoints(), 0U);
    EXPECT_STREQ(chart->getXLegend().getCharacterArray(), "Value in ???");
    window().setReferenceCurrency(window().catalogue().getCurrencies()[0]);
    enter("txtDate", "31/12/32767");
    auto* reason = static_cast<BStringView*>(chart->ChildAt(0));
    EXPECT_THAT(reason->Text(), HasSubstr("too long"));
    enter("txtDate", "20/11/2024");
    EXPECT_STREQ(reason->Text(), "");
    EXPECT_GT(line->getNbrGraphPoints(), 0U);
    enter("txtDate", "31/2");
    EXPECT_EQ(line->getNbrGraphPoints(), 0U) << "no date, no evolution";
    enter("txtDate", "20/11/2024");
    click("cbxComputeEvolution");
    EXPECT_EQ(wallet().getNbrStates(), 1U);
    EXPECT_EQ(line->getNbrGraphPoints(), 0U);
}

TEST_F(PortoFolioPageTest, RowsSayWhatIsOldOrMissing)
{
    enter("txtDate", "24/11/2024"); // a Sunday
    EXPECT_THAT(rows("lstShares")[0], HasSubstr("22/11/2024"));
    Company* company = nullptr;
    unsigned n;
    wallet().getAllShares(&n)[0]->getCompany(&company);
    while (company->getNbrQuotes() > 0)
        delete company->getQuote(0U);
    enter("txtDate", "22/11/2024");
    EXPECT_THAT(rows("lstShares")[0], HasSubstr("no quote"));
    wallet().getAllShares(&n)[1]->getCompany(&company);
    enter("txtDate", "1/1/2030"); // far behind the last quote
    EXPECT_THAT(rows("lstShares")[1], HasSubstr("~ " + dateText(company->getLastQuote())));
    Market* market = nullptr;
    Currency* currency = nullptr;
    company->getMarket(&market);
    market->getCurrency(&currency);
    while (currency->getNbrQuotes() > 0)
        delete currency->getQuote(0U);
    enter("txtDate", "22/11/2024");
    EXPECT_THAT(rows("lstShares")[1], HasSubstr("no rate"));
    wallet().getAccount(0)->setCurrency(nullptr);
    enter("txtDate", "21/11/2024");
    EXPECT_THAT(rows("lstAccounts")[0], HasSubstr("no currency"));
}

TEST_F(PortoFolioPageTest, HoldingsKeepToTheirValuation)
{
    Company* quoted = nullptr;
    Company* unquoted = nullptr;
    unsigned n;
    wallet().getAllShares(&n)[0]->getCompany(&quoted);
    wallet().getAllShares(&n)[1]->getCompany(&unquoted);
    while (unquoted->getNbrQuotes() > 0)
        delete unquoted->getQuote(0U);
    enter("txtDate", "24/11/2024");
    const auto valued = rows("lstShares");
    // As quotes that were fetched are, which wait for the next valuation.
    new CompanyQuote(quoted, Date(23, 11, 2024), 12345);
    new CompanyQuote(unquoted, Date(22, 11, 2024), 12345);
    EXPECT_EQ(rows("lstShares"), valued);
    window().UpdateState();
    EXPECT_THAT(rows("lstShares")[0], HasSubstr("12,345.00\t23/11/2024"));
    EXPECT_THAT(rows("lstShares")[1], HasSubstr("12,345.00\t22/11/2024"));
}

class ParameterPageTest : public WindowTest {
protected:
    ParameterPageTest() { show(kParameterPage); }
};

TEST_F(ParameterPageTest, FieldsShowTheDefaultsAndAllButTheFixedCostsRevalue)
{
    const struct {
        const char* field;
        const char* text;
        bool revalues;
    } cases[] = {
        {"txtBuyCost", "29.95", false},
        {"txtSellCost", "29.95", false},
        {"txtBuyRateCost", "0.17 %", true},
        {"txtSellRateCost", "0.17 %", true},
        {"txtInvestementPeriod", "90", true},
        {"txtBeginProfitSellRate", "200.00 %", true},
        {"txtEndProfitSellRate", "110.00 %", true},
        {"txtBeginLoseSellRate", "80.00 %", true},
        {"txtEndLoseSellRate", "80.00 %", true},
        {"txtReinvestRate", "90.00 %", true},
    };
    for (const auto& c : cases) {
        EXPECT_EQ(text(c.field), c.text) << c.field;
        window().SetState(nullptr);
        enter(c.field, "33");
        EXPECT_EQ(window().getState() != nullptr, c.revalues) << c.field;
    }
}

TEST_F(ParameterPageTest, CommitsStoreWhatTheFieldBeginsWith)
{
    const struct {
        const char* text;
        float cost;
    } costs[] = {
        {"29.95 $", 29.95F}, {"$29.95", 29.95F},
        {"\u00A330", 30},    {"12abc", 12},
        {"abc", 0},          {"", 0},
        {"7%", 7},           {"1000000000000000000000000000000000000000000", 3.40282347e38F},
    };
    for (const auto& c : costs) {
        enter("txtBuyCost", c.text);
        EXPECT_EQ(wallet().getBuyCost(), c.cost) << c.text;
    }
    enter("txtBuyCost", "12abc");
    EXPECT_EQ(text("txtBuyCost"), "12.00") << "the page shows what was understood";
    for (const char* text : {"0.25 %", "0.25", "%0.25"}) {
        enter("txtSellRateCost", text);
        EXPECT_EQ(wallet().getSellRateCost(), 0.0025F) << text;
    }
    const struct {
        const char* text;
        short days;
    } periods[] = {{"90.7", 90}, {"12 days", 12}, {"", 0}, {"99999", 32767}};
    for (const auto& c : periods) {
        enter("txtInvestementPeriod", c.text);
        EXPECT_EQ(wallet().getInvestementPeriod(), c.days) << c.text;
    }
    enter("txtBeginProfitSellRate", "150");
    EXPECT_EQ(wallet().getBeginProfitSellRate(), 1.5F);
}

} // namespace
