// The account commands, by their controls on the portfolio page.

#include "portfolio/Account.h"
#include "platform/ListView.h"
#include "portfolio/DepositAccountOperation.h"
#include "portfolio/TransferAccountOperation.h"
#include "portfolio/Wallet.h"
#include "tests/gui/SmallCatalogue.h"
#include "tests/gui/WindowFixture.h"
#include "tests/support/ToolRun.h"
#include "valuation/AccountState.h"
#include "valuation/State.h"

#include <QCheckBox>
#include <QComboBox>
#include <gmock/gmock.h>

namespace {

using testing::Each;
using testing::ElementsAre;
using testing::SizeIs;

constexpr const char* kAdd = "btnAddAccount";
constexpr const char* kUpdate = "btnUpdateQuote";
constexpr const char* kRemove = "btnRemoveQuote";

class AccountTest : public WindowTest {
protected:
    AccountTest()
    {
        addSmallCatalogue(window());
        show(kPortoFolioPage);
    }

    void typeAccount(const std::string& name, const std::string& currency)
    {
        type("txtAccountName", name);
        type("txtAccountCurrency", currency);
    }
    void add(const std::string& name, const std::string& currency)
    {
        typeAccount(name, currency);
        click(kAdd);
    }
    std::vector<std::string> menuItems(const char* name)
    {
        auto& menu = find<QComboBox>(name);
        std::vector<std::string> items;
        for (int i = 0; i < menu.count(); ++i)
            items.push_back(menu.itemText(i).toStdString());
        return items;
    }
};

TEST_F(AccountTest, AnAccountNeedsANameAndAKnownCurrency)
{
    const struct {
        const char *name, *currency, *message;
    } refused[] = {
        {"", "EUR", "Please specify an account name and a currency."},
        {"Cash", "", "Please specify an account name and a currency."},
        {"Cash", "GBP", "Unknown currency."},
    };
    for (const auto& c : refused) {
        clearMessage();
        add(c.name, c.currency);
        EXPECT_EQ(message(), c.message);
        EXPECT_EQ(wallet().getNbrAccounts(), 0U) << c.message;
    }
    clearMessage();
    add("Cash", "EUR");
    click("cbxDefaultTransferAccount");
    add("Cash", "USD");
    EXPECT_EQ(message(), "") << "a success is silent";
    EXPECT_THAT(rows("lstAccounts"), ElementsAre("Cash\t0.00\tEUR\t", "Cash\t0.00\tUSD\t\u2713"))
        << "names need not differ";
    show(kOperationPage);
    EXPECT_THAT(menuItems("baseAccount"), ElementsAre("Cash", "Cash"));
}

TEST_F(AccountTest, AnUpdateChecksInItsFixedOrder)
{
    add("Cash", "EUR");
    const struct {
        bool isSelected;
        const char *name, *currency;
        const char* answer; // empty for no alert
        const char *message, *row;
        const char* why;
    } cases[] = {
        {false, "", "EUR", "", "Please specify an account name and a currency.", "Cash\t0.00\tEUR\t", "no name"},
        {true, "Cash", "", "", "Please specify an account name and a currency.", "Cash\t0.00\tEUR\t", "no currency"},
        {false, "Cash", "GBP", "", "You must select an account to update.", "Cash\t0.00\tEUR\t", "none selected"},
        {true, "Bank", "EUR", "", "", "Bank\t0.00\tEUR\t", "only the name"},
        {true, "Purse", "USD", "Cancel", "", "Bank\t0.00\tEUR\t", "a cancel keeps the name, too"},
        {true, "Purse", "USD", "Continue", "", "Purse\t0.00\tUSD\t", "the currency and the name"},
        {true, "Box", "GBP", "Continue", "Unknown currency.", "Box\t0.00\tUSD\t", "the name is not lost"},
    };
    for (const auto& c : cases) {
        list("lstAccounts").DeselectAll();
        if (c.isSelected)
            select("lstAccounts", 0);
        typeAccount(c.name, c.currency);
        clearMessage();
        if (*c.answer != '\0')
            answerNextAlert(c.answer);
        click(kUpdate);
        EXPECT_EQ(message(), c.message) << c.why;
        EXPECT_THAT(rows("lstAccounts"), ElementsAre(c.row)) << c.why;
        if (*c.answer != '\0') {
            EXPECT_THAT(alerts(), ElementsAre("This will modify the currency used in all attached operations"));
        }
        EXPECT_EQ(list("lstAccounts").CountSelected(), c.isSelected ? 1 : 0) << c.why;
    }
    show(kOperationPage);
    EXPECT_THAT(menuItems("baseAccount"), ElementsAre("Box"));
}

TEST_F(AccountTest, ARemovalAsksAndTakesOperationsRowsAndMenuItemsAlong)
{
    add("Cash", "EUR");
    add("Bank", "EUR");
    Account* cash = wallet().getAccount(0);
    Account* bank = wallet().getAccount(1);
    new DepositAccountOperation(Date(1, 2, 2024), cash, 100, false);
    new DepositAccountOperation(Date(1, 2, 2024), bank, 7, false);
    new TransferAccountOperation(Date(2, 2, 2024), bank, cash, 5, false);
    window().UpdateState();

    click(kRemove);
    EXPECT_EQ(message(), "You must select an account to update.");
    select("lstAccounts", 0);
    answerNextAlert("Cancel");
    click(kRemove);
    EXPECT_EQ(wallet().getNbrAccounts(), 2U);

    answerNextAlert("Continue");
    window().PostMessage('WBRa');
    window().PostMessage('WBRa'); // as by a second click before the alert is there
    settle();
    EXPECT_THAT(alerts(), Each(std::string("This will delete all attached operations")));
    EXPECT_EQ(message(), "You must select an account to update.") << "it comes when the account is gone";
    EXPECT_THAT(rows("lstAccounts"), ElementsAre("Bank\t7.00\tEUR\t"));
    show(kOperationPage);
    EXPECT_THAT(rows("lstOperations"), SizeIs(1));
    EXPECT_THAT(menuItems("baseAccount"), ElementsAre("Bank"));
    EXPECT_THAT(menuItems("transferAccount"), ElementsAre("Bank"));
}

TEST_F(AccountTest, ASelectionFillsTheFields)
{
    add("Cash", "EUR");
    click("cbxDefaultTransferAccount");
    add("Dollars", "USD");
    for (const auto& [row, name, currency, isDefault] :
         {std::tuple(0, "Cash", "EUR", false), std::tuple(1, "Dollars", "USD", true)}) {
        select("lstAccounts", row);
        EXPECT_EQ(text("txtAccountName"), name);
        EXPECT_EQ(text("txtAccountCurrency"), currency);
        EXPECT_EQ(find<QCheckBox>("cbxDefaultTransferAccount").isChecked(), isDefault) << name;
    }
}

TEST_F(AccountTest, ARowWithoutAccountIsReported)
{
    add("Cash", "EUR");
    window().getState()->getAccountState(0)->setAccount(nullptr);
    select("lstAccounts", 0);
    EXPECT_EQ(message(), "Error getting the selected account.");
    for (const char* button : {kUpdate, kRemove}) {
        clearMessage();
        click(button);
        EXPECT_EQ(message(), "Error accessing the account.") << button;
    }
}

TEST_F(AccountTest, AnAccountWithoutCurrencyCannotBeSavedUntilItIsGivenOne)
{
    add("Cash", "EUR");
    click("btnSavePortoFolio");
    answerPanel("SavePanel", folder() + "/PortoFolios/mine");
    const std::string saved = contentOf(folder() + "/PortoFolios/mine");
    ASSERT_NE(saved, "");

    wallet().getAccount(0)->setCurrency(nullptr);
    window().UpdateState();
    EXPECT_THAT(rows("lstAccounts"), ElementsAre("Cash\t0.00\tno currency\t"));
    click("btnSavePortoFolio");
    EXPECT_EQ(message(), "Failed to write the file.");
    EXPECT_EQ(contentOf(folder() + "/PortoFolios/mine"), saved);

    select("lstAccounts", 0);
    type("txtAccountCurrency", "USD");
    answerNextAlert("Continue");
    click(kUpdate);
    EXPECT_THAT(rows("lstAccounts"), ElementsAre("Cash\t0.00\tUSD\t"));
    click("btnSavePortoFolio");
    EXPECT_EQ(message(), "Wallet successfully saved...");
}

} // namespace
