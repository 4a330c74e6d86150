// What a person does with a chart: wheel, dragging, keys and buttons, and what the chart says and keeps then.

#include "chart/DateTicks.h"
#include "chart/GraphView.h"
#include "foundation/DateText.h"
#include "tests/gui/CatalogueFixture.h"
#include "tests/support/ToolRun.h"
#include "valuation/State.h"

#include <QImage>
#include <QWheelEvent>
#include <cmath>
#include <cstring>
#include <sstream>

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class ChartTest : public CatalogueTest {
protected:
    GraphView& chart(const char* page, const char* name)
    {
        return dynamic_cast<GraphView&>(*window().FindView(page)->FindView(name));
    }
    GraphView& quotes() { return chart("CompanyView", "grvQuotes"); }
    GraphView& evolution() { return chart("WalletView", "grvEvolution"); }

    /// Draws, as the screen does before it is pointed at.
    static QWidget& drawn(GraphView& chart)
    {
        settle();
        chart.widget()->grab();
        return *chart.widget();
    }
    static QPoint placeOf(GraphView& chart, const Date& date)
    {
        drawn(chart);
        return {static_cast<int>(std::lround(chart.scale()->pixelX(dayNumber(date)))), 100};
    }
    static std::string shown(GraphView& chart)
    {
        drawn(chart);
        const ChartRange range = chart.shownRange();
        return std::string(dateOfDay(range.min).toString().bytes()) + " " +
               std::string(dateOfDay(range.max).toString().bytes());
    }
    static void turnWheel(GraphView& chart, QPoint where, int notches)
    {
        QWidget& widget = drawn(chart);
        QWheelEvent event(where, widget.mapToGlobal(where), {}, {0, 120 * notches}, Qt::NoButton, Qt::NoModifier,
                          Qt::NoScrollPhase, false);
        QApplication::sendEvent(&widget, &event);
    }
    static void drag(GraphView& chart, QPoint from, QPoint to, Qt::KeyboardModifiers modifiers = {})
    {
        QWidget& widget = drawn(chart);
        QTest::mousePress(&widget, Qt::LeftButton, modifiers, from);
        QMouseEvent move(QEvent::MouseMove, to, widget.mapToGlobal(to), Qt::NoButton, Qt::LeftButton, modifiers);
        QApplication::sendEvent(&widget, &move);
        QTest::mouseRelease(&widget, Qt::LeftButton, modifiers, to);
    }
    static std::vector<std::string> textsAt(GraphView& chart, QPoint where)
    {
        QTest::mouseMove(&drawn(chart), where);
        settle();
        return texts(chart);
    }
    static std::vector<std::string> texts(GraphView& chart)
    {
        std::vector<std::string> texts;
        drawn(chart);
        if (const auto readOut = chart.readOut())
            for (const ChartText& text : readOut->texts)
                texts.push_back(text.text);
        return texts;
    }
    std::string pressedButtons(GraphView& chart)
    {
        std::string names;
        for (const auto* button : drawn(chart).findChildren<QAbstractButton*>())
            if (button->isChecked())
                names += button->objectName().toStdString();
        return names;
    }
};

