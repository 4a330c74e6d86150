// The account commands, by their controls on the portfolio page.

#include "tests/gui/CatalogueFixture.h"
#include "tests/support/ToolRun.h"

#include <QCheckBox>

namespace {

using testing::Each;
using testing::ElementsAre;
using testing::SizeIs;

class AccountTest : public CatalogueTest {
protected:
    AccountTest()
    {
        addTwoMarkets();
        show(kPortoFolioPage);
    }

    void add(const char* name, const char* currency)
    {
        follow({{{{"txtAccountName", name}, {"txtAccountCurrency", currency}}, "btnAddAccount", ""}});
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

TEST_F(AccountTest, AnAdditionIsListedAndItsSelectionFillsTheFields)
{
    add("Cash", "EUR");
    click("cbxDefaultTransferAccount");
    add("Cash", "USD");
    EXPECT_THAT(rows("lstAccounts"), ElementsAre("Cash\t0.00\tEUR\t", "Cash\t0.00\tUSD\t\u2713"))
        << "names need not differ";
    select("lstAccounts", 0);
    EXPECT_EQ(text("txtAccountName") + ' ' + text("txtAccountCurrency"), "Cash EUR");
    EXPECT_FALSE(find<QCheckBox>("cbxDefaultTransferAccount").isChecked());
    select("lstAccounts", 1);
    EXPECT_EQ(text("txtAccountCurrency"), "USD");
    EXPECT_TRUE(find<QCheckBox>("cbxDefaultTransferAccount").isChecked());
    show(kOperationPage);
    EXPECT_THAT(menuItems("baseAccount"), ElementsAre("Cash", "Cash"));
}

TEST_F(AccountTest, AnUpdateAsksForAnotherCurrency)
{
    add("Cash", "EUR");
    select("lstAccounts", 0);
    const struct {
        const char *name, *currency;
        const char* answer; // empty for no alert
        const char *message, *row;
        const char* why;
    } cases[] = {
        {"Bank", "EUR", "", "", "Bank\t0.00\tEUR\t\u2713", "only the name and the mark"},
        {"Purse", "USD", "Cancel", "", "Bank\t0.00\tEUR\t\u2713", "a cancel keeps the name, too"},
        {"Purse", "USD", "Continue", "", "Purse\t0.00\tUSD\t\u2713", "the currency and the name"},
        {"Box", "GBP", "Continue", "Unknown currency.", "Box\t0.00\tUSD\t\u2713", "the name is not lost"},
    };
    click("cbxDefaultTransferAccount");
    for (const auto& c : cases) {
        SCOPED_TRACE(c.why);
        answerNextAlert(c.answer);
        follow({{{{"txtAccountName", c.name}, {"txtAccountCurrency", c.currency}}, "btnUpdateQuote", c.message}});
        EXPECT_THAT(rows("lstAccounts"), ElementsAre(c.row));
        EXPECT_THAT(alerts(), SizeIs(*c.answer != '\0' ? 1 : 0));
        EXPECT_EQ(list("lstAccounts").CountSelected(), 1);
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
    select("lstAccounts", 0);
    answerNextAlert("Cancel");
    click("btnRemoveQuote");
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

TEST_F(AccountTest, AnAccountWithoutCurrencyCannotBeSavedUntilItIsGivenOne)
{
    add("Cash", "EUR");
    click("btnSavePortoFolio");
    answerPanel("SavePanel", "mine");
    const std::string saved = contentOf(folder() + "/PortoFolios/mine");
    ASSERT_NE(saved, "");

    wallet().getAccount(0)->setCurrency(nullptr);
    window().UpdateState();
    EXPECT_THAT(rows("lstAccounts"), ElementsAre("Cash\t0.00\tno currency\t"));
    follow({{{}, "btnSavePortoFolio", "Failed to write the file."}});
    EXPECT_EQ(contentOf(folder() + "/PortoFolios/mine"), saved);

    select("lstAccounts", 0);
    answerNextAlert("Continue");
    follow({{{{"txtAccountCurrency", "USD"}}, "btnUpdateQuote", ""},
            {{}, "btnSavePortoFolio", "Wallet successfully saved..."}});
    EXPECT_THAT(alerts(), ElementsAre("This will modify the currency used in all attached operations"));
    EXPECT_THAT(rows("lstAccounts"), ElementsAre("Cash\t0.00\tUSD\t"));
}

} // namespace
