// The operation commands, by their controls on the operation page.

#include "market/NoteCompanyEvent.h"
#include "tests/gui/CatalogueFixture.h"
#include "valuation/AccountState.h"
#include "valuation/State.h"

#include <QCheckBox>

namespace {

using testing::ElementsAre;
using testing::EndsWith;
using testing::HasSubstr;
using testing::Not;
using testing::SizeIs;

constexpr const char* kAdd = "btnAddOperation";
constexpr const char* kUpdate = "btnUpdateOperation";
constexpr const char* kRemove = "btnRemoveOperation";

class OperationTest : public CatalogueTest {
protected:
    OperationTest()
    {
        addTwoMarkets();
        const auto& currencies = window().catalogue().getCurrencies();
        cash_ = addAccount(wallet(), "Cash", currencies[1]);
        addAccount(wallet(), "Broker", currencies[1]);
        addAccount(wallet(), "Dollars", currencies[0]);
        showAccounts();
    }

    /// Values the portfolio on another day.
    void valueOn(const char* day)
    {
        show(kPortoFolioPage);
        enter("txtDate", day);
        show(kOperationPage);
    }
    std::string menuText(const char* name) { return find<QComboBox>(name).currentText().toStdString(); }
    /// A purchase of BBB, in no account yet.
    ShareOperation* buy(const Date& date, int quantity, float quote)
    {
        return new ShareOperation(date, new Share(&wallet(), beta()), true, quantity, quote, false, 0);
    }
    int selectedRow() { return list("lstOperations").CurrentSelection(); }
    unsigned countOperations()
    {
        unsigned n = 0;
        for (unsigned i = 0; i < wallet().getNbrAccounts(); ++i)
            n += wallet().getAccount(i)->getNbrOperations();
        return n;
    }

