// The company and the currency page: a catalogue kept by hand.

#include "market/Company.h"
#include "market/Currency.h"
#include "market/Market.h"
#include "market/NoteCompanyEvent.h"
#include "market/SplitCompanyEvent.h"
#include "net/QuoteServers.h"
#include "platform/ListItem.h"
#include "platform/ListView.h"
#include "portfolio/Account.h"
#include "portfolio/Share.h"
#include "portfolio/ShareOperation.h"
#include "portfolio/Wallet.h"
#include "tests/gui/WindowFixture.h"
#include "tests/support/Peer.h"
#include "tests/support/ToolRun.h"

#include <QAbstractItemView>
#include <QComboBox>
#include <QLineEdit>
#include <QPlainTextEdit>
#include <QTest>
#include <gmock/gmock.h>

namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

class CatalogueTest : public WindowTest {
protected:
    /// A click on a button, with what is typed before it and what the status line says then.
    struct Step {
        std::vector<std::pair<const char*, const char*>> fields;
        const char* button;
        const char* message;
    };
    void follow(const std::vector<Step>& steps)
    {
        for (const auto& step : steps) {
            for (const auto& [field, typed] : step.fields)
                type(field, typed);
            clearMessage();
            click(step.button);
            EXPECT_EQ(message(), step.message) << step.button;
        }
    }

    void addCurrency(const char* name, const char* symbol)
    {
        show(kCurrencyPage);
        follow({{{{"txtCurrencyName", name}, {"txtCurrencyRepresentation", symbol}}, "btnAddCurrency", ""}});
    }
    void addMarket(const char* name, const char* symbol)
    {
        show(kCompanyPage);
        follow({{{{"txtMarketName", name}, {"txtMarketCurrencyRepresentation", symbol}}, "btnAddMarket", ""}});
    }
    void addCompany(const char* ticker, const char* name)
    {
        follow({{{{"txtAbbreviation", ticker}, {"txtName", name}}, "btnAddCompany", ""}});
    }
    void addQuote(const char* date, const char* value)
    {
        follow({{{{"txtQuoteDate", date}, {"txtQuoteValue", value}}, "btnAddQuote", ""}});
    }
    /// Two currencies, a market in the first one, and a company with three quotes, which is selected.
    void addSmallCatalogue()
    {
        addCurrency("Euro", "EUR");
        addQuote("1/1/2024", "1");
        addCurrency("Dollar", "USD");
        addQuote("1/1/2024", "2");
        addMarket("Paris", "EUR");
        addCompany("AL", "Alpha");
        addQuote("1/3/2024", "10");
        addQuote("11/3/2024", "20");
        addQuote("6/3/2024", "12.5");
    }
    /// A purchase of ten shares of the company, on the operation page's list.
    Share* buy(Company* company)
    {
        auto* account = new Account("Cash");
        account->setWallet(&wallet());
        account->setCurrency(window().getReferenceCurrency());
        auto* share = new Share(&wallet(), company);
        (new ShareOperation(Date(2, 3, 2024), share, true, 10, 11, false, 0))->setAccount(account);
        window().UpdateState();
        return share;
    }
    Currency* currency(unsigned i) { return window().catalogue().getCurrencies()[i]; }
    Company* company()
    {
        Company* found = nullptr;
        window().catalogue().getMarkets()[0]->getCompany("AL", &found);
        return found;
    }
    void selectAll(const char* name)
    {
        select(name, 0);
        QTest::keyClick(list(name).widget(), Qt::Key_A, Qt::ControlModifier);
        settle();
    }
    /// Whether the field tells that it does not understand its text.
    bool isMarked(const char* field) { return !find<QLineEdit>(field).toolTip().isEmpty(); }
};

