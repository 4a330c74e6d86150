// The window itself, the portfolio page and the parameter page.

#include "chart/GraphLine.h"
#include "chart/GraphView.h"
#include "foundation/DateText.h"
#include "market/Company.h"
#include "market/Currency.h"
#include "market/Market.h"
#include "platform/StringView.h"
#include "platform/TextControl.h"
#include "portfolio/Share.h"
#include "portfolio/Wallet.h"
#include "tests/gui/WindowFixture.h"
#include "valuation/State.h"

#include <QAccessible>
#include <QPixmap>
#include <QTabBar>

#include <limits>

namespace {

using testing::HasSubstr;
using testing::SizeIs;

class MainWindowTest : public WindowTest {
protected:
    QWidget& tabs() { return *window().widget().findChild<QTabBar*>(); }

    /// What the Tab key comes to, from the row of tabs on until it is back there.
    std::vector<const QWidget*> roundByTab()
    {
        constexpr std::size_t kMost = 200;
        std::vector<const QWidget*> met;
        tabs().setFocus();
        do {
            key(Qt::Key_Tab);
            met.push_back(QApplication::focusWidget());
        } while (met.back() != &tabs() && met.size() < kMost);
        return met;
    }
};

/// Looks at what assistive tools see of `object` and of what shows within it. @return how many controls there are.
int lookAt(const QAccessibleInterface& object, const std::string& around)
{
    constexpr int kRowsLookedAt = 2;
    const QAccessible::Role role = object.role();
    const std::string where = around + " > " + object.text(QAccessible::Name).toStdString();
    int controls = 0, rows = 0;
    if (object.state().focusable) {
        ++controls;
        EXPECT_NE(object.text(QAccessible::Name), "") << where;
        for (const auto none : {QAccessible::NoRole, QAccessible::Client, QAccessible::Pane, QAccessible::Grouping})
            EXPECT_NE(role, none) << where;
        if (role == QAccessible::EditableText || role == QAccessible::ComboBox) {
            EXPECT_FALSE(object.relations(QAccessible::Label).isEmpty()) << where;
        }
    }
    for (int i = 0; i < object.childCount(); ++i) {
        const QAccessibleInterface& child = *object.child(i);
        if (!child.state().invisible && (role != QAccessible::List || ++rows <= kRowsLookedAt))
            controls += lookAt(child, where);
    }
    return controls;
}

TEST_F(MainWindowTest, EveryControlHasANameARoleAndItsLabelAndIsReachedByTab)
{
    EXPECT_EQ(message(), "No Company...");
    loadSample();
    const auto& tree = *QAccessible::queryAccessibleInterface(&window().widget());
    EXPECT_EQ(tree.role(), QAccessible::Window);
    const int least[] = {25, 15, 20, 8, 11};
    for (const Page page : {kCompanyPage, kCurrencyPage, kPortoFolioPage, kOperationPage, kParameterPage}) {
        show(page);
        EXPECT_GE(lookAt(tree, "page " + std::to_string(page)), least[page]);
        for (const auto* button : window().widget().findChildren<QAbstractButton*>())
            if (button->isVisible() && !button->parentWidget()->inherits("QTabBar")) {
                EXPECT_NE(button->objectName(), "") << page;
                EXPECT_NE(button->focusPolicy() & Qt::TabFocus, 0) << button->objectName().toStdString();
            }
        const auto met = roundByTab();
        for (const auto* control : window().widget().findChildren<QWidget*>()) {
            if (control->isVisible() && control->isEnabled() && (control->focusPolicy() & Qt::TabFocus) != 0 &&
                control->focusProxy() == nullptr) {
                EXPECT_THAT(met, testing::Contains(control)) << control->objectName().toStdString() << " on " << page;
            }
        }
        const auto isOfPage = [this](const QWidget* control) { return this->page().isAncestorOf(control); };
        EXPECT_TRUE(std::ranges::is_partitioned(met, isOfPage)) << "first the page, then what is beside it";
    }
}

TEST_F(MainWindowTest, PagesDrawBetweenTheirControls)
{
    struct {
        Page page;
        QRect place;
    } const drawn[] = {{kOperationPage, {640, 10, 140, 18}}, {kParameterPage, {500, 60, 200, 200}}};
    for (const auto& [number, place] : drawn) {
        show(number);
        const QImage shown = page().grab(place).toImage();
        QImage ground(shown.size(), shown.format());
        ground.fill(page().grab({0, 0, 1, 1}).toImage().pixelColor(0, 0));
        EXPECT_NE(shown, ground) << number;
    }
}

/// Beside the fixture's window, another one as a start leaves it.
class StartTest : public MainWindowTest {
protected:
    StartTest()
    {
        started_->Show();
        [[maybe_unused]] const bool isExposed = QTest::qWaitForWindowExposed(&desktop());
    }

