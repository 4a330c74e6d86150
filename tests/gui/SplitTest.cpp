#include "market/NoteCompanyEvent.h"
#include "market/SplitCompanyEvent.h"
#include "tests/gui/CatalogueFixture.h"
#include "valuation/ShareState.h"
#include "valuation/State.h"

using testing::Contains;
using testing::ElementsAre;
using testing::HasSubstr;

namespace {

/// The window of the split, worked by events as the other one is.
class SplitTest : public CatalogueTest {
protected:
    /// A company with quotes of 10, 12.5 and 20 in March 2024 and ten shares bought, and its split on the tenth.
    void addSplit(const char* from, const char* to)
    {
        addSmallCatalogue();
        buy(company());
        choose("companyEventType", "Split");
        follow(
            {{{{"txtCompanyEventDate", "10/3/2024"}, {"txtEventSplitRangeNum", from}, {"txtEventSplitRangeDenum", to}},
              "btnAddCompanyEvent",
              ""}});
    }
    ShareOperation& trade(unsigned i) { return *wallet().shares()[0]->getShareOperation(i); }
    unsigned trades() { return wallet().shares()[0]->getNbrShareOperations(); }
    std::vector<float> quotes() { return valuesOf(*company()); }
};

} // namespace

TEST_F(SplitTest, WhatWasShownIsDoneInOneStep)
{
    addSplit("4", "5");
    addQuote("10/3/2024", "10");
    const auto steps = window().changeSerial();
    click("btnApplySplit");
    ASSERT_NE(dialog(), nullptr);
    EXPECT_THAT(line("txtSplit"), HasSubstr("AL  Alpha:  4 shares become 5 on 10/03/2024"));
    EXPECT_EQ(line("txtQuoteSample"), "06/03/2024:  12.50 becomes 10.00");
    // 12.5 shares: the half is sold at 5 and 0.17 %.
    EXPECT_THAT(table("lstSplitTrades"), ElementsAre("02/03/2024\tCash\tBuy\t10\t13\t11.00\t8.4615\t10\t13",
                                                     "10/03/2024\tCash\tSell\t\t1\t\t5.0085\t\t12"));
    EXPECT_THAT(table("lstSplitHoldings"),
                ElementsAre("Before\t10\t12.50\t\t\t125.00", "After\t12\t10.00\t1/2\t5.00\t125.00"));
    EXPECT_THAT(line("txtSettlement"), HasSubstr("brings 5.00 EUR, rate cost paid, to Cash"));
    EXPECT_EQ(part<QWidget>("txtWarning"), nullptr);
    constexpr int kLow = 310; // of a small screen
    BWindow::newest()->GiveWay(static_cast<float>(dialog()->width()), kLow);
    EXPECT_EQ(dialog()->height(), kLow);
    EXPECT_EQ(dialog()->focusWidget()->visibleRegion().boundingRect(), dialog()->focusWidget()->rect());
    QTest::keyClick(dialog()->focusWidget(), Qt::Key_Return);
    settle();
    ASSERT_EQ(dialog(), nullptr);
    EXPECT_THAT(quotes(), ElementsAre(8, 10, 10, 20));
    EXPECT_EQ(trade(0).getQuantity(), 13);
    ASSERT_EQ(trades(), 2U);
    EXPECT_EQ(trade(1).account(), trade(0).account());
    EXPECT_THAT(rows("lstCompanyEvents"), ElementsAre("10/03/2024\tSplit\t4 : 5", "10/03/2024\tNote\tSplit applied"));
    EXPECT_THAT(rows("lstQuotes"), Contains("06/03/2024\t10.00"));
    EXPECT_EQ(window().changeSerial(), steps + 1);
    EXPECT_EQ(window().history().undoLabel(), "Apply split AL");
    EXPECT_EQ(window().getState()->getShareState(0)->getQuantity(), 12);

    press("btnUndo");
    EXPECT_THAT(quotes(), ElementsAre(10, 12.5F, 10, 20));
    EXPECT_EQ(trades(), 1U);
    EXPECT_EQ(trade(0).getQuantity(), 10);
    EXPECT_EQ(company()->getNbrEvents(), 1U);
}

TEST_F(SplitTest, NothingIsDoneUnlessApplyIsPressedForWhatIsThere)
{
    addSplit("1", "2");
    const auto untouched = [this] {
        EXPECT_THAT(quotes(), ElementsAre(10, 12.5F, 20));
        EXPECT_EQ(trade(0).getQuantity(), 10);
        EXPECT_EQ(dialog(), nullptr);
    };
    click("btnApplySplit");
    EXPECT_THAT(line("txtWarning"), HasSubstr("look split already: 12.50 on 06/03/2024, 20.00 on 11/03/2024"));
    QTest::keyClick(dialog()->focusWidget(), Qt::Key_Escape);
    settle();
    untouched();
    click("btnApplySplit");
    QTest::keyClick(dialog()->focusWidget(), Qt::Key_Return); // with a warning, the keyboard is at Cancel
    settle();
    untouched();
    click("btnApplySplit");
    trade(0).setQuote(12); // by nobody at the screen
    pressPart("btnApply");
    untouched();
    post('SpAp');
    untouched();

    // Quotes that have come split stay.
    click("btnApplySplit");
    pressPart("cbxSplitQuotes");
    EXPECT_EQ(line("txtQuoteSample"), "06/03/2024:  12.50 stays");
    EXPECT_THAT(table("lstSplitHoldings"),
                ElementsAre("Before\t10\t25.00\t\t\t250.00", "After\t20\t12.50\t\t\t250.00"));
    pressPart("btnApply");
    EXPECT_THAT(quotes(), ElementsAre(10, 12.5F, 20));
    EXPECT_EQ(trade(0).getQuantity(), 20);
    click("btnApplySplit");
    EXPECT_THAT(line("txtWarning"), HasSubstr("Applied before"));
    pressPart("btnCancel");
}

TEST_F(SplitTest, ItWorksWithQuotesOnlyOrTradesOnlyAndSaysWhenThereIsNothing)
{
    addSmallCatalogue();
    click("btnApplySplit");
    EXPECT_EQ(dialog(), nullptr);
    EXPECT_THAT(notice(), HasSubstr("Select a split"));
    new SplitCompanyEvent(company(), Date(1, 1, 2024), 1, 2);
    new SplitCompanyEvent(company(), Date(2, 3, 2024), 1, 2);
    window().CompanySelection();
    select("lstCompanyEvents", 0);
    click("btnApplySplit");
    EXPECT_EQ(dialog(), nullptr);
    EXPECT_THAT(notice(), HasSubstr("Nothing to do: before 01/01/2024"));
    select("lstCompanyEvents", 1);
    click("btnApplySplit");
    pressPart("btnApply");
    EXPECT_THAT(quotes(), ElementsAre(5, 12.5F, 20));

    Company* bare = new Company(company()->market(), "Bare", "BR");
    buy(bare);
    new SplitCompanyEvent(bare, Date(1, 4, 2024), 1, 3);
    window().AddCompany(bare, true);
    settle();
    select("lstCompanyEvents", 0);
    click("btnApplySplit");
    EXPECT_FALSE(part<QWidget>("cbxSplitQuotes")->isEnabled());
    pressPart("btnApply");
    EXPECT_EQ(trade(0).getQuantity(), 30);
}
