// Keys, copying, and what charts do under the pointer.

#include "chart/GraphView.h"
#include "platform/TabView.h"
#include "portfolio/Wallet.h"
#include "tests/gui/WindowFixture.h"

#include <QImage>
#include <QMenu>
#include <QTabBar>
#include <QTimer>

#include <tuple>

namespace {

using testing::HasSubstr;

class HabitsTest : public WindowTest {
protected:
    int32 tab() { return static_cast<BTabView*>(window().FindView("TabView"))->Selection(); }
};

TEST_F(HabitsTest, KeysShowTheTabsAndToolTipsNameThem)
{
    const auto* bar = window().widget().findChild<QTabBar*>();
    for (int i = 4; i >= 0; --i) {
        key(static_cast<Qt::Key>(Qt::Key_1 + i), Qt::AltModifier);
        EXPECT_EQ(tab(), i);
        EXPECT_EQ(bar->tabToolTip(i), QString("Alt+%1").arg(i + 1));
    }
    ctrl(Qt::Key_PageUp);
    EXPECT_EQ(tab(), kParameterPage);
    ctrl(Qt::Key_PageDown);
    EXPECT_EQ(tab(), kCompanyPage);
    EXPECT_THAT(find<QWidget>("btnSaveMarket").toolTip().toStdString(), HasSubstr("Ctrl+S"));
}

TEST_F(HabitsTest, LoadAndSaveAreThoseOfThePageInFront)
{
    makeSample();
    show(kCurrencyPage);
    ctrl(Qt::Key_O);
    answerPanel("OpenPanel", marketFile());
    EXPECT_EQ(message(), "Markets successfully loaded...");
    show(kOperationPage);
    answerNextAlert("Continue");
    ctrl(Qt::Key_O);
    EXPECT_EQ(tab(), kPortoFolioPage) << "the operations are the portfolio's";
    answerPanel("OpenPanel", walletFile());
    EXPECT_EQ(message(), "Wallet successfully loaded...");

    // What is being typed counts, as it does when the button is clicked.
    show(kParameterPage);
    type("txtBuyCost", "7.5");
    ctrl(Qt::Key_S);
    EXPECT_EQ(message(), "Wallet successfully saved...");
    EXPECT_EQ(wallet().getBuyCost(), 7.5F);
}

TEST_F(HabitsTest, AddGoesByTheBoxThatHasTheKeyboard)
{
    show(kCurrencyPage);
    fill({{"txtCurrencyRepresentation", "EUR"}, {"txtCurrencyName", "Euro"}});
    ctrl(Qt::Key_N);
    ASSERT_EQ(list("lstCurrencies").CountItems(), 1);
    EXPECT_EQ(focus(), "txtCurrencyName") << "ready for the next one";
    select("lstCurrencies", 0);
    fill({{"txtQuoteDate", "05/03/2024"}, {"txtQuoteValue", "1.5"}});
    ctrl(Qt::Key_N);
    EXPECT_EQ(list("lstCurrencies").CountItems(), 1);
    EXPECT_EQ(list("lstQuotes").CountItems(), 1);
    find<QWidget>("btnLoadMarket").setFocus();
    ctrl(Qt::Key_N);
    EXPECT_EQ(list("lstCurrencies").CountItems() + list("lstQuotes").CountItems(), 2) << "none of them, or which?";
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
    for (const auto& [from, step, to] : steps) {
        type("txtDate", from);
        key(step);
        EXPECT_EQ(text("txtDate"), to) << from;
    }
    enter("txtDate", "21/11/2024");
    const std::string value = text("txtTotalValue");
    key(Qt::Key_PageDown);
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
    const QPoint place(300, 100);
    QTest::mouseMove(&widget, place);
    settle();
    EXPECT_NE(look(), plain) << "the read-out";

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
