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
}