TEST_F(CatalogueTest, CompanyPageChecksInOrder)
{
    show(kCompanyPage);
    follow({
        {{}, "btnAddMarket", "Please specify a market name."},
        {{{"txtMarketName", "Paris"}}, "btnAddMarket", "Please specify a currency representation."},
        {{{"txtMarketCurrencyRepresentation", "EUR"}}, "btnAddMarket", "Unknown currency..."},
        {{}, "btnUpdateMarket", ""},
        {{}, "btnAddCompany", "Please first create a market."},
        {{}, "btnUpdateCompany", ""},
        {{}, "btnSetLastThreeMonths", ""},
        {{}, "btnAddQuote", "Please specify a date."},
        {{{"txtQuoteDate", "1/1/2024"}}, "btnAddQuote", "You must first select a company"},
        {{{"txtQuoteDate", ""}}, "btnUpdateQuote", "You must first select a quote"},
        {{}, "btnRemoveQuote", ""},
        {{}, "btnSplitQuotes", "Please specify a factor (ex: 1:2)"},
        {{{"txtSplitRangeNum", "1"}, {"txtSplitRangeDenum", "0"}},
         "btnSplitQuotes",
         "Please specify a factor (ex: 1:2)"},
        {{{"txtSplitRangeDenum", "2"}}, "btnSplitQuotes", ""},
        {{}, "btnAddCompanyEvent", "You must first select a company"},
        {{}, "btnUpdateCompanyEvent", "Please specify a date."},
        {{{"txtCompanyEventDate", "1/1/2024"}},
         "btnUpdateCompanyEvent",
         "Please select a company event if you want to update."},
        {{}, "btnRemoveCompanyEvent", ""},
    });
    EXPECT_THAT(alerts(), IsEmpty());
    addSmallCatalogue();
    follow({
        {{{"txtAbbreviation", ""}}, "btnAddCompany", "Please specify an abbreviation for your company"},
        {{{"txtCompanyEventDate", "31/2/2024"}}, "btnAddCompanyEvent", "Please specify a date."},
    });
    select("lstQuotes", 0);
    follow({{{{"txtQuoteDate", "99"}}, "btnUpdateQuote", "Please specify a date."}});
    EXPECT_THAT(rows("lstQuotes"), ElementsAre("01/03/2024\t10.00", "06/03/2024\t12.50", "11/03/2024\t20.00"));
    EXPECT_THAT(rows("lstCompanies"), SizeIs(1));
    EXPECT_THAT(rows("lstCompanyEvents"), IsEmpty());
}

TEST_F(CatalogueTest, CurrencyPageChecksInOrder)
{
    const char* incomplete = "Please specify a currency name and representation.";
    show(kCurrencyPage);
    follow({
        {{}, "btnAddCurrency", incomplete},
        {{{"txtCurrencyName", "Euro"}}, "btnAddCurrency", incomplete},
        {{{"txtCurrencyName", ""}, {"txtCurrencyRepresentation", "EUR"}}, "btnAddCurrency", incomplete},
        {{}, "btnUpdateCurrency", ""},
        {{}, "btnSetReferenceCurrency", "Please select a currency."},
        {{}, "btnAddQuote", "Please specify a date."},
        {{{"txtQuoteDate", "1.1.2024"}}, "btnAddQuote", "You must first select a currency"},
        {{}, "btnUpdateQuote", "You must first select a quote"},
        {{}, "btnRemoveQuote", ""},
    });
    EXPECT_THAT(rows("lstCurrencies"), IsEmpty());
    addCurrency("Euro", "EUR");
    follow({{{}, "btnRemoveCurrency", "You may not remove the last currency..."}});
    addQuote("1/1/2024", "1");
    select("lstQuotes", 0);
    follow({{{{"txtQuoteDate", ""}}, "btnUpdateQuote", "Please specify a date."}});
    EXPECT_THAT(rows("lstQuotes"), ElementsAre("01/01/2024\t1.00"));
    EXPECT_THAT(alerts(), IsEmpty());
}

