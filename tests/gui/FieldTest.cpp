// What fields make of what is typed into them: completions, numbers and dates as they are understood, and what is not.

#include "tests/gui/CatalogueFixture.h"
#include "valuation/State.h"

#include <QCalendarWidget>

namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

class FieldTest : public CatalogueTest {
protected:
    void dismiss() { key(Qt::Key_0, Qt::AltModifier); }
    bool isMarked(const char* name) { return !find<QLineEdit>(name).toolTip().isEmpty(); }
    /// The list below a field; null while it has not been needed.
    QAbstractItemView* completions(const std::string& field)
    {
        return window().widget().findChild<QAbstractItemView*>(QString::fromStdString(field + "Completions"));
    }
    std::vector<std::string> offered(const std::string& field)
    {
        std::vector<std::string> labels;
        const auto* list = completions(field);
        for (int i = 0; list != nullptr && list->isVisible() && i < list->model()->rowCount(); ++i)
            labels.push_back(list->model()->index(i, 0).data().toString().toStdString());
        return labels;
    }
};

TEST_F(FieldTest, NamesAreCompletedByKeysAndMouseAndWhatIsTypedStands)
{
    addTwoMarkets();
    const char* const ticker = "txtCompanyAbbreviation";
    Market* market = window().catalogue().getMarkets()[0];
    for (const char* more : {"G0", "G1", "G2", "G3", "G4", "G5", "G6", "G7", "G8"})
        new Company(market, "Mu", more);
    show(kOperationPage);
    choose("operationType", "Buy");
    type(ticker, "g");
    EXPECT_EQ(offered(ticker).size(), 9U) << "more than show at once";
    type(ticker, "ET");
    EXPECT_THAT(offered(ticker), ElementsAre("BBB  Beta  Paris"));
    EXPECT_EQ(focus(), ticker) << "the list never has the keyboard";
    key(Qt::Key_Escape);
    EXPECT_THAT(offered(ticker), IsEmpty());
    EXPECT_EQ(text(ticker), "ET");
    type(ticker, "be");
    key(Qt::Key_Return);
    EXPECT_EQ(text(ticker) + text("txtMarketName"), "be") << "nothing was chosen";
    EXPECT_THAT(offered(ticker), IsEmpty());

    type(ticker, "a");
    EXPECT_THAT(offered(ticker), ElementsAre("AAA  Alpha  Paris", "BBB  Beta  Paris"));
    key(Qt::Key_Down);
    key(Qt::Key_Down);
    key(Qt::Key_Return);
    EXPECT_EQ(text(ticker) + ' ' + text("txtMarketName") + ' ' + text("txtQuote"), "BBB Paris 10.00");
    type(ticker, "alp");
    auto* list = completions(ticker);
    QTest::mouseClick(list->viewport(), Qt::LeftButton, {}, list->visualRect(list->model()->index(0, 0)).center());
    settle();
    EXPECT_EQ(text(ticker) + ' ' + focus(), std::string("AAA ") + ticker);
    type(ticker, "b");
    key(Qt::Key_Down);
    key(Qt::Key_Tab);
    EXPECT_EQ(text(ticker) + ' ' + focus(), "BBB txtQuantity");
    type("txtMarketName", "par");
    find<QWidget>("txtQuantity").setFocus();
    EXPECT_THAT(offered("txtMarketName"), IsEmpty());
    EXPECT_EQ(text("txtMarketName"), "par") << "leaving chooses nothing";

    show(kPortoFolioPage);
    type("txtAccountCurrency", "EUR");
    EXPECT_THAT(offered("txtAccountCurrency"), IsEmpty()) << "there is nothing to add, and buttons below";
    show(kCompanyPage);
    type("txtMarketCurrencyRepresentation", "");
    key(Qt::Key_Down);
    EXPECT_THAT(offered("txtMarketCurrencyRepresentation"), ElementsAre("EUR  Euro", "USD  Dollar"));
}

