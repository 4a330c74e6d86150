// Quotes on the company page: by hand, from servers, in a chart, and thousands of them.

#include "chart/GraphLine.h"
#include "chart/GraphPolygon.h"
#include "chart/GraphView.h"
#include "net/QuoteServers.h"
#include "platform/ListItem.h"
#include "tests/gui/CatalogueFixture.h"
#include "tests/support/Peer.h"
#include "tests/support/ServerRun.h"
#include "tests/support/ToolRun.h"

#include <QInputDevice>
#include <QKeyEvent>
#include <QWindow>
#include <sstream>

namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;
using testing::UnorderedElementsAre;

using QuoteTest = CatalogueTest;

const std::string kBand = "Trend \u00B1 one standard deviation";

TEST_F(QuoteTest, AnotherSeriesEmptiesTheFieldsOfItsQuotes)
{
    addSmallCatalogue();
    const auto fields = [this] { return text("txtQuoteDate") + ' ' + text("txtQuoteValue"); };
    addCompany("BE", "Beta");
    EXPECT_EQ(fields(), " ");
    fill({{"txtQuoteDate", "2/3/2024"}, {"txtQuoteValue", "1"}});
    click("btnAddQuote");
    post('HUnd');
    EXPECT_EQ(fields(), "02/03/2024 1.00") << "the same company, though it was made anew";
    type("txtQuoteValue", "1x");
    select("lstCompanies", 0);
    EXPECT_EQ(fields(), " ");
    EXPECT_TRUE(find<QLineEdit>("txtQuoteValue").toolTip().isEmpty());
    show(kCurrencyPage);
    type("txtQuoteValue", "3");
    select("lstCurrencies", 1);
    EXPECT_EQ(fields(), "01/01/2024 3.00") << "selected already";
    select("lstCurrencies", 0);
    EXPECT_EQ(fields(), " ");
}

TEST_F(QuoteTest, AQuoteIsReplacedMovedAndKeptBesideAnotherOfItsDay)
{
    addSmallCatalogue();
    BListItem* last = list("lstQuotes").ItemAt(2);
    select("lstQuotes", 2);
    addQuote("6/3/2024", "13");
    addQuote("7/3/2024", "14");
    EXPECT_THAT(rows("lstQuotes"),
                ElementsAre("01/03/2024\t10.00", "06/03/2024\t13.00", "07/03/2024\t14.00", "11/03/2024\t20.00"));
    EXPECT_EQ(list("lstQuotes").ItemAt(3), last) << "one row comes in, the others stay";
    EXPECT_EQ(list("lstQuotes").CurrentSelection(), 3);

    follow({{{{"txtQuoteDate", "6/3/2024"}, {"txtQuoteValue", "15"}}, "btnUpdateQuote", ""}});
    EXPECT_EQ(company()->getNbrQuotes(), 4U) << "both quotes of the day stay";
    EXPECT_THAT(rows("lstQuotes"),
                ElementsAre("01/03/2024\t10.00", "06/03/2024\t15.00", "06/03/2024\t13.00", "07/03/2024\t14.00"))
        << "in the order of their addition";
    EXPECT_EQ(list("lstQuotes").CurrentSelection(), 1) << "it is still selected, where it is now";
    follow({{{{"txtQuoteDate", "8/3/2024"}, {"txtQuoteValue", "16"}}, "btnUpdateQuote", ""}});
    EXPECT_EQ(rows("lstQuotes")[3], "08/03/2024\t16.00");

    select("lstQuotes", 1);
    select("lstQuotes", 3, true);
    EXPECT_EQ(text("txtQuoteDate") + ' ' + text("txtQuoteValue"), "06/03/2024 13.00");
    follow({{{{"txtSplitRangeNum", "1"}, {"txtSplitRangeDenum", "2"}}, "btnSplitQuotes", ""}});
    EXPECT_THAT(rows("lstQuotes"),
                ElementsAre("01/03/2024\t10.00", "06/03/2024\t6.50", "07/03/2024\t14.00", "08/03/2024\t8.00"));
    EXPECT_EQ(list("lstQuotes").CountSelected(), 2);
    click("btnRemoveQuote");
    EXPECT_THAT(rows("lstQuotes"), ElementsAre("01/03/2024\t10.00", "07/03/2024\t14.00"));
    selectAll("lstQuotes");
    click("btnRemoveQuote");
    EXPECT_EQ(company()->getNbrQuotes(), 0U);
    select("lstCompanies", 0);
    EXPECT_EQ(text("txtRelativeDailyChange"), "?") << "there is no trend to divide by";
}

