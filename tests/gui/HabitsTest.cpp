// Keys, copying, and what charts do under the pointer.

#include "chart/ChartSeries.h"
#include "chart/GraphLine.h"
#include "chart/GraphPoint.h"
#include "chart/GraphView.h"
#include "platform/ListView.h"
#include "platform/TabView.h"
#include "platform/qt/WindowWidget.h"
#include "portfolio/Wallet.h"
#include "tests/gui/WindowFixture.h"

#include <QApplication>
#include <QClipboard>
#include <QImage>
#include <QLineEdit>
#include <QMenu>
#include <QTabBar>
#include <QTest>
#include <QTimer>
#include <gmock/gmock.h>

#include <tuple>

namespace {

using testing::ElementsAre;
using testing::HasSubstr;

class HabitsTest : public WindowTest {
protected:
    /// Presses a key where the keyboard is.
    void press(Qt::Key key, Qt::KeyboardModifiers modifiers = Qt::ControlModifier)
    {
        QWidget* focus = QApplication::focusWidget();
        QTest::keyClick(focus != nullptr ? focus : &window().widget(), key, modifiers);
        settle();
    }
    int32 tab() { return static_cast<BTabView*>(window().FindView("TabView"))->Selection(); }
    std::string focus() { return QApplication::focusWidget()->objectName().toStdString(); }
};

TEST_F(HabitsTest, KeysShowTheTabsAndToolTipsNameThem)
{
    const auto* bar = window().widget().findChild<QTabBar*>();
    for (int i = 4; i >= 0; --i) {
        press(static_cast<Qt::Key>(Qt::Key_1 + i), Qt::AltModifier);
        EXPECT_EQ(tab(), i);
        EXPECT_EQ(bar->tabToolTip(i), QString("Alt+%1").arg(i + 1));
    }
    press(Qt::Key_PageUp);
    EXPECT_EQ(tab(), kParameterPage);
    press(Qt::Key_PageDown);
    EXPECT_EQ(tab(), kCompanyPage);
    EXPECT_THAT(find<QWidget>("btnSaveMarket").toolTip().toStdString(), HasSubstr("Ctrl+S"));
}

TEST_F(HabitsTest, LoadAndSaveAreThoseOfThePageInFront)
{
    makeSample();
    show(kCurrencyPage);
    press(Qt::Key_O);
    answerPanel("OpenPanel", marketFile());
    EXPECT_EQ(message(), "Markets successfully loaded...");
    show(kOperationPage);
    answerNextAlert("Continue");
    press(Qt::Key_O);
    EXPECT_EQ(tab(), kPortoFolioPage) << "the operations are the portfolio's";
    answerPanel("OpenPanel", walletFile());
    EXPECT_EQ(message(), "Wallet successfully loaded...");

    // What is being typed counts, as it does when the button is clicked.
    show(kParameterPage);
    type("txtBuyCost", "7.5");
    press(Qt::Key_S);
    EXPECT_EQ(message(), "Wallet successfully saved...");
    EXPECT_EQ(wallet().getBuyCost(), 7.5F);
}

TEST_F(HabitsTest, AddGoesByTheBoxThatHasTheKeyboard)
{
    show(kCurrencyPage);
    fill({{"txtCurrencyRepresentation", "EUR"}, {"txtCurrencyName", "Euro"}});
    press(Qt::Key_N);
    ASSERT_EQ(list("lstCurrencies").CountItems(), 1);
    EXPECT_EQ(focus(), "txtCurrencyName") << "ready for the next one";
    select("lstCurrencies", 0);
    fill({{"txtQuoteDate", "05/03/2024"}, {"txtQuoteValue", "1.5"}});
    press(Qt::Key_N);
    EXPECT_EQ(list("lstCurrencies").CountItems(), 1);
    EXPECT_EQ(list("lstQuotes").CountItems(), 1);
    find<QWidget>("btnLoadMarket").setFocus();
    press(Qt::Key_N);
    EXPECT_EQ(list("lstCurrencies").CountItems() + list("lstQuotes").CountItems(), 2) << "none of them, or which?";
}

TEST_F(HabitsTest, ListsFindWhatIsTypedAndCopyWhatIsSelected)
{
    loadSample();
    show(kCompanyPage);
    select("lstMarkets", 0);
    const std::vector<std::string> companies = rows("lstCompanies");
    ASSERT_GT(companies.size(), 2U);
    select("lstCompanies", 0);
    const std::string last = companies.back();
    QTest::keyClicks(QApplication::focusWidget(), QString::fromStdString(last.substr(0, 3)));
    settle();
    press(Qt::Key_C);
    EXPECT_EQ(QApplication::clipboard()->text().toStdString(), last);
    QTest::qWait(QApplication::keyboardInputInterval() + 50);
    const std::string name = companies[1].substr(companies[1].find('\t') + 1);
    QTest::keyClicks(QApplication::focusWidget(), QString::fromStdString(name.substr(0, 5)).toLower());
    settle();
    EXPECT_EQ(text("txtName"), name.substr(0, name.find('\t'))) << "typing finds a row by a later cell, too";

    const std::vector<std::string> quotes = rows("lstQuotes");
    select("lstQuotes", 1);
    select("lstQuotes", 3, true);
    press(Qt::Key_C);
    EXPECT_EQ(QApplication::clipboard()->text().toStdString(), quotes[1] + '\n' + quotes[3]);
    press(Qt::Key_A);
    EXPECT_EQ(list("lstQuotes").CountSelected(), static_cast<int32>(quotes.size()));
}

TEST_F(HabitsTest, DateStepsByDayAndMonthAndIsValuedAtOnce)
{
    loadSample();
    const std::tuple<const char*, Qt::Key, const char*> steps[] = {
        {"21/11/2024", Qt::Key_Up, "22/11/2024"},
        {"01/03/2024", Qt::Key_Down, "29/02/2024"},
        {"31/12/2024", Qt::Key_PageUp, "31/01/2025"},
        {"31/03/2024", Qt::Key_PageDown, "29/02/2024"},
        {"", Qt::Key_Down, "21/11/2024"},
        {"21/11", Qt::Key_Down, "21/11"},
        {"01/01/1", Qt::Key_Down, "01/01/1"},
    };
    for (const auto& [from, key, to] : steps) {
        type("txtDate", from);
        press(key, Qt::NoModifier);
        EXPECT_EQ(text("txtDate"), to) << from;
    }
    enter("txtDate", "21/11/2024");
    const std::string value = text("txtTotalValue");
    press(Qt::Key_PageDown, Qt::NoModifier);
    EXPECT_NE(text("txtTotalValue"), value);
    for (int i = 0; i < 31; ++i) // faster than they can be valued
        QTest::keyEvent(QTest::Click, QApplication::focusWidget(), Qt::Key_Up);
    settle();
    EXPECT_EQ(text("txtDate"), "21/11/2024");
    EXPECT_EQ(text("txtTotalValue"), value) << "of the last day that was stepped to";
}

TEST_F(HabitsTest, ChartShowsThePointAndSavesItsPicture)
{
    loadSample();
    show(kPortoFolioPage);
    click("cbxComputeEvolution");
    auto& chart = static_cast<GraphView&>(*window().FindView("grvEvolution"));
    QWidget& widget = *chart.widget();
    const auto look = [&widget] { // without the buttons that stand on it
        QImage image(widget.size(), QImage::Format_RGB32);
        widget.render(&image, {}, {}, QWidget::DrawWindowBackground);
        return image;
    };
    const QImage plain = look();
    unsigned count;
    auto* line = static_cast<GraphLine*>(chart.getAllGraphElements(&count)[0]);
    const GraphPoint* middle = line->getAllGraphPoints(&count)[line->getNbrGraphPoints() / 2];
    const BPoint where = chart.scale()->pixel(chartPointOf(*middle, true));
    const QPoint place(static_cast<int>(where.x), static_cast<int>(where.y));
    QTest::mouseMove(&widget, place);
    settle();
    EXPECT_NE(look(), plain);

    const std::string file = folder() + "/evolution";
    widget.setFocus(); // as the click for the menu does
    QTimer::singleShot(100, [] {
        auto* menu = qobject_cast<QMenu*>(QApplication::activePopupWidget());
        ASSERT_NE(menu, nullptr);
        EXPECT_EQ(menu->actions().at(0)->text(), "Save as PNG...");
        QTest::keyClick(menu, Qt::Key_Down);
        QTest::keyClick(menu, Qt::Key_Return);
    });
    QContextMenuEvent asked(QContextMenuEvent::Mouse, place, widget.mapToGlobal(place));
    QApplication::sendEvent(&widget, &asked);
    settle();
    answerPanel("SavePanel", file);
    EXPECT_EQ(QImage(QString::fromStdString(file + ".png")).convertToFormat(plain.format()), plain)
        << "the ending is added, the read-out left out";
}

} // namespace