TEST_F(CatalogueTest, CatalogueByHandIsSavedAndComesBackTheSame)
{
    addSmallCatalogue();
    choose("companyEventType", "Note");
    find<QPlainTextEdit>("txtCompanyEventText").setPlainText("Sales rose.\nMargins fell.");
    follow({{{{"txtCompanyEventDate", "5-4-2024"}, {"txtCompanyEventTitle", "Report"}}, "btnAddCompanyEvent", ""}});
    choose("companyEventType", "Split");
    follow({{{{"txtCompanyEventDate", "4/4/2024"}, {"txtEventSplitRangeNum", "2"}, {"txtEventSplitRangeDenum", "3"}},
             "btnAddCompanyEvent",
             ""}});
    click("btnSaveMarket");
    answerPanel("SavePanel", "ByHand");
    const std::string saved = contentOf(folder() + "/Companies/ByHand");
    EXPECT_FALSE(saved.empty());

    restart();
    show(kCompanyPage);
    click("btnLoadMarket");
    answerPanel("OpenPanel", folder() + "/Companies/ByHand");
    EXPECT_THAT(rows("lstMarkets"), ElementsAre("Paris\tEUR\t1"));
    select("lstMarkets", 0);
    EXPECT_THAT(rows("lstCompanies"), ElementsAre("AL\tAlpha"));
    select("lstCompanies", 0);
    EXPECT_EQ(text("txtRelativeDailyChange"), "5.2174 %") << "a rise of 1 a day, at a trend of 19.17";
    EXPECT_EQ(text("txtDiffWithAverage"), "4.35 %");
    EXPECT_THAT(rows("lstQuotes"), ElementsAre("01/03/2024\t10.00", "06/03/2024\t12.50", "11/03/2024\t20.00"));
    EXPECT_THAT(rows("lstCompanyEvents"), ElementsAre("04/04/2024\tSplit\t2 : 3", "05/04/2024\tNote\tReport"));
    select("lstCompanyEvents", 1);
    EXPECT_EQ(find<QPlainTextEdit>("txtCompanyEventText").toPlainText().toStdString(), "Sales rose.\nMargins fell.");
    show(kCurrencyPage);
    EXPECT_THAT(rows("lstCurrencies"), ElementsAre("Euro\tEUR\t1.00\t01/01/2024", "Dollar\tUSD\t2.00\t01/01/2024"));
    EXPECT_EQ(text("txtReferenceCurrencyName"), "Euro");
    select("lstCurrencies", 0);
    EXPECT_THAT(rows("lstMarkets"), ElementsAre("Paris\tEUR\t1"));
    click("btnSaveMarket");
    EXPECT_EQ(contentOf(folder() + "/Companies/ByHand"), saved);
}

TEST_F(CatalogueTest, FieldsReadDatesAndNumbersAsTypedAndMarkWhatTheyCannot)
{
    addSmallCatalogue();
    const struct {
        const char* date;
        const char* value;
        const char* row; // null: not added
        bool isDateMarked, isValueMarked;
    } cases[] = {
        {"2.3.2024", "1,5", "02/03/2024\t1.50", false, false},
        {"2-3-2024", "0.123456789", "02/03/2024\t0.12345679", false, false},
        {"02/03/2024", "", "02/03/2024\t0.00", false, false},
        {"2/3/2024", "abc", "02/03/2024\t0.00", false, true},
        {"2/3/2024", "12 EUR", "02/03/2024\t12.00", false, true},
        {"2/3/99", "-7", "02/03/99\t-7.00", false, false},
        {"30/2/2024", "1", nullptr, true, false},
        {"2/3", "1", nullptr, true, false},
    };
    for (const auto& c : cases) {
        type("txtQuoteDate", c.date);
        type("txtQuoteValue", c.value);
        EXPECT_EQ(isMarked("txtQuoteDate"), c.isDateMarked) << c.date;
        EXPECT_EQ(isMarked("txtQuoteValue"), c.isValueMarked) << c.value;
        click("btnAddQuote");
        if (c.row != nullptr) {
            EXPECT_THAT(rows("lstQuotes"), testing::Contains(c.row));
        }
    }
    EXPECT_THAT(rows("lstQuotes"), SizeIs(5)) << "the days of 2024, and one of the first century";
    select("lstQuotes", 0);
    EXPECT_FALSE(isMarked("txtQuoteDate"));
}