TEST_F(QuoteTest, ChartShowsQuotesAndTrendAndABandOnRequest)
{
    addSmallCatalogue();
    auto& chart = dynamic_cast<GraphView&>(*window().FindView("CompanyView")->FindView("grvQuotes"));
    const auto legend = [&chart] { return std::string(chart.getXLegend().getCharacterArray()); };
    // Legend, and least and greatest value of each element.
    const auto extremes = [](const auto& poly) {
        std::ostringstream text;
        text << poly.getLegend().getCharacterArray() << ' ' << poly.getMinY() << ' ' << poly.getMaxY();
        return text.str();
    };
    const auto shown = [&] {
        std::vector<std::string> texts;
        for (const GraphElement* element : all(chart, &GraphView::getAllGraphElements)) {
            const auto* line = dynamic_cast<const GraphLine*>(element);
            texts.push_back(line != nullptr ? extremes(*line) : extremes(dynamic_cast<const GraphPolygon&>(*element)));
        }
        return texts;
    };
    EXPECT_EQ(legend(), "Value in EUR");
    EXPECT_THAT(shown(), UnorderedElementsAre("AL 10 20", "Trend 9.16667 19.1667", kBand + " 0 0"));
    click("cbWithSafe");
    // The quotes are 5/6, -10/6 and 5/6 from the trend: a deviation of 1.17851.
    EXPECT_THAT(shown(), testing::Contains(kBand + " 7.98816 20.3452"));
    addQuote("21/3/2024", "30");
    EXPECT_THAT(shown(), testing::Contains("AL 10 30"));
    click("cbWithSafe");
    EXPECT_THAT(shown(), testing::Contains(kBand + " 0 0"));
    select("lstCompanies", 0, true); // now none is
    EXPECT_EQ(legend(), "Value in ???");
    EXPECT_THAT(rows("lstQuotes"), IsEmpty());
}

class FetchCommandTest : public CatalogueTest {
protected:
    FetchCommandTest() { quoteServers() = {"localhost", "localhost", 1, std::chrono::seconds(1)}; } // nobody there
    ~FetchCommandTest() override { quoteServers() = before_; }

    /// Clicks while a server answers with `page`. @return the request.
    std::string clickWithServer(const char* button, const std::string& page)
    {
        std::string request;
        const Peer server([&](int client) {
            request = Peer::receiveLine(client);
            Peer::send(client, page);
        });
        quoteServers().port = server.port();
        click(button);
        return request;
    }

private:
    QuoteServers before_ = quoteServers();
};

TEST_F(FetchCommandTest, UpdateRenamesAndFetchesByTheFormerTicker)
{
    addSmallCatalogue();
    type("txtAbbreviation", "AX");
    type("txtName", "Alphax");
    click("btnUpdateCompany");
    EXPECT_EQ(message(), "Error Getting the latest quote on the Internet");
    EXPECT_THAT(rows("lstCompanies"), ElementsAre("AX\tAlphax")) << "it is renamed all the same";
    EXPECT_THAT(rows("lstQuotes"), SizeIs(3));

    type("txtAbbreviation", "AL");
    for (const char* price : {"30", "31"}) {
        const std::string page = std::string("<td nowrap><b>") + price + "</b></td>";
        EXPECT_EQ(clickWithServer("btnUpdateCompany", page),
                  price == std::string("30") ? "GET /quotes?symbol=AX\r\n" : "GET /quotes?symbol=AL\r\n");
        EXPECT_EQ(message(), "Successful update to the latest quote on the Internet");
        EXPECT_THAT(rows("lstQuotes"), SizeIs(4));
        EXPECT_EQ(rows("lstQuotes").back(), std::string("21/11/2024\t") + price + ".00");
    }
}

TEST_F(FetchCommandTest, ThreeMonthsComeInByMarketName)
{
    addSmallCatalogue();
    show(kPortoFolioPage);
    enter("txtDate", ""); // without a day nothing is valued, and the page is refreshed all the same
    show(kCompanyPage);
    click("btnSetLastThreeMonths");
    EXPECT_EQ(message(), "Error getting the last three months of quotes") << "Paris is not one of its markets";
    follow({{{{"txtMarketName", "NYSE"}}, "btnUpdateMarket", ""}});
    clickWithServer("btnSetLastThreeMonths", "(00s)</b>\r\n11/20/2024 21.5000 1\r\n11/19/2024 20.0000 1\r\n</table>");
    EXPECT_EQ(message(), "Last three months added...");
    EXPECT_THAT(rows("lstQuotes"), SizeIs(5));
    EXPECT_EQ(rows("lstQuotes").back(), "20/11/2024\t21.50");
}

