// The company and the currency page: a catalogue kept by hand. Quotes are in QuoteTest.cpp, refusals in
// RefusalTest.cpp.

#include "market/NoteCompanyEvent.h"
#include "net/QuoteServers.h"
#include "tests/gui/CatalogueFixture.h"
#include "tests/support/ToolRun.h"

#include <QPlainTextEdit>

namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

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
    loadMarkets(folder() + "/Companies/ByHand");
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
    EXPECT_EQ(text("txtCurrencyName") + ' ' + text("txtCurrencyRepresentation"), "Euro EUR");
    click("btnSaveMarket");
    EXPECT_EQ(contentOf(folder() + "/Companies/ByHand"), saved);
    select("lstCurrencies", 1);
    addQuote("11/1/2024", "3");
    select("lstCurrencies", 0);
    select("lstCurrencies", 1);
    show(kCompanyPage);
    EXPECT_EQ(text("txtRelativeDailyChange"), "3.3333 %") << "of the currency that was selected last";
    const auto hasTitle = [&](const char* title) {
        const auto parts = find<QWidget>("lstCompanies").parentWidget();
        return parts->accessibleName() == title;
    };
    EXPECT_TRUE(hasTitle("Companies - trend of the currency USD"));
    window().CompanySelection();
    EXPECT_TRUE(hasTitle("Companies"));
}

TEST_F(CatalogueTest, AnAdditionIsToldAndADoubleClickAddsOnce)
{
    addSmallCatalogue();
    const auto addTwice = [this](const char* name) {
        auto& button = find<QWidget>(name);
        QTest::mouseClick(&button, Qt::LeftButton);
        settle();
        QTest::mouseDClick(&button, Qt::LeftButton);
        settle();
    };
    EXPECT_EQ(notice(), "Added quote of AL");
    select("lstCompanies", 0); // which shows its trend
    fill({{"txtAbbreviation", "BE"}, {"txtName", "Beta"}});
    addTwice("btnAddCompany");
    EXPECT_EQ(list("lstCompanies").CountItems(), 2);
    EXPECT_EQ(notice(), "Added company BE");
    fill({{"txtMarketName", "London"}});
    click("btnUpdateMarket");
    EXPECT_EQ(notice(), "Updated market London");
    show(kCurrencyPage);
    fill({{"txtQuoteDate", "5/3/2024"}, {"txtQuoteValue", "3"}});
    fill({{"txtCurrencyName", "Yen"}, {"txtCurrencyRepresentation", "JPY"}});
    addTwice("btnAddCurrency");
    EXPECT_EQ(list("lstCurrencies").CountItems(), 3);
    EXPECT_EQ(notice(), "Added currency Yen");
}

TEST_F(CatalogueTest, EventFieldsFollowTheKindAndAnUpdateTakesItFromTheMenu)
{
    addSmallCatalogue();
    EXPECT_TRUE(isVisible("txtEventSplitRangeNum") && !isVisible("txtCompanyEventTitle"));
    follow({{{{"txtCompanyEventDate", "1/4/2024"}, {"txtEventSplitRangeNum", "99999"}}, "btnAddCompanyEvent", ""}});
    EXPECT_THAT(rows("lstCompanyEvents"), ElementsAre("01/04/2024\tSplit\t32767 : 2"));
    choose("companyEventType", "Note");
    EXPECT_TRUE(!isVisible("txtEventSplitRangeNum") && isVisible("txtCompanyEventText"));
    follow({{{{"txtCompanyEventDate", "9/9/2024"}, {"txtCompanyEventTitle", "New"}}, "btnUpdateCompanyEvent", ""}});
    EXPECT_THAT(rows("lstCompanyEvents"), ElementsAre("01/04/2024\tNote\tNew")) << "on the day where it stood";
    follow({{{{"txtCompanyEventTitle", "Newer"}}, "btnUpdateCompanyEvent", ""},
            {{{"txtCompanyEventDate", "1/1/2024"}, {"txtCompanyEventTitle", "Old"}}, "btnAddCompanyEvent", ""}});
    EXPECT_THAT(rows("lstCompanyEvents"), ElementsAre("01/01/2024\tNote\tOld", "01/04/2024\tNote\tNewer"));

    select("lstCompanyEvents", 0, true); // the new one was, and now none is
    EXPECT_EQ(text("txtCompanyEventDate") + text("txtCompanyEventTitle"), " ");
    selectAll("lstCompanyEvents");
    click("btnRemoveCompanyEvent");
    EXPECT_EQ(company()->getNbrEvents(), 0U);
}

TEST_F(CatalogueTest, WhatNobodyTypedComesBackByteForByte)
{
    addSmallCatalogue();
    const String name("Par\xEDs\r\n");        // no UTF-8, as other programs' names may be
    const String note("a\r\n\xC2\xA0 b\xFF"); // line ends and blanks that the field shows otherwise
    window().catalogue().getMarkets()[0]->setName(name);
    auto* event = new NoteCompanyEvent(company(), Date(1, 4, 2024), name, note);
    window().CompanySelection();
    window().MarketSelection();
    select("lstCompanyEvents", 0);
    click("btnUpdateMarket");
    click("btnUpdateCompanyEvent");
    EXPECT_EQ(window().catalogue().getMarkets()[0]->getName(), name);
    EXPECT_EQ(event->getTitle(), name);
    EXPECT_EQ(event->getText(), note);
}