TEST_F(ChartTest, WheelDragKeysAndButtonsChangeTheRange)
{
    loadSample();
    click("cbxComputeEvolution");
    GraphView& chart = evolution();
    const std::string all = shown(chart);
    EXPECT_EQ(pressedButtons(chart), "btnAll");
    const QPoint from = placeOf(chart, {1, 2, 2023});
    const QPoint to = placeOf(chart, {1, 2, 2024});
    drag(chart, to, from);
    EXPECT_THAT(shown(chart), testing::MatchesRegex(".*/2023 .*/2024")) << "from the right to the left as well";
    EXPECT_EQ(pressedButtons(chart), "");
    const ChartRange selected = chart.shownRange();
    const double under = chart.scale()->x(300);
    turnWheel(chart, {300, 100}, 1);
    drawn(chart);
    EXPECT_NEAR(chart.shownRange().length(), selected.length() / 1.25, 1e-6);
    EXPECT_NEAR(chart.scale()->x(300), under, 0.5) << "the day under the pointer stays there";
    turnWheel(chart, {300, 100}, -1);
    drag(chart, {300, 100}, {200, 100}, Qt::ShiftModifier);
    EXPECT_GT(chart.shownRange().min, selected.min + 10);
    EXPECT_NEAR(chart.shownRange().length(), selected.length(), 1e-6);
    click("btn6M");
    EXPECT_EQ(shown(chart), "21/05/2024 21/11/2024");
    EXPECT_EQ(pressedButtons(chart), "btn6M");
    enter("txtDate", "20/11/2024");
    EXPECT_EQ(shown(chart), "20/05/2024 20/11/2024") << "the months end at the last day";
    click("btn6M");
    EXPECT_EQ(pressedButtons(chart), "btn6M") << "a second click changes nothing";
    for (const auto& [key, after] : {std::pair(Qt::Key_Plus, 0.6667), {Qt::Key_Left, 0.6667}, {Qt::Key_Minus, 1.0}}) {
        QTest::keyClick(chart.widget(), key);
        EXPECT_NEAR(chart.shownRange().length(), after * 184, 0.1) << key;
    }
    QTest::mouseDClick(chart.widget(), Qt::LeftButton, {}, {300, 100});
    enter("txtDate", "21/11/2024");
    EXPECT_EQ(shown(chart), all);
    drag(chart, {300, 100}, {302, 100});
    EXPECT_EQ(shown(chart), all) << "a click with an unsteady hand";
}

TEST_F(ChartTest, ReadsTheNearestDayEverywhereAndAgreesWithTheTotals)
{
    loadSample();
    click("cbxComputeEvolution");
    GraphView& chart = evolution();
    const auto amount = [this](const char* field) { return text(field).substr(0, text(field).find(' ')); };
    const std::vector<std::string> last{
        "21/11/2024",       "Value", amount("txtTotalValue"), "Put in", amount("txtTotalDeposit"), "Gain",
        amount("txtProfit")};
    const int right = static_cast<int>(chart.Bounds().right) - 1;
    const int bottom = static_cast<int>(chart.Bounds().bottom) - 1;
    EXPECT_EQ(textsAt(chart, {right, bottom}), last);
    EXPECT_EQ(textsAt(chart, {right, 60}), last);
    EXPECT_EQ(textsAt(chart, {1, bottom})[0], window().getState()->getFirstOperationDate().toString().bytes());
    QWidget& widget = *chart.widget();
    QEvent leave(QEvent::Leave);
    QApplication::sendEvent(&widget, &leave);
    EXPECT_THAT(texts(chart), IsEmpty());
    widget.setFocus();
    QTest::keyClick(&widget, Qt::Key_Down);
    EXPECT_EQ(texts(chart), last) << "by keys as well";
    QTest::keyClick(&widget, Qt::Key_Down);
    EXPECT_EQ(texts(chart)[0], "20/11/2024");
}