    Account* cash_;
};

TEST_F(OperationTest, AnAdditionIsListedSelectedAndLeavesTheFields)
{
    const struct {
        Fields fields;
        const char* row;
        int where;
    } cases[] = {
        {{{"operationType", "Deposit"}, {"baseAccount", "Broker"}, {"txtAmount", "1000.00"}},
         "21/11/2024\tBroker\tDeposit\t\t\t1,000.00\t\t1,000.00 EUR\t1,000.00",
         0},
        {{{"operationType", "Transfer"},
          {"transferAccount", "Dollars"},
          {"txtAmount", "50.00"},
          {"txtDate", "20/11/2024"},
          {"txtTransferCost", "2.00"},
          {"txtTransferRateCost", "0.01"}},
         "20/11/2024\tBroker\tTransfer\tto Dollars\t\t50.00\t2.50\t50.00 EUR\t-50.00",
         0},
        {{{"operationType", "Buy"},
          {"txtMarketName", "Paris"},
          {"txtCompanyAbbreviation", "BBB"},
          {"txtQuantity", "3000"},
          {"txtDate", "22/11/2024"},
          {"txtQuote", "12.50"},
          {"txtShareCost", "1.25"}},
         "22/11/2024\tBroker\tBuy\tBBB  Beta\t3,000\t12.50\t1.25\t37,500.00 EUR\t-37,565.00",
         2},
        {{{"operationType", "Sell"}},
         "22/11/2024\tBroker\tSell\tBBB  Beta\t3,000\t12.50\t1.25\t37,500.00 EUR\t37,435.00",
         3},
    };
    for (const auto& c : cases) {
        follow({{c.fields, kAdd, ""}});
        EXPECT_EQ(selectedRow(), c.where) << c.row;
        EXPECT_EQ(rows("lstOperations").at(static_cast<std::size_t>(c.where)), c.row);
        for (const auto& [field, entered] : c.fields) {
            if (std::string_view(field).starts_with("txt")) {
                EXPECT_EQ(text(field), entered);
            }
        }
    }
    const auto* made = static_cast<TransferAccountOperation*>(wallet().getAccount(1)->getOperation(0));
    EXPECT_EQ(made->getFromCurrencyQuote(), 1.0F) << "offered";
    EXPECT_EQ(made->getToCurrencyQuote(), 0.5F) << "offered";
    EXPECT_EQ(wallet().getNbrShares(), 1U);
}

TEST_F(OperationTest, AnUpdateReplacesAndWithoutSelectionAdds)
{
    const struct {
        Fields fields;
        const char* row;
        const char* why;
    } cases[] = {
        {{{"operationType", "Deposit"}, {"baseAccount", "Cash"}, {"txtAmount", "10"}},
         "21/11/2024\tCash\tDeposit\t\t\t10.00\t\t10.00 EUR\t10.00",
         "added"},
        {{{"txtAmount", "20"}, {"txtDate", ""}},
         "21/11/2024\tCash\tDeposit\t\t\t10.00\t\t10.00 EUR\t10.00",
         "after a failed check the old one stays"},
        {{{"txtDate", "20/11/2024"}}, "20/11/2024\tCash\tDeposit\t\t\t20.00\t\t20.00 EUR\t20.00", "replaced"},
        {{{"operationType", "Buy"},
          {"txtMarketName", "Paris"},
          {"txtCompanyAbbreviation", "BBB"},
          {"txtQuantity", "2"}},
         "20/11/2024\tCash\tBuy\tBBB  Beta\t2\t10.00\t29.95\t20.00 EUR\t-49.98",
         "with another type, at the quote and the cost that were offered"},
    };
    for (const auto& c : cases) {
        follow({{c.fields, kUpdate, ""}});
        EXPECT_THAT(rows("lstOperations"), ElementsAre(c.row)) << c.why;
        EXPECT_EQ(selectedRow(), 0) << c.why;
    }
}

TEST_F(OperationTest, ASelectionFillsTheFieldsOfItsTypeAndHidesTheOthers)
{
    auto* deposited = new DepositAccountOperation(Date(1, 2, 2024), cash_, -12.5F, false);
    withTerms(new TransferAccountOperation(Date(2, 2, 2024), cash_, wallet().getAccount(2), 9, false), 0.0017F, 1, 2,
              3);
    buy(Date(3, 2, 2024), 1234, 2.5F)->setAccount(cash_);
    (new ShareOperation(Date(4, 2, 2024), nullptr, false, 2, 3, false, 8))->setAccount(cash_);
    auto* earned = new TransferAccountOperation(Date(5, 2, 2024), cash_, cash_, 0, false);
    earned->setCost(-37.5F);
    (new TransferAccountOperation(Date(6, 2, 2024), cash_, cash_, 5, false))->setRateCost(1);
    window().UpdateState();
    const std::pair<const char*, const char*> cases[] = {
        {"Deposit", "txtDate=01/02/2024 txtAmount=-12.50 txtCharged=12.50 EUR from Cash"},
        {"Transfer", "txtDate=02/02/2024 txtAmount=9.00 txtTransferCost=1.00 txtTransferFromQuote=2.00 "
                     "txtTransferToQuote=3.00 txtTransferRateCost=0.0017 "
                     "txtCharged=9.00 EUR from Cash, 5.32 USD to Dollars"},
        {"Buy", "txtDate=03/02/2024 txtMarketName=Paris txtCompanyAbbreviation=BBB txtQuantity=1234 txtQuote=2.50 "
                "txtShareCost=0.00 txtTotal=3,085.00 txtCharged=3,090.24 EUR from Cash"},
        {"Sell", "txtDate=04/02/2024 txtMarketName=ERROR txtCompanyAbbreviation=ERROR txtQuantity=2 txtQuote=3.00 "
                 "txtShareCost=8.00 txtTotal=6.00 txtCharged="},
        {"Income", "txtDate=05/02/2024 txtAmount=37.50 txtMarketName= txtCompanyAbbreviation= "
                   "txtCharged=37.50 EUR to Cash"},
        {"Charge", "txtDate=06/02/2024 txtAmount=5.00 txtCharged=5.00 EUR from Cash"},
    };
    EXPECT_EQ(rows("lstOperations")[4], "05/02/2024\tCash\tIncome\t\t\t37.50\t\t37.50 EUR\t37.50");
    EXPECT_EQ(rows("lstOperations")[5], "06/02/2024\tCash\tCharge\t\t\t5.00\t\t5.00 EUR\t-5.00");
    for (int row = 5; row >= 0; --row) {
        select("lstOperations", row);
        EXPECT_EQ(menuText("operationType"), cases[row].first);
        EXPECT_EQ(menuText("baseAccount"), "Cash");
        QStringList shown;
        for (const auto* field : window().widget().findChildren<QLineEdit*>()) {
            if (field->isVisible() && field->objectName() != "txtFilter")
                shown += field->objectName() + '=' + field->text();
        }
        EXPECT_EQ(shown.join(' ').toStdString(), cases[row].second);
        EXPECT_EQ(isVisible("transferAccount"), row == 1);
    }
    select("lstOperations", 1);
    EXPECT_EQ(menuText("transferAccount"), "Dollars");
    click(kUpdate);
    EXPECT_EQ(static_cast<TransferAccountOperation*>(cash_->getOperation(1))->getRateCost(), 0.0017F)
        << "what is shown reads back to the same";
    EXPECT_EQ(cash_->getOperation(0), deposited);
}

TEST_F(OperationTest, ARemovalIsNotAskedFor)
{
    for (const float amount : {1.0F, 2.0F, 3.0F})
        new DepositAccountOperation(Date(1, 2, 2024), cash_, amount, false);
    window().UpdateState();
    click(kRemove);
    EXPECT_EQ(countOperations(), 3U) << "nothing is selected";
    select("lstOperations", 1);
    click(kRemove);
    EXPECT_THAT(rows("lstOperations"), ElementsAre(EndsWith("1.00 EUR\t1.00"), EndsWith("3.00 EUR\t3.00")));
    EXPECT_EQ(selectedRow(), -1);

    // While the portfolio's date is none, the list is not filled again.
    valueOn("never");
    select("lstOperations", 0);
    click(kRemove);
    EXPECT_THAT(rows("lstOperations"), ElementsAre(EndsWith("3.00 EUR\t3.00")));
}

TEST_F(OperationTest, TheTotalFollowsQuantityAndQuote)
{
    fill({{"operationType", "Buy"},
          {"txtMarketName", "Paris"},
          {"txtCompanyAbbreviation", "BBB"},
          {"txtQuantity", "7"}});
    EXPECT_EQ(text("txtTotal"), "70.00") << "typed only";
    type("txtQuantity", "7x");
    EXPECT_EQ(text("txtTotal"), "") << "of no number";
    type("txtQuantity", "7");
    type("txtCompanyAbbreviation", "AAA");
    EXPECT_EQ(text("txtTotal"), "0.00") << "has no quote";
    enter("txtQuote", "1000.5");
    EXPECT_EQ(text("txtTotal"), "7,003.50") << "before costs";
}

/// Has the next valuation with previsions find a profitable sale, and so move the profit from Broker to Cash.
class AutomaticOperationTest : public OperationTest {
protected:
    AutomaticOperationTest()
    {
        cash_->setDefaultTransferAccount(true);
        buy(Date(1, 11, 2024), 10, 10)->setAccount(wallet().getAccount(1));
        new CompanyQuote(beta(), Date(20, 11, 2024), 40);
        click("cbxPrevision");
        select("lstOperations", 1);
    }
};

TEST_F(AutomaticOperationTest, IsToldApartAndNeverFoundAgainByItsAddress)
{
    ASSERT_THAT(rows("lstOperations"), ElementsAre(EndsWith("\t"), EndsWith("\t\u2713")));
    EXPECT_TRUE(find<QCheckBox>("cbAutomatic").isChecked());
    EXPECT_EQ(menuText("transferAccount"), "Cash");
    window().UpdateState();
    EXPECT_EQ(selectedRow(), -1);
}

TEST_F(AutomaticOperationTest, CanBeRemoved)
{
    click(kRemove);
    EXPECT_EQ(countOperations(), 1U);
    EXPECT_EQ(selectedRow(), -1);
}

TEST_F(AutomaticOperationTest, CanBeReplacedThoughTheValuationDestroysIt)
{
    click("cbAutomatic");
    type("txtAmount", "5");
    click(kUpdate);
    EXPECT_EQ(rows("lstOperations").at(static_cast<std::size_t>(selectedRow())),
              "21/11/2024\tBroker\tTransfer\tto Cash\t\t5.00\t0.00\t5.00 EUR\t-5.00");
}

TEST_F(AutomaticOperationTest, CanBeReplacedByAnotherOneWhichIsGoneBeforeItIsListed)
{
    click(kUpdate);
    EXPECT_EQ(countOperations(), 1U) << "the simulated sale is in the past now, and moves no profit again";
    EXPECT_THAT(notice(), Not(HasSubstr("Transferred"))) << "it is gone";
    click(kAdd);
    EXPECT_EQ(countOperations(), 1U);
    EXPECT_EQ(wallet().shares()[0]->getNbrShareOperations(), 2U) << "the sale stays with its holding";
}

TEST_F(OperationTest, OffersFollowWhatIsTypedButNeverOverwriteIt)
{
    valueOn("02/11/2024");
    EXPECT_EQ(text("txtDate"), "02/11/2024") << "the portfolio's date";
    wallet().setSellCost(5);
    choose("operationType", "Buy");
    EXPECT_EQ(text("txtShareCost"), "29.95");
    choose("operationType", "Sell");
    EXPECT_EQ(text("txtShareCost"), "5.00");
    show(kParameterPage);
    enter("txtSellCost", "6");
    show(kOperationPage);
    EXPECT_EQ(text("txtShareCost"), "6.00") << "follows the parameter";
    fill({{"txtShareCost", ""}, {"txtMarketName", "Paris"}});
    EXPECT_EQ(text("txtShareCost"), "") << "emptied by hand: no cost";
    fill({{"txtShareCost", "7"}, {"operationType", "Buy"}});
    EXPECT_EQ(text("txtShareCost"), "7.00") << "typed";

    type("txtCompanyAbbreviation", "BBB");
    EXPECT_EQ(text("txtQuote"), "10.00");
    new CompanyQuote(beta(), Date(3, 11, 2024), 12);
    valueOn("03/11/2024");
    EXPECT_EQ(text("txtDate") + " " + text("txtQuote"), "03/11/2024 12.00") << "the quote of the day that is offered";
    type("txtCompanyAbbreviation", "AAA");
    EXPECT_EQ(text("txtQuote"), "") << "it has no quotes, and BBB's is not its";
    fill({{"txtQuote", "4"}, {"txtCompanyAbbreviation", "BB"}});
    EXPECT_EQ(text("txtQuote"), "4.00") << "typed, and there is no other company yet";
    type("txtCompanyAbbreviation", "BBB");
    EXPECT_EQ(text("txtQuote"), "12.00") << "what was typed was a quote of AAA";
    fill({{"txtQuote", "5"}, {"txtMarketName", "Pari"}, {"txtMarketName", "Paris"}});
    EXPECT_EQ(text("txtQuote"), "5.00") << "the same company again";
    fill({{"txtCompanyAbbreviation", ""}, {"txtQuote", "6"}, {"txtCompanyAbbreviation", "BBB"}});
    EXPECT_EQ(text("txtQuote"), "6.00") << "typed for no company yet";
    type("txtCompanyAbbreviation", "AAA");
    EXPECT_EQ(text("txtQuote"), "") << "BBB's since then";
    fill({{"txtQuote", "4"}, {"txtCompanyAbbreviation", "AAB"}, {"txtQuantity", "3"}});
    type("txtCompanyAbbreviation", "BBB");
    EXPECT_EQ(text("txtQuote"), "12.00") << "a quantity says nothing of whose quote it is";
    fill({{"txtCompanyAbbreviation", ""}, {"txtQuote", "6"}, {"txtCompanyAbbreviation", "AAA"}});
    EXPECT_EQ(text("txtQuote"), "6.00");
    type("txtCompanyAbbreviation", "BBB");
    EXPECT_EQ(text("txtQuote"), "12.00") << "what was typed has become AAA's";
    new Company(beta()->market(), "Longer", "BBBB");
    fill({{"txtCompanyAbbreviation", ""}, {"txtQuote", "6"}, {"txtCompanyAbbreviation", "BBBB"}});
    EXPECT_EQ(text("txtQuote"), "6.00") << "BBB came by on the way";

    fill({{"operationType", "Transfer"}, {"baseAccount", "Cash"}, {"transferAccount", "Dollars"}});
    EXPECT_EQ(text("txtTransferFromQuote") + " " + text("txtTransferToQuote"), "1.00 0.50");
    choose("transferAccount", "Broker");
    EXPECT_EQ(text("txtTransferToQuote"), "1.00") << "nothing to exchange";
    fill({{"txtTransferToQuote", "3"}, {"transferAccount", "Dollars"}});
    EXPECT_EQ(text("txtTransferToQuote"), "3.00") << "typed";

    type("txtDate", "05/05/2024");
    valueOn("04/11/2024");
    EXPECT_EQ(text("txtDate"), "05/05/2024") << "typed";
}

TEST_F(OperationTest, ANewOperationStartsWithTheAccountThatIsLikely)
{
    const auto chosen = [this] { return menuText("baseAccount"); };
    EXPECT_EQ(chosen(), "") << "any of three";
    fill({{"operationType", "Buy"}, {"txtMarketName", "Paris"}, {"txtCompanyAbbreviation", "AAA"}});
    EXPECT_EQ(chosen(), "Dollars") << "the first one in the currency of the share";
    type("txtCompanyAbbreviation", "BBB");
    EXPECT_EQ(chosen(), "Cash");
    fill({{"baseAccount", "Dollars"}, {"txtQuantity", "2"}, {"txtDate", "20/11/2024"}});
    EXPECT_EQ(chosen() + text("txtCharged"), "Dollars") << "chosen by hand after that, though it does not fit";
    fill({{"baseAccount", "Broker"}, {"txtShareCost", "1"}});
    EXPECT_EQ(text("txtCharged"), "21.03 EUR from Broker") << "2 * 10 * 1.0017 + 1";
    type("txtShareCost", "1x");
    EXPECT_EQ(text("txtCharged"), "") << "nothing is booked of a faulty number";
    type("txtShareCost", "1");
    click(kAdd);
    fill({{"txtCompanyAbbreviation", "AAA"}, {"txtCompanyAbbreviation", "BBB"}});
    EXPECT_EQ(chosen(), "Broker") << "used last";
    fill({{"operationType", "Deposit"}, {"baseAccount", "Dollars"}, {"txtAmount", "1"}});
    click(kAdd);
    choose("operationType", "Buy");
    EXPECT_EQ(chosen(), "Broker") << "used last for this company";
    restart();
    addTwoMarkets();
    addAccount(wallet(), "Only", window().catalogue().getCurrencies()[0]);
    showAccounts();
    EXPECT_EQ(chosen(), "Only");
}

TEST_F(OperationTest, ASuccessIsToldAndADoubleClickBooksOnce)
{
    fill({{"operationType", "Buy"},
          {"txtMarketName", "Paris"},
          {"txtCompanyAbbreviation", "BBB"},
          {"txtQuantity", "100"},
          {"txtQuote", "40"}});
    auto& add = find<QWidget>(kAdd);
    QTest::mouseClick(&add, Qt::LeftButton);
    QTest::mouseDClick(&add, Qt::LeftButton);
    settle();
    click(kAdd);
    EXPECT_EQ(countOperations(), 1U);
    EXPECT_EQ(notice(), "Bought 100 BBB, 4,036.75 EUR from Cash");
    add.setFocus();
    for (const bool isHeld : {false, true, true}) {
        QTest::qWait(QApplication::doubleClickInterval() + 50); // as long as a key takes to repeat itself
        QTest::simulateEvent(&add, true, Qt::Key_Return, Qt::NoModifier, "\r", isHeld);
        settle();
    }
    EXPECT_EQ(countOperations(), 2U) << "a held key is no more meant";
    post('HUnd');
    EXPECT_EQ(notice(), "") << "it is undone";
    post('OBAd');
    EXPECT_EQ(countOperations(), 2U) << "a code that no person sends is no double click";
    post('HUnd');
    click(kAdd);
    EXPECT_EQ(countOperations(), 2U) << "taken back, and meant again";
    QTest::qWait(QApplication::doubleClickInterval() + 50);
    click(kAdd);
    EXPECT_EQ(countOperations(), 3U);
    const struct {
        Fields fields;
        const char* button;
        const char* notice;
    } cases[] = {
        {{{"txtQuantity", "50"}}, kUpdate, "Updated: Bought 50 BBB, 2,033.35 EUR from Cash"},
        {{{"operationType", "Sell"}}, kAdd, "Sold 50 BBB, 1,966.65 EUR to Cash"},
        {{}, kRemove, "Removed: Sold 50 BBB, 1,966.65 EUR to Cash"},
        {{{"operationType", "Deposit"}, {"txtAmount", "-5"}}, kAdd, "Withdrew 5.00 EUR from Cash"},
        {{{"txtAmount", "1000"}}, kAdd, "Deposited 1,000.00 EUR to Cash"},
        {{{"operationType", "Transfer"}, {"transferAccount", "Dollars"}},
         kAdd,
         "Transferred 1,000.00 EUR from Cash, 2,000.00 USD to Dollars"},
        {{{"operationType", "Income"}, {"txtAmount", "0"}}, kAdd, "Please specify an amount above 0."},
        {{{"operationType", "Charge"}, {"txtAmount", "-1"}}, kAdd, "Please specify an amount above 0."},
        {{{"txtAmount", "2.5"}}, kAdd, "Charge of 2.50 EUR from Cash"},
    };
    for (const auto& c : cases) {
        follow({{c.fields, c.button, ""}});
        EXPECT_EQ(notice(), c.notice);
    }
}

TEST_F(OperationTest, IncomeAndChargesMoveTheirSumsAndNoDeposits)
{
    const auto cashOf = [this](unsigned account) { return window().getState()->getAccountState(account)->getCash(); };
    const auto expectCash = [&](float euros, float dollars, const char* when) {
        EXPECT_EQ(cashOf(0), euros) << when;
        EXPECT_EQ(cashOf(2), dollars) << when;
        EXPECT_EQ(window().getState()->getTotalDeposit(), 1000) << when;
    };
    const auto notes = [this](const char* ticker = "BBB") {
        std::vector<std::string> texts;
        Company* company = nullptr;
        wallet().getCompany("Paris", ticker, &company);
        for (const CompanyEvent* event : company->events()) {
            const auto& note = dynamic_cast<const NoteCompanyEvent&>(*event);
            texts.push_back(std::string(event->getDate().toString().getCharacterArray()) + ' ' +
                            note.getTitle().getCharacterArray() + ' ' + note.getText().getCharacterArray());
        }
        return texts;
    };
    follow({{{{"operationType", "Deposit"}, {"baseAccount", "Cash"}, {"txtAmount", "1000"}}, kAdd, ""},
            {{{"operationType", "Charge"}, {"txtAmount", "12.25"}}, kAdd, ""},
            {{{"operationType", "Income"}, {"txtAmount", "0.1"}}, kAdd, ""},
            {{{"txtMarketName", "Paris"}, {"txtCompanyAbbreviation", "CCC"}}, kAdd, "Unknown company."},
            {{{"txtCompanyAbbreviation", "BBB"}, {"baseAccount", "Dollars"}, {"txtAmount", "37.5"}}, kAdd, ""}});
    const float euros = static_cast<float>(1000 - 12.25) + 0.1F;
    expectCash(euros, 37.5F, "booked");
    EXPECT_THAT(notes(), ElementsAre("21/11/2024 Dividend 37.50 USD to Dollars"));
    post('HUnd');
    expectCash(euros, 0, "one step back");
    EXPECT_THAT(notes(), testing::IsEmpty());
    post('HRed');
    EXPECT_THAT(notes(), SizeIs(1));
    select("lstOperations", 3);
    EXPECT_EQ(text("txtMarketName") + ' ' + text("txtCompanyAbbreviation"), "Paris BBB") << "found by the note";
    follow({{{{"txtAmount", "40"}}, kUpdate, ""}});
    expectCash(euros, 40, "replaced");
    EXPECT_THAT(notes(), ElementsAre("21/11/2024 Dividend 40.00 USD to Dollars"));

    select("lstOperations", 3);
    click(kRemove);
    expectCash(euros, 0, "removed");
    EXPECT_THAT(notes(), testing::IsEmpty());

    const auto expectNotes = [&](const char* ofAlpha) {
        EXPECT_THAT(notes("AAA"), ElementsAre(ofAlpha));
        EXPECT_THAT(notes("BBB"), ElementsAre("21/11/2024 Dividend 5.00 USD to Dollars"));
    };
    follow({{{{"txtCompanyAbbreviation", "BBB"}, {"baseAccount", "Dollars"}, {"txtAmount", "5"}}, kAdd, ""},
            {{{"txtCompanyAbbreviation", "AAA"}}, kAdd, ""},
            {{{"txtAmount", "6"}}, kUpdate, ""}});
    expectNotes("21/11/2024 Dividend 6.00 USD to Dollars");
    follow({{{{"txtAmount", "5"}}, kUpdate, ""}});
    select("lstOperations", 3);
    EXPECT_EQ(text("txtMarketName") + ' ' + text("txtCompanyAbbreviation"), "Paris AAA") << "one of two alike";
    follow({{{{"txtAmount", "7"}}, kUpdate, ""}});
    expectNotes("21/11/2024 Dividend 7.00 USD to Dollars");
}

} // namespace