    PLWindow& started() { return *started_; }
    QWidget& desktop() { return started_->widget(); }

private:
    std::unique_ptr<PLWindow, void (*)(PLWindow*)> started_{new PLWindow({50, 50, 850, 850}, DataFolder("/nowhere")),
                                                            [](PLWindow* window) { window->Quit(); }};
};

TEST_F(StartTest, OtherPagesComeAfterThePictureWithoutAChangeInIt)
{
    ASSERT_EQ(started().FindView("WalletView"), nullptr);
    const QImage first = desktop().grab().toImage();
    ASSERT_TRUE(QTest::qWaitFor([this] { return started().FindView("ParameterView") != nullptr; }));
    settle();
    EXPECT_EQ(desktop().grab().toImage(), first);
}

TEST_F(StartTest, WhoIsFasterFindsThemAll)
{
    QTest::keyClick(&desktop(), Qt::Key_3, Qt::AltModifier);
    QApplication::sendPostedEvents();
    ASSERT_NE(started().FindView("WalletView"), nullptr);
    const auto* date = dynamic_cast<BTextControl*>(started().FindView("WalletView")->FindView("txtDate"));
    EXPECT_STREQ(date->Text(), "21/11/2024");
    EXPECT_TRUE(date->widget()->isVisible());
}

TEST_F(MainWindowTest, StatusLineIsOnTheScreenWhileItsCommandStillRuns)
{
    auto& line = *window().FindView("MessageView")->widget();
    const auto shown = [&] { return window().widget().screen()->grabWindow(window().widget().winId()).toImage(); };
    const QRect place(line.mapTo(&window().widget(), QPoint(0, 0)), line.size());
    window().SetMessage("");
    const QImage empty = shown().copy(place);
    window().SetMessage("first"); // no event is handled here
    const QImage first = shown().copy(place);
    EXPECT_NE(first, empty);
    window().SetMessage("other"); // of the same length
    EXPECT_NE(shown().copy(place), first);
}

class PortoFolioPageTest : public WindowTest {
protected:
    PortoFolioPageTest() { loadSample(); }