TEST_F(CatalogueTest, OfALongTextTheBeginningShowsAndNothingIsLost)
{
    addSmallCatalogue();
    const auto longText = [](const char* name) {
        std::string text = name;
        while (text.size() < 200'000)
            text += "\u20AC"; // which no cut may tear apart
        return text;
    };
    const std::string name = longText("Name");
    const std::string note = longText("Note");
    Market* market = window().catalogue().getMarkets()[0];
    Company* alpha = company();
    market->setName(name.c_str());
    alpha->setName(name.c_str());
    alpha->setAbbreviation(name.c_str());
    auto* event = new NoteCompanyEvent(alpha, Date(1, 4, 2024), name.c_str(), note.c_str());
    window().CompanySelection();
    window().MarketSelection();
    select("lstCompanyEvents", 0);
    auto& field = find<QPlainTextEdit>("txtCompanyEventText");
    EXPECT_LT(field.toPlainText().size(), 30'000);
    for (const std::string& shown : {rows("lstMarkets")[0], rows("lstCompanies")[0], rows("lstCompanyEvents")[0],
                                     text("txtMarketName"), text("txtName"), text("txtCompanyEventTitle")}) {
        EXPECT_LT(shown.size(), 5000U);
        EXPECT_THAT(shown, testing::HasSubstr("\u20AC\u2026"));
    }

    const QuoteServers servers = std::exchange(quoteServers(), {"localhost", "localhost", 1, std::chrono::seconds(1)});
    for (const char* button : {"btnUpdateMarket", "btnUpdateCompany", "btnUpdateCompanyEvent"})
        click(button);
    quoteServers() = servers;
    EXPECT_TRUE(market->getName() == name.c_str() && alpha->getName() == name.c_str() &&
                alpha->getAbbreviation() == name.c_str());
    EXPECT_TRUE(event->getTitle() == name.c_str() && event->getText() == note.c_str());
    // What is typed before and behind the mark leaves what it stands for.
    QTest::keyClicks(&field, "My ");
    QTest::keyClick(&field, Qt::Key_End, Qt::ControlModifier);
    QTest::keyClicks(&field, "!");
    type("txtCompanyEventTitle", "New");
    click("btnUpdateCompanyEvent");
    EXPECT_TRUE(event->getText() == ("My " + note + '!').c_str());
    EXPECT_EQ(event->getTitle(), String("New"));

    buy(alpha);
    wallet().getAccount(0)->setName(name.c_str());
    show(kPortoFolioPage);
    select("lstAccounts", 0);
    follow({{{}, "btnUpdateQuote", ""}}); // fills the menus of the accounts, too
    show(kOperationPage);
    select("lstOperations", 0);
    EXPECT_LT(find<QComboBox>("baseAccount").currentText().size(), 1000);
    follow({{{{"txtQuantity", "12"}}, "btnUpdateOperation", ""}});
    EXPECT_EQ(wallet().getAccount(0)->getName(), name.c_str());
    ASSERT_EQ(wallet().getAccount(0)->getNbrOperations(), 1U);
    EXPECT_EQ(static_cast<ShareOperation*>(wallet().getAccount(0)->getOperation(0))->getQuantity(), 12);
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
        std::size_t markets;
    } cases[] = {
        {"btnRemoveCompany", "This will delete all attached share operations...", 1},
        {"btnRemoveMarket", "This will delete all attached companies and share operations...", 0},
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
        EXPECT_THAT(rows("lstMarkets"), SizeIs(c.markets));
        EXPECT_THAT(rows("lstCompanies"), IsEmpty());
        answerNextAlert("Continue"); // nothing is selected now
        click("btnRemoveCompany");
        EXPECT_THAT(alerts(), SizeIs(1));
        show(kOperationPage);
        EXPECT_THAT(rows("lstOperations"), IsEmpty());
    }
}

TEST_F(CatalogueTest, AnotherReferenceRebasesTheRatesAndARemovedOneHandsOver)
{
    addSmallCatalogue();
    addCurrency("Pound", "GBP");
    addQuote("1/1/2024", "4");
    buy(company());
    show(kPortoFolioPage);
    const std::string value = text("txtTotalValue");
    show(kCurrencyPage);
    select("lstCurrencies", 1);
    click("btnSetReferenceCurrency");
    EXPECT_EQ(text("txtReferenceCurrencyName"), "Dollar");
    EXPECT_THAT(rows("lstQuotes"), ElementsAre("01/01/2024\t1.00"));
    show(kPortoFolioPage);
    EXPECT_NE(text("txtTotalValue"), value) << "it is in the new reference";

    show(kCurrencyPage);
    select("lstCurrencies", 0);
    click("btnSetReferenceCurrency");
    answerNextAlert("Cancel");
    click("btnRemoveCurrency");
    EXPECT_THAT(rows("lstCurrencies"), SizeIs(3));
    answerNextAlert("Continue");
    click("btnRemoveCurrency");
    EXPECT_THAT(alerts(), testing::Each("This will delete all attached markets, companies and accounts..."));
    EXPECT_THAT(rows("lstCurrencies"), ElementsAre("Pound\tGBP\t1.00\t01/01/2024", "Dollar\tUSD\t0.50\t01/01/2024"))
        << "the last one comes first now, and the rates are in it";
    EXPECT_EQ(text("txtReferenceCurrencyName"), "Pound");
    EXPECT_EQ(wallet().getNbrShares(), 0U);
    Currency* stored;
    EXPECT_EQ(wallet().getAccount(0)->getCurrency(&stored), -1) << "the account stays, without a currency";

    window().RemoveAllCurrencies();
    EXPECT_EQ(window().getReferenceCurrency(), nullptr);
    addCurrency("Euro", "EUR");
    EXPECT_EQ(text("txtReferenceCurrencyName"), "Euro");
}

} // namespace