TEST_F(FieldTest, NumbersAreWrittenAsTheyWereUnderstood)
{
    const struct {
        const char *field, *typed, *shown, *notice;
    } cases[] = {
        {"txtQuote", "5.000", "5.00", "5.000 was read as 5.00"},
        {"txtQuote", "1,234", "1.234", "1,234 was read as 1.234"},
        {"txtQuote", "0,125", "0.125", ""},
        {"txtQuote", "1,234.5", "1234.50", ""},
        {"txtQuote", "12x", "12x", ""},
        {"txtQuote", "", "", ""},
        {"txtQuantity", "1,234", "1234", ""},
        {"txtQuantity", "5.00", "5", ""},
        {"txtQuantity", "99999999999", "2147483647", "99999999999 was read as 2147483647"},
    };
    dismissOffer();
    show(kOperationPage);
    choose("operationType", "Buy");
    for (const auto& c : cases) {
        type(c.field, c.typed);
        key(Qt::Key_Tab);
        EXPECT_EQ(text(c.field), c.shown) << c.typed;
        EXPECT_EQ(notice(), c.notice) << c.typed;
        dismiss();
    }
    for (const char* wrong : {"1,5", "10o0", "0,125", "12,34,567"}) {
        type("txtQuantity", wrong);
        EXPECT_TRUE(isMarked("txtQuantity")) << wrong;
    }
}

TEST_F(FieldTest, WhatCannotBeReadIsNotBooked)
{
    addTwoMarkets();
    show(kPortoFolioPage);
    follow({{{{"txtAccountName", "Cash"}, {"txtAccountCurrency", "EUR"}}, "btnAddAccount", ""}});
    show(kOperationPage);
    fill({{"baseAccount", "Cash"}, {"txtAmount", "10o0"}});
    for (const char* button : {"btnAddOperation", "btnUpdateOperation", ""}) {
        find<QWidget>("txtDate").setFocus();
        if (*button == '\0')
            key(Qt::Key_N, Qt::ControlModifier);
        else
            click(button);
        EXPECT_EQ(wallet().getAccount(0)->getNbrOperations(), 0U) << button;
        EXPECT_EQ(notice() + " / " + focus(), "Amount: 10o0 is no number / txtAmount") << button;
        dismiss();
    }
    fill({{"operationType", "Buy"},
          {"txtMarketName", "Paris"},
          {"txtCompanyAbbreviation", "BBB"},
          {"txtQuantity", "1,5"}});
    click("btnAddOperation");
    EXPECT_EQ(notice(), "Quantity: 1,5 is no whole number") << "the amount is not of this type";
    type("txtQuantity", "2");
    click("btnAddOperation");
    EXPECT_EQ(wallet().getAccount(0)->getNbrOperations(), 1U);
    fill({{"operationType", "Deposit"}});
    post('OBAd');
    EXPECT_EQ(wallet().getAccount(0)->getNbrOperations(), 2U) << "the code by itself is not asked";
    EXPECT_EQ(static_cast<AccountOperation*>(wallet().getAccount(0)->getOperation(1))->getAmount(), 10);
    type("txtAmount", "1,234");
    click("btnAddOperation");
    EXPECT_EQ(notice(), "Deposited 1.23 EUR to Cash (1,234 was read as 1.234)");

    addCurrency("Franc", "CHF");
    fill({{"txtQuoteDate", "1/1/2024"}, {"txtQuoteValue", "1.5x"}});
    click("btnAddQuote");
    EXPECT_EQ(notice(), "Value: 1.5x is no number");
    EXPECT_TRUE(isMarked("txtQuoteValue"));
    EXPECT_THAT(rows("lstQuotes"), IsEmpty());
    addQuote("2-3-2024", "-0.123456789");
    EXPECT_THAT(rows("lstQuotes"), ElementsAre("02/03/2024\t-0.12345679"));
}