TEST_F(FetchCommandTest, PortfolioQuotesComeInWithoutAValuation)
{
    addSmallCatalogue();
    buy(company());
    buy(new Company(company()->market(), "Other", "OT"));
    const TemporaryFolder tables("pelorin-gui-quotes");
    for (const char* table : {"AL.csv", "OT.csv"})
        tables.write(table, "2024-11-21,45\n");
    const ServerRun server(PELORIN_QUOTES, tables.path);
    quoteServers().port = server.port();
    show(kPortoFolioPage);
    click("btnUpdateAllQuotes");
    EXPECT_EQ(message(), "All portofolio quotes are up-to-date.");
    EXPECT_EQ(company()->getRealQuote(Date(21, 11, 2024)), 45);
    EXPECT_EQ(notice(), "2 of 2 quotes came");
    EXPECT_THAT(rows("lstShares"), ElementsAre(testing::HasSubstr("2,750.00 EUR"), testing::_))
        << "as it was valued before";
    quoteServers().port = 1;
    click("btnUpdateAllQuotes");
    EXPECT_EQ(message(), "All portofolio quotes are up-to-date.") << "also after a failure";
    show(kCompanyPage);
    EXPECT_EQ(rows("lstQuotes").back(), "21/11/2024\t45.00") << "the page of the selected company was told";
}

TEST_F(FetchCommandTest, ASilentServerIsAskedOnceAndEscapeEndsTheWait)
{
    addTwoMarkets();
    for (const Market* market : window().catalogue().getMarkets())
        buy(market->companies().front());
    show(kPortoFolioPage);
    QWidget& notice = anywhere("txtNotice");
    QWindow* handle = window().widget().windowHandle();
    // Keys belong to a keyboard, which Qt makes with the first of them: here, and not in the server's thread.
    QInputDevice::primaryKeyboard();
    for (const bool isEscaped : {false, true}) {
        const Peer server([&](int client) {
            Peer::receiveLine(client);
            if (isEscaped) {
                using Key = QKeyEvent;
                QCoreApplication::postEvent(handle, new Key(QEvent::KeyPress, Qt::Key_1, Qt::AltModifier));
                QCoreApplication::postEvent(handle, new Key(QEvent::KeyPress, Qt::Key_Escape, Qt::NoModifier));
            }
            Peer::waitForEnd(client);
        });
        const std::chrono::milliseconds limit(isEscaped ? 20000 : 1000);
        quoteServers() = {"localhost", "localhost", server.port(), limit};
        const auto start = std::chrono::steady_clock::now();
        click("btnUpdateAllQuotes");
        EXPECT_LT(std::chrono::steady_clock::now() - start, isEscaped ? limit / 4 : 2 * limit);
        EXPECT_EQ(message(), "All portofolio quotes are up-to-date.");
        EXPECT_EQ(notice.accessibleName().toStdString(),
                  std::string("0 of 2 quotes came: ") +
                      (isEscaped ? "Escape has ended it" : "the server localhost did not answer, and not asked again") +
                      "; none for AAA, BBB");
    }
    EXPECT_TRUE(isVisible("lstCompanies")) << "what was pressed besides has come in its turn";
}

TEST_F(QuoteTest, ManyRowsAreFoundSelectedAndRemovedTogether)
{
    constexpr int kQuotes = 15000;
    addSmallCatalogue();
    for (int i = 1; i < kQuotes - 2; ++i)
        new CompanyQuote(company(), Date(Date(11, 3, 2024)).moveBy(-10 - i), 10);
    for (int i = 1; i < 2000; ++i)
        new Company(window().catalogue().getMarkets()[0], "Many", ("T" + std::to_string(i)).c_str());
    window().MarketSelection();
    window().CompanySelection();
    settle();
    ASSERT_EQ(list("lstQuotes").CountItems(), kQuotes);
    select("lstQuotes", 100);
    const int32 top = list("lstQuotes").TopRow();
    BListItem* row = list("lstQuotes").ItemAt(100);
    window().UpdateState(); // which refreshes the page
    settle();
    EXPECT_EQ(list("lstQuotes").ItemAt(100), row);
    EXPECT_EQ(list("lstQuotes").CurrentSelection(), 100);
    EXPECT_EQ(list("lstQuotes").TopRow(), top);

    selectAll("lstQuotes");
    follow({{{{"txtSplitRangeNum", "3"}, {"txtSplitRangeDenum", "1"}}, "btnSplitQuotes", ""}});
    EXPECT_EQ(list("lstQuotes").CountSelected(), kQuotes);
    EXPECT_EQ(rows("lstQuotes").back(), "11/03/2024\t60.00");
    click("btnRemoveQuote");
    EXPECT_EQ(list("lstQuotes").CountItems(), 0);
    select("lstCompanies", 0);
    QTest::keyClicks(list("lstCompanies").widget(), "T1234");
    settle();
    EXPECT_EQ(text("txtAbbreviation"), "T1234");
}

} // namespace
