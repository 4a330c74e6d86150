// The line of notices, and what is told there and beside the figures.

#include "app/NoticeLine.h"
#include "tests/gui/CatalogueFixture.h"

#include <QCheckBox>
#include <QPushButton>

namespace {

using testing::HasSubstr;

class NoticeTest : public CatalogueTest {
protected:
    /// What is shown of it; empty while it is hidden.
    std::string shown(const char* name)
    {
        const auto* button = qobject_cast<QPushButton*>(&anywhere(name));
        const QString text = button != nullptr ? button->text() : anywhere(name).accessibleName();
        return anywhere(name).isVisible() ? text.toStdString() : "";
    }
};

TEST_F(NoticeTest, SeveralQueueAndAClickBringsTheNext)
{
    std::string pressed;
    const auto button = [&](const char* label) {
        return Notice::Button{label, [&pressed, label] { pressed += label; }};
    };
    dismissOffer();
    show(kPortoFolioPage);
    find<QWidget>("txtDate").setFocus();
    EXPECT_EQ(notice(), "");
    window().showNotice({"a", "first", {button("Yes"), button("No")}});
    window().showNotice({"b", "second", {}});
    window().showNotice({"c", "third", {button("Go")}});
    window().showNotice({"b", "second, again", {}});
    EXPECT_EQ(notice() + ' ' + shown("btnNotice1") + ' ' + shown("btnNotice2"), "first Yes No");
    window().showNotice({"a", std::string(500, 'w') + "\nmore", {button("On")}});
    EXPECT_EQ(notice(), std::string(500, 'w') + "\nmore") << "in the place of the former one";
    EXPECT_THAT(anywhere("txtNotice").toolTip().toStdString(), HasSubstr("wwww\nmore"));
    EXPECT_EQ(shown("btnNotice1") + shown("btnNotice2"), "On");
    EXPECT_LT(anywhere("txtNotice").geometry().right(), anywhere("btnNotice1").geometry().left());
    window().showNotice({"d", "passing", {}, true});
    EXPECT_EQ(notice(), "passing") << "it does not queue";
    BMessage expired('NtEx');
    window().FindView("NoticeLine")->MessageReceived(&expired);
    EXPECT_THAT(notice(), HasSubstr("more"));

    auto& on = static_cast<QPushButton&>(anywhere("btnNotice1"));
    on.click();
    on.click(); // before the first one has its turn
    settle();
    EXPECT_EQ(pressed, "On") << "and not what came in its place";
    EXPECT_EQ(notice(), "second, again");
    EXPECT_EQ(shown("btnNotice1"), "");
    press("txtNotice");
    EXPECT_EQ(notice() + ' ' + shown("btnNotice1"), "third Go");
    QTest::keyClick(QApplication::focusWidget(), Qt::Key_7, Qt::AltModifier); // it has one button only
    settle();
    QTest::keyClick(QApplication::focusWidget(), Qt::Key_6, Qt::AltModifier);
    settle();
    EXPECT_EQ(pressed + notice(), "OnGo");
    window().showNotice({"c", "third", {}});
    window().showNotice({"a", "last", {}});
    window().dropNotice("c");
    EXPECT_EQ(notice(), "last");
    press("NoticeLine");
    EXPECT_EQ(notice(), "");
    EXPECT_EQ(QApplication::focusWidget()->objectName(), "txtDate") << "the keyboard has stayed where it was";
}

TEST_F(NoticeTest, SimulatedSalesAreToldOfAndTakenBack)
{
    addTwoMarkets();
    Company* beta = window().catalogue().getMarkets()[1]->companies().front();
    new CompanyQuote(beta, Date(1, 1, 2024), 10); // a trend that neither limit meets
    buy(beta);                                    // on 02/03/2024, for 90 days
    show(kPortoFolioPage);
    enter("txtDate", "1/4/2024");
    const auto before = rows("lstShares");
    show(kOperationPage);
    click("cbxPrevision");
    EXPECT_THAT(notice(), testing::StartsWith("simulated sales are in these figures from "));
    show(kPortoFolioPage);
    enter("txtDate", "21/11/2024");
    EXPECT_EQ(notice(), "simulated sales are in these figures");
    press("txtNotice");
    enter("txtDate", "20/11/2024");
    EXPECT_EQ(notice(), "") << "who has dismissed it knows";
    enter("txtDate", "1/4/2024");
    ASSERT_EQ(shown("btnNotice1"), "Take Back");
    EXPECT_EQ(beta->shares()[0]->getNbrShareOperations(), 2U);
    press("btnNotice1");
    EXPECT_EQ(notice(), "");
    EXPECT_EQ(beta->shares()[0]->getNbrShareOperations(), 1U);
    EXPECT_EQ(rows("lstShares"), before);
    show(kOperationPage);
    EXPECT_FALSE(find<QCheckBox>("cbxPrevision").isChecked());
}

TEST_F(NoticeTest, TotalsSayWhatTheyRestOn)
{
    addTwoMarkets();
    const auto markets = window().catalogue().getMarkets();
    new CompanyQuote(markets[0]->companies().front(), Date(15, 11, 2024), 10);
    buy(markets[0]->companies().front());
    buy(markets[1]->companies().front());
    show(kPortoFolioPage);
    EXPECT_EQ(shown("txtEstimated"), "estimated: 2 of 2 quotes are older than 21/11/2024, no day has all quotes");
    EXPECT_EQ(shown("btnLastQuotes"), "");
    new CompanyQuote(markets[0]->companies().front(), Date(1, 11, 2024), 10);
    enter("txtDate", "15/11/2024");
    EXPECT_EQ(shown("txtEstimated"),
              "estimated: 1 of 2 quotes is older than 15/11/2024, the last day with all quotes is 01/11/2024");
    EXPECT_THAT(anywhere("txtEstimated").toolTip().toStdString(), HasSubstr("1 of 1 rates is older"));
    click("btnLastQuotes");
    EXPECT_EQ(text("txtDate"), "01/11/2024");
    EXPECT_EQ(shown("txtEstimated"),
              "estimated: 1 of 1 rates is older than 01/11/2024, the last day with all rates is 01/01/2020");
}

TEST_F(NoticeTest, EnterAndEscapeCancelWhatDestroys)
{
    addSmallCatalogue();
    for (const char* key : {"Enter", "Escape"}) {
        answerNextAlert(key);
        click("btnRemoveCompany");
        EXPECT_EQ(alerts().size(), 1U);
        EXPECT_THAT(rows("lstCompanies"), testing::SizeIs(1)) << key;
    }
}

} // namespace