TEST_F(CatalogueTest, AQuoteIsReplacedMovedAndKeptBesideAnotherOfItsDay)
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
    EXPECT_EQ(text("txtQuoteDate"), "06/03/2024");
    follow({{{{"txtSplitRangeNum", "1"}, {"txtSplitRangeDenum", "2"}}, "btnSplitQuotes", ""}});
    EXPECT_THAT(rows("lstQuotes"),
                ElementsAre("01/03/2024\t10.00", "06/03/2024\t6.50", "07/03/2024\t14.00", "08/03/2024\t8.00"));
    EXPECT_EQ(list("lstQuotes").CountSelected(), 2);
    click("btnRemoveQuote");
    EXPECT_THAT(rows("lstQuotes"), ElementsAre("01/03/2024\t10.00", "07/03/2024\t14.00"));
    selectAll("lstQuotes");
    click("btnRemoveQuote");
    EXPECT_THAT(rows("lstQuotes"), IsEmpty());
    EXPECT_EQ(company()->getNbrQuotes(), 0U);
    select("lstCompanies", 0);
    EXPECT_EQ(text("txtRelativeDailyChange"), "?") << "there is no trend to divide by";
}

TEST_F(CatalogueTest, EventFieldsFollowTheKindAndAnUpdateTakesItFromTheMenu)
{
    addSmallCatalogue();
    EXPECT_TRUE(isVisible("txtEventSplitRangeNum") && !isVisible("txtCompanyEventTitle"));
    EXPECT_EQ(text("txtEventSplitRangeNum") + ":" + text("txtEventSplitRangeDenum"), "1:2");
    follow({{{{"txtCompanyEventDate", "1/4/2024"}, {"txtEventSplitRangeNum", "99999"}}, "btnAddCompanyEvent", ""}});
    EXPECT_THAT(rows("lstCompanyEvents"), ElementsAre("01/04/2024\tSplit\t32767 : 2"));
    EXPECT_EQ(list("lstCompanyEvents").CurrentSelection(), 0);

    choose("companyEventType", "Note");
    EXPECT_TRUE(!isVisible("txtEventSplitRangeNum") && isVisible("txtCompanyEventText"));
    follow({{{{"txtCompanyEventDate", "9/9/2024"}, {"txtCompanyEventTitle", "New"}}, "btnUpdateCompanyEvent", ""}});
    EXPECT_THAT(rows("lstCompanyEvents"), ElementsAre("01/04/2024\tNote\tNew")) << "on the day where it stood";
    follow({{{{"txtCompanyEventTitle", "Newer"}}, "btnUpdateCompanyEvent", ""},
            {{{"txtCompanyEventDate", "1/1/2024"}, {"txtCompanyEventTitle", "Old"}}, "btnAddCompanyEvent", ""}});
    EXPECT_THAT(rows("lstCompanyEvents"), ElementsAre("01/01/2024\tNote\tOld", "01/04/2024\tNote\tNewer"));
    EXPECT_EQ(text("txtCompanyEventTitle"), "Old") << "the new one is selected";

    select("lstCompanyEvents", 0, true); // now none is
    EXPECT_EQ(text("txtCompanyEventDate"), "");
    EXPECT_EQ(text("txtCompanyEventTitle"), " ");
    selectAll("lstCompanyEvents");
    click("btnRemoveCompanyEvent");
    EXPECT_THAT(rows("lstCompanyEvents"), IsEmpty());
    EXPECT_EQ(company()->getNbrEvents(), 0U);
}

