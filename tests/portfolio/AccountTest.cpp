#include "portfolio/Account.h"
#include "tests/support/SmallPortfolio.h"

#include <gtest/gtest.h>

namespace {

std::string amounts(const Account& account)
{
    std::string text;
    for (const Operation* operation : all(account, &Account::getAllOperations))
        text += std::to_string(static_cast<int>(static_cast<const AccountOperation*>(operation)->getAmount()));
    return text;
}

} // namespace

TEST(AccountTest, OperationsAreListedByDateAndThoseOfADayAsTheyWereAdded)
{
    Account account;
    for (const auto& [day, amount] : {std::pair(5, 1.0F), {5, 2.0F}, {3, 3.0F}, {5, 4.0F}})
        deposit(&account, day, amount);
    EXPECT_EQ(amounts(account), "3124");
    account.getOperation(0)->setDate(daysAfterStart(7));
    EXPECT_EQ(amounts(account), "1243") << "a changed date moves the operation";

    const Operation *first = account.getOperation(0), *second = account.getOperation(1),
                    *last = account.getOperation(3);
    EXPECT_EQ(sortOperationByDate(&first, &second), 0);
    EXPECT_EQ(sortOperationByDate(&first, &last), -1);
    EXPECT_EQ(sortOperationByDate(&last, &first), 1);
}

TEST(AccountTest, ATransferIsListedAtBothEndsAndCostsNothingUntilToldOtherwise)
{
    Account from;
    auto* to = new Account;
    const TransferAccountOperation* later = transfer(&from, to, 9, 2);
    TransferAccountOperation* sent = transfer(&from, to, 10, 200);
    sent->setDate(daysAfterStart(8));
    EXPECT_EQ(from.getOperation(0), sent);
    EXPECT_EQ(to->getTransferOperation(0), sent) << "both lists follow a changed date";
    EXPECT_EQ(to->getTransferOperation(1), later);
    EXPECT_EQ(sent->getTotalCost(), 0);
    sent->setRateCost(0.01F);
    sent->setCost(5);
    EXPECT_FLOAT_EQ(sent->getTotalCost(), 7);
    delete to;
    EXPECT_EQ(from.getNbrOperations(), 0U) << "what an account receives goes with it";
}

TEST(AccountTest, WithoutCurrencyOrWalletLookUpsFindNothing)
{
    SmallPortfolio p;
    new Share(&p.wallet, p.alpha);
    auto* account = new Account("A");
    const auto* operation = new DepositAccountOperation(kStart, account, 1, false);
    for (const bool isOwned : {false, true}) {
        Share* share;
        EXPECT_EQ(account->getCurrencyName().isUndefined(), !isOwned);
        EXPECT_EQ(operation->getCurrencyRepresentation().isUndefined(), !isOwned);
        EXPECT_EQ(account->getShare("Paris", "AC", &share), isOwned ? 0 : -1);
        EXPECT_EQ(operation->getAccountByName("A"), isOwned ? account : nullptr);
        account->setCurrency(p.euro);
        account->setWallet(&p.wallet);
    }
}