TEST_F(FieldTest, DatesAreCompletedWhateverComesNext)
{
    addCurrency("Euro", "EUR");
    const struct {
        const char *typed, *shown;
    } cases[] = {{"1/2/26", "01/02/2026"},     {"1.2.99", "01/02/1999"},  {"1/2/73", "01/02/2073"},
                 {"1/2/74", "01/02/1974"},     {"29/2/00", "29/02/2000"}, {"2026-06-30", "30/06/2026"},
                 {"2026-02-30", "2026-02-30"}, {"1/2/0026", "01/02/26"},  {"1/2", "1/2"},
                 {"30.2.2024", "30.2.2024"}};
    for (const auto& c : cases) {
        type("txtQuoteDate", c.typed);
        key(Qt::Key_Tab);
        EXPECT_EQ(text("txtQuoteDate"), c.shown) << c.typed;
        EXPECT_EQ(isMarked("txtQuoteDate"), c.shown == std::string(c.typed)) << c.typed;
    }
    // By a click, which leaves the field, by the key, and by the code, which does not.
    const auto add = [&](const char* date, const auto& send) {
        fill({{"txtQuoteValue", "1"}, {"txtQuoteDate", date}});
        send();
    };
    add("1/1/26", [&] { click("btnAddQuote"); });
    add("2/1/26", [&] { key(Qt::Key_N, Qt::ControlModifier); });
    add("3/1/26", [&] { post('RBAq'); });
    add("4/1/26", [&] { key(Qt::Key_Up), click("btnAddQuote"); });
    EXPECT_THAT(rows("lstQuotes"),
                ElementsAre("01/01/2026\t1.00", "02/01/2026\t1.00", "03/01/2026\t1.00", "05/01/2026\t1.00"));
    show(kPortoFolioPage);
    enter("txtDate", "5/3/25");
    EXPECT_EQ(text("txtDate"), "05/03/2025");
}

TEST_F(FieldTest, CalendarChoosesByKeysAndEscapeKeepsTheDate)
{
    show(kPortoFolioPage);
    enter("txtDate", "28/2/2024");
    const auto open = [&] {
        find<QWidget>("txtDate").setFocus();
        key(Qt::Key_Down, Qt::AltModifier);
        auto* popup = QApplication::activePopupWidget();
        return popup != nullptr ? popup->findChild<QCalendarWidget*>() : nullptr;
    };
    ASSERT_NE(open(), nullptr);
    key(Qt::Key_Right);
    key(Qt::Key_Escape);
    EXPECT_EQ(QApplication::activePopupWidget(), nullptr);
    EXPECT_EQ(text("txtDate") + ' ' + focus(), "28/02/2024 txtDate");
    ASSERT_NE(open(), nullptr);
    key(Qt::Key_Right);
    key(Qt::Key_Return);
    EXPECT_EQ(QApplication::activePopupWidget(), nullptr);
    EXPECT_EQ(text("txtDate"), "29/02/2024");
    EXPECT_EQ(window().getState()->getDate(), Date(29, 2, 2024)) << "sent as by Enter";
}

TEST_F(FieldTest, ParametersThatAreReadInPartSaySo)
{
    const struct {
        const char *field, *typed, *shown, *understood, *proposed; // null: nothing is in doubt
    } cases[] = {
        {"txtBuyRateCost", "0,25", "0,25", "is read as 0.00 %", "write 0.25"},
        {"txtBuyCost", "1 234.5", "1 234.5", "is read as 1.00", "write 1234.50"},
        {"txtInvestementPeriod", "90.7", "90.7", "is read as 90", "write 90"},
        {"txtInvestementPeriod", "120 days", "120", nullptr, nullptr},
        {"txtSellCost", "$5", "5.00", nullptr, nullptr},
    };
    show(kParameterPage);
    for (const auto& c : cases) {
        enter(c.field, c.typed);
        EXPECT_EQ(text(c.field), c.shown);
        const std::string tip = find<QLineEdit>(c.field).toolTip().toStdString();
        if (c.understood == nullptr) {
            EXPECT_EQ(tip, "") << c.typed;
            continue;
        }
        EXPECT_THAT(tip, testing::AllOf(HasSubstr(c.understood), HasSubstr(c.proposed)));
        EXPECT_THAT(notice(), HasSubstr(tip));
    }
    EXPECT_EQ(wallet().getBuyRateCost(), 0.0F);
    window().ReinitWallet();
    EXPECT_EQ(text("txtBuyCost"), "29.95") << "another portfolio's";
    EXPECT_FALSE(isMarked("txtBuyCost"));
}

} // namespace