TEST_F(CatalogueTest, RenamingReachesBothPagesAndTheOperations)
{
    addSmallCatalogue();
    buy(company());
    follow({{{{"txtMarketName", "Lyon"}, {"txtMarketCurrencyRepresentation", "USD"}}, "btnUpdateMarket", ""}});
    EXPECT_THAT(rows("lstMarkets"), ElementsAre("Lyon\tEUR\t1")) << "the currency is not changed";
    show(kCurrencyPage);
    select("lstCurrencies", 0);
    EXPECT_THAT(rows("lstMarkets"), ElementsAre("Lyon\tEUR\t1"));
    follow({{{{"txtCurrencyName", "Ecu"}, {"txtCurrencyRepresentation", "XEU"}}, "btnUpdateCurrency", ""}});
    EXPECT_EQ(text("txtReferenceCurrencyName"), "Ecu");
    show(kPortoFolioPage);
    EXPECT_THAT(rows("lstAccounts"), ElementsAre(testing::HasSubstr("XEU")));
}

TEST_F(CatalogueTest, RemovalsAskAndTakeTheSharesAlong)
{
    const struct {
        const char* button;
        const char* question;
        std::size_t markets, companies;
    } cases[] = {
        {"btnRemoveCompany", "This will delete all attached share operations...", 1, 0},
        {"btnRemoveMarket", "This will delete all attached companies and share operations...", 0, 0},
    };
    for (const auto& c : cases) {
        restart();
        addSmallCatalogue();
        buy(company());
        answerNextAlert("Cancel");
        click(c.button);
        EXPECT_EQ(wallet().getNbrShares(), 1U);
        answerNextAlert("Continue");
        click(c.button);
        EXPECT_THAT(alerts(), ElementsAre(c.question, c.question));
        EXPECT_EQ(wallet().getNbrShares(), 0U);
        EXPECT_EQ(wallet().getAccount(0)->getNbrOperations(), 0U);
        EXPECT_THAT(rows("lstMarkets"), SizeIs(c.markets));
        EXPECT_THAT(rows("lstCompanies"), SizeIs(c.companies));
        EXPECT_THAT(rows("lstQuotes"), IsEmpty());
        show(kOperationPage);
        EXPECT_THAT(rows("lstOperations"), IsEmpty());
        show(kCompanyPage);
        answerNextAlert("Continue"); // nothing is selected now
        click("btnRemoveCompany");
        EXPECT_EQ(message(), "");
        EXPECT_THAT(alerts(), SizeIs(1));
    }
}

TEST_F(CatalogueTest, FirstCurrencyIsTheReferenceAndAnotherOneRebasesTheRates)
{
    addSmallCatalogue();
    EXPECT_EQ(window().getReferenceCurrency(), currency(0));
    show(kCurrencyPage);
    select("lstCurrencies", 0);
    click("btnSetReferenceCurrency");
    EXPECT_EQ(currency(1)->getRealQuote(Date(1, 1, 2024)), 2) << "it was the reference";
    select("lstCurrencies", 1);
    EXPECT_THAT(rows("lstQuotes"), ElementsAre("01/01/2024\t2.00"));
    click("btnSetReferenceCurrency");
    EXPECT_EQ(text("txtReferenceCurrencyName"), "Dollar");
    EXPECT_THAT(rows("lstQuotes"), ElementsAre("01/01/2024\t1.00"));
    EXPECT_THAT(rows("lstCurrencies"), ElementsAre("Euro\tEUR\t0.50\t01/01/2024", "Dollar\tUSD\t1.00\t01/01/2024"));
}

