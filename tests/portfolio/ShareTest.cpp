#include "portfolio/Share.h"
#include "tests/support/SmallPortfolio.h"

#include <ctime>
#include <gtest/gtest.h>

TEST(ShareTest, WithoutCompanyThereAreNoNamesAndNoQuotes)
{
    const Share share;
    float quote = 5;
    share.getQuote(kStart, &quote);
    EXPECT_EQ(quote, 0);
    EXPECT_EQ(share.getPrevisionQuote(kStart), 0);
    for (const String& name : {share.getMarketName(), share.getCompanyAbbreviation(), share.getCompanyName()})
        EXPECT_TRUE(name.isUndefined());
}

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

TEST(ShareTest, RemovingTheAutomaticOperationsTakesTimeInProportionToThem)
{
    Share share;
    constexpr int kMany = 40000; // sorting anew for each would take many times the limit
    for (int day = 0; day < kMany; ++day)
        new ShareOperation(daysAfterStart(day), &share, true, 1, 1, day % 2 == 0, 0);
    const std::clock_t start = std::clock();
    share.removeAutomaticShareOperations();
    EXPECT_LT(std::clock() - start, CLOCKS_PER_SEC);
    EXPECT_EQ(share.getNbrShareOperations(), kMany / 2U);
}