    /// The company of a holding.
    Company& company(unsigned i)
    {
        Company* found;
        unsigned n;
        wallet().getAllShares(&n)[i]->getCompany(&found);
        return *found;
    }
    template <class Series>
    static void dropQuotes(Series& series)
    {
        while (series.getNbrQuotes() > 0)
            delete series.getQuote(0U);
    }
};

TEST_F(PortoFolioPageTest, DateRevaluesAWrongOneStopsTheValuationAndTheSelectionsSurvive)
{
    click("cbxComputeEvolution"); // whose chart leaves less room
    select("lstShares", 9);
    select("lstAccounts", 1);
    const int32 top = list("lstShares").TopRow();
    ASSERT_GT(top, 0);
    enter("txtDate", "31.12.2023");
    EXPECT_EQ(window().getState()->getDate(), Date(31, 12, 2023));
    EXPECT_EQ(list("lstShares").TopRow(), top);
    enter("txtDate", "31/2/2024");
    EXPECT_EQ(window().getState(), nullptr);
    EXPECT_EQ(text("txtTotalValue"), "");
    EXPECT_THAT(rows("lstAccounts"), SizeIs(0));
    type("txtDate", "1-6-2024");
    QTest::keyClick(&find<QLineEdit>("txtDate"), Qt::Key_Tab);
    settle();
    EXPECT_EQ(window().getState()->getDate(), Date(1, 6, 2024)) << "leaving the field commits it as well";
    EXPECT_EQ(list("lstAccounts").CurrentSelection(), 1);
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
    EXPECT_THAT(static_cast<BStringView*>(chart->FindView("txtNoEvolution"))->Text(), HasSubstr("too long"));
    enter("txtDate", "20/11/2024");
    EXPECT_GT(line->getNbrGraphPoints(), 0U);
    click("cbxComputeEvolution");
    EXPECT_EQ(wallet().getNbrStates(), 1U);
    EXPECT_EQ(line->getNbrGraphPoints(), 0U);
}

TEST_F(PortoFolioPageTest, RowsSayWhatIsOldOrMissing)
{
    enter("txtDate", "24/11/2024"); // a Sunday
    EXPECT_THAT(rows("lstShares")[0], HasSubstr("22/11/2024"));
    dropQuotes(company(0));
    enter("txtDate", "22/11/2024");
    EXPECT_THAT(rows("lstShares")[0], HasSubstr("no quote"));
    new CompanyQuote(&company(0), Date(20, 11, 2024), 12345); // as a fetched one is, which waits for the next valuation
    EXPECT_THAT(rows("lstShares")[0], HasSubstr("no quote"));
    window().UpdateState();
    EXPECT_THAT(rows("lstShares")[0], HasSubstr("12,345.00\t20/11/2024"));
    enter("txtDate", "1/1/2030"); // far behind the last quote
    EXPECT_THAT(rows("lstShares")[1], HasSubstr("~ " + dateText(company(1).getLastQuote())));
    Market* market = nullptr;
    Currency* currency = nullptr;
    company(1).getMarket(&market);
    market->getCurrency(&currency);
    dropQuotes(*currency);
    enter("txtDate", "22/11/2024");
    EXPECT_THAT(rows("lstShares")[1], HasSubstr("no rate"));
}

using ParameterPageTest = WindowTest;

TEST_F(ParameterPageTest, FieldsShowTheDefaultsTakeWhatTheyBeginWithAndAllButTheFixedCostsRevalue)
{
    const struct {
        const char *field, *text;
        const char *typed, *understood;
        bool revalues;
    } cases[] = {
        {"txtBuyCost", "29.95", "12abc", "12.00", false},
        {"txtSellCost", "29.95", "\u00A330.5 $", "30.50", false},
        {"txtBuyRateCost", "0.17 %", "0.25 %", "0.25 %", true},
        {"txtSellRateCost", "0.17 %", "%0.5", "0.50 %", true},
        {"txtInvestementPeriod", "90", "99999 days", "32767", true},
        {"txtBeginProfitSellRate", "200.00 %", "150.7", "150.70 %", true},
        {"txtEndProfitSellRate", "110.00 %", "151", "151.00 %", true},
        {"txtBeginLoseSellRate", "80.00 %", "", "0.00 %", true},
        {"txtEndLoseSellRate", "80.00 %", "81", "81.00 %", true},
        {"txtReinvestRate", "90.00 %", "abc", "0.00 %", true},
    };
    show(kParameterPage);
    for (const auto& c : cases) {
        EXPECT_EQ(text(c.field), c.text);
        window().SetState(nullptr);
        enter(c.field, c.typed);
        EXPECT_EQ(window().getState() != nullptr, c.revalues) << c.field;
    }
    for (const auto& c : cases)
        EXPECT_EQ(text(c.field), c.understood) << c.field;
    EXPECT_EQ(wallet().getSellRateCost(), 0.005F);
    EXPECT_EQ(wallet().getBeginProfitSellRate(), 1.507F);
    const struct {
        const char *field, *typed, *shown;
        Wallet::Parameter parameter;
        float value;
    } fine[] = {{"txtBuyRateCost", "0.123", "0.123 %", Wallet::kBuyRateCost, 0.00123F},
                {"txtSellRateCost", "0.0001", "0.0001 %", Wallet::kSellRateCost, 0.000001F},
                {"txtSellCost", "a0.004", "0.004", Wallet::kSellCost, 0.004F}};
    for (const auto& c : fine)
        enter(c.field, c.typed);
    for (const auto& c : fine) {
        EXPECT_EQ(text(c.field), c.shown) << "though another field was entered";
        QTest::keyClick(&find<QLineEdit>(c.field), Qt::Key_Return);
        settle();
        EXPECT_EQ(wallet().getParameter(c.parameter), c.value) << c.field;
    }
    enter("txtBuyCost", std::string(43, '1'));
    EXPECT_EQ(wallet().getBuyCost(), std::numeric_limits<float>::max());
}

} // namespace