TEST_F(CatalogueTest, RemovedReferenceHandsOverToTheFirstAndTakesItsMarketsAlong)
{
    addSmallCatalogue();
    addCurrency("Pound", "GBP");
    addQuote("1/1/2024", "4");
    buy(company());
    answerNextAlert("Cancel");
    click("btnRemoveCurrency");
    EXPECT_EQ(window().catalogue().getNbrCurrencies(), 3U);
    select("lstCurrencies", 0);
    answerNextAlert("Continue");
    click("btnRemoveCurrency");
    EXPECT_THAT(alerts(), testing::Each("This will delete all attached markets, companies and accounts..."));
    EXPECT_THAT(rows("lstCurrencies"), ElementsAre("Pound\tGBP\t1.00\t01/01/2024", "Dollar\tUSD\t0.50\t01/01/2024"))
        << "the last one comes first now, and the rates are in it";
    EXPECT_EQ(text("txtReferenceCurrencyName"), "Pound");
    EXPECT_THAT(rows("lstMarkets"), IsEmpty());
    EXPECT_EQ(wallet().getNbrShares(), 0U);
    ASSERT_EQ(wallet().getNbrAccounts(), 1U) << "the account stays, without a currency";
    Currency* stored;
    EXPECT_EQ(wallet().getAccount(0)->getCurrency(&stored), -1);
    currency(1)->getReferenceCurrency(&stored);
    EXPECT_EQ(stored, currency(0)) << "nobody stores the one that is gone";
    show(kCompanyPage);
    EXPECT_THAT(rows("lstMarkets"), IsEmpty());

    window().RemoveAllCurrencies();
    EXPECT_EQ(window().catalogue().getNbrCurrencies(), 0U);
    EXPECT_EQ(window().getReferenceCurrency(), nullptr);
    addCurrency("Euro", "EUR");
    EXPECT_EQ(text("txtReferenceCurrencyName"), "Euro");
}

TEST_F(CatalogueTest, FiguresOfASelectedCurrencyShowOnTheCompanyPage)
{
    addSmallCatalogue();
    show(kCurrencyPage);
    select("lstCurrencies", 1);
    addQuote("11/1/2024", "3");
    select("lstCurrencies", 0);
    select("lstCurrencies", 1);
    EXPECT_EQ(text("txtRelativeDailyChange"), "");
    show(kCompanyPage);
    EXPECT_EQ(text("txtRelativeDailyChange"), "3.3333 %");
    EXPECT_EQ(text("txtDiffWithAverage"), "0.00 %");
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
    show(kPortoFolioPage);
    clickWithServer("btnUpdateAllQuotes", "<td nowrap><b>45</b></td>");
    EXPECT_EQ(message(), "All portofolio quotes are up-to-date.");
    EXPECT_EQ(company()->getRealQuote(Date(21, 11, 2024)), 45);
    EXPECT_THAT(rows("lstShares"), ElementsAre(testing::HasSubstr("2,750.00 EUR"))) << "as it was valued before";
    quoteServers().port = 1;
    click("btnUpdateAllQuotes");
    EXPECT_EQ(message(), "All portofolio quotes are up-to-date.") << "also after a failure";
    show(kCompanyPage);
    EXPECT_EQ(rows("lstQuotes").back(), "21/11/2024\t45.00") << "the page of the selected company was told";
}

class LongListTest : public CatalogueTest {
protected:
    static constexpr int kQuotes = 15000;
    static constexpr int kCompanies = 2000;

    LongListTest()
    {
        addSmallCatalogue();
        for (int i = 1; i < kQuotes - 2; ++i)
            new CompanyQuote(company(), Date(Date(11, 3, 2024)).moveBy(-10 - i), 10);
        for (int i = 1; i < kCompanies; ++i)
            new Company(window().catalogue().getMarkets()[0], "Many", ("T" + std::to_string(i)).c_str());
        window().MarketSelection();
        window().CompanySelection();
        settle();
    }
};

TEST_F(LongListTest, ManyRowsAreFoundSelectedAndRemovedTogether)
{
    ASSERT_EQ(list("lstQuotes").CountItems(), kQuotes);
    ASSERT_EQ(list("lstCompanies").CountItems(), kCompanies);
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
