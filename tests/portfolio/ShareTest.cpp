#include "portfolio/Share.h"
#include "tests/support/SmallPortfolio.h"

#include <gtest/gtest.h>

TEST(ShareTest, TheRateCostIsThePresentOneOfTheWallet)
{
    SmallPortfolio p;
    auto* share = new Share(&p.wallet, p.alpha);
    const ShareOperation* bought = trade(share, nullptr, 0, 1, 10);
    EXPECT_EQ(bought->getOperationRateCost(), 0.0017F);
    p.wallet.setSellRateCost(0.25F);
    EXPECT_EQ(trade(share, nullptr, 0, -1, 10)->getOperationRateCost(), 0.25F);
    share->setWallet(nullptr);
    EXPECT_EQ(bought->getOperationRateCost(), 0);
    EXPECT_EQ(ShareOperation().getOperationRateCost(), 0);
}