TEST_F(ChartTest, ReturnsAreOfTheDaysInViewAndThoseOfPelorinValue)
{
    loadSample();
    const auto line = [this](const char* name) { return find<QWidget>(name).accessibleName().toStdString(); };
    const auto returns = [&] { return line("txtMoneyWeighted") + ", " + line("txtTimeWeighted"); };
    const auto expectRange = [&](const Date& from, const Date& to, const std::string& options) {
        const std::string range = "From " + dateText(from) + " to " + dateText(to);
        EXPECT_EQ(line("txtReturnRange"), range + ", per year:");
        const ToolRun tool(PELORIN_VALUE,
                           "'" + marketFile() + "' '" + walletFile() + "' --date " + dateText(to) + options,
                           TemporaryFolder("pelorin-gui-returns"));
        const auto valued = [&](const char* what) {
            std::istringstream rest(tool.out.substr(tool.out.find(what) + std::strlen(what)));
            std::string number;
            rest >> number;
            return std::string(what) + ' ' + number + " %";
        };
        EXPECT_EQ(returns(), valued("Money-weighted return") + ", " + valued("Time-weighted return")) << range;
    };
    const Date first = window().getState()->getFirstOperationDate();
    EXPECT_THAT(returns(), testing::MatchesRegex("Money.* %, Time-weighted return: tick Compute Evolution"));
    click("cbxComputeEvolution");
    expectRange(first, {21, 11, 2024}, "");
    click("btn1Y");
    expectRange({21, 11, 2023}, {21, 11, 2024}, " --from 21/11/2023");
    drag(evolution(), placeOf(evolution(), {1, 2, 2023}), placeOf(evolution(), {1, 2, 2024}));
    const ChartRange range = evolution().shownRange();
    const Date from = dateOfDay(std::ceil(range.min)), to = dateOfDay(std::floor(range.max));
    EXPECT_EQ(from.getYear() + to.getYear(), 2023 + 2024);
    expectRange(from, to, " --from " + dateText(from));
    enter("txtDate", "21/11/2025");
    expectRange(from, to, " --from " + dateText(from));
    click("btnAll");
    const std::string value = text("txtTotalValue");
    show(kOperationPage);
    click("cbxPrevision");
    show(kPortoFolioPage);
    enter("txtDate", "22/11/2025"); // values the sales that the day before was simulated with
    enter("txtDate", "21/11/2025");
    EXPECT_NE(text("txtTotalValue"), value);
    expectRange(first, {21, 11, 2025}, "");
    click("cbxComputeEvolution");
    EXPECT_THAT(returns(), testing::EndsWith(", Time-weighted return: tick Compute Evolution"));
    enter("txtDate", dateText(first).c_str());
    EXPECT_EQ(line("txtReturnRange") + returns(), "Money-weighted return: no day, Time-weighted return: no day");
    enter("txtDate", "");
    EXPECT_EQ(returns(), ", ");
}

TEST_F(ChartTest, MarksTradesAndEventsAndKeepsItsRangeForAnotherCompany)
{
    addSmallCatalogue();
    buy(company());
    GraphView& chart = quotes();
    show(kCompanyPage);
    fill({{"txtCompanyEventDate", "6/3/2024"}});
    click("btnAddCompanyEvent");
    EXPECT_THAT(textsAt(chart, placeOf(chart, {2, 3, 2024})),
                ElementsAre("02/03/2024", "AL", "10.50", "Trend", testing::_, "Bought 10 at 11.00"));
    EXPECT_EQ(textsAt(chart, placeOf(chart, {6, 3, 2024}) + QPoint(2, 0)).back(), "Split 1 to 2");
    select("lstCompanyEvents", 0);
    choose("companyEventType", "Note");
    type("txtCompanyEventTitle", "Dividend");
    click("btnUpdateCompanyEvent");
    EXPECT_EQ(textsAt(chart, placeOf(chart, {6, 3, 2024})).back(), "Dividend");
    click("btnRemoveCompanyEvent");
    EXPECT_EQ(textsAt(chart, placeOf(chart, {6, 3, 2024})).size(), 5U) << "before it is destroyed";
    delete company()->shares()[0]->shareOperations()[0];
    window().UpdateState();
    EXPECT_EQ(textsAt(chart, placeOf(chart, {2, 3, 2024}))[0], "01/03/2024") << "no longer a day of its own";

    drag(chart, placeOf(chart, {3, 3, 2024}), placeOf(chart, {9, 3, 2024}));
    const std::string range = shown(chart);
    for (const auto& [ticker, firstDay, lastDay] :
         {std::tuple("BE", "1/2/2024", "1/5/2024"), {"GA", "1/1/2023", "1/2/2023"}}) {
        addCompany(ticker, ticker);
        addQuote(firstDay, "1");
        addQuote(lastDay, "2");
        const bool hasData = ticker == std::string("BE");
        EXPECT_EQ(shown(chart), hasData ? range : "01/01/2023 01/02/2023") << ticker;
        EXPECT_EQ(pressedButtons(chart), hasData ? "" : "btnAll") << ticker;
    }
    select("lstCompanies", 0);
    EXPECT_EQ(shown(chart), range);
}

} // namespace
