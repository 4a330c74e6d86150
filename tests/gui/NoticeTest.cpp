// The line of notices, and what is told there and beside the figures.

#include "app/NoticeLine.h"
#include "platform/DialogAnswers.h"
#include "tests/gui/CatalogueFixture.h"
#include "tests/support/ToolRun.h"

#include <QCheckBox>
#include <QPushButton>

#include <filesystem>
#include <fstream>

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
    window().showNotice({"e", "just come", {button("Unread")}});
    QTest::keyClick(QApplication::focusWidget(), Qt::Key_6, Qt::AltModifier);
    QTest::keyClick(QApplication::focusWidget(), Qt::Key_0, Qt::AltModifier);
    settle();
    EXPECT_EQ(pressed + notice(), "OnGojust come") << "not for what nobody has seen";
    key(Qt::Key_6, Qt::AltModifier);
    EXPECT_EQ(pressed + notice(), "OnGoUnread");
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
    new CompanyQuote(beta(), Date(1, 1, 2024), 10); // a trend that neither limit meets
    buy(beta());                                    // on 02/03/2024, for 90 days
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
    EXPECT_EQ(beta()->shares()[0]->getNbrShareOperations(), 2U);
    press("btnNotice1");
    EXPECT_EQ(notice(), "");
    EXPECT_EQ(beta()->shares()[0]->getNbrShareOperations(), 1U);
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

/// F1, and what the desktop does with the file that it is asked to open.
class GuideTest : public NoticeTest {
protected:
    ~GuideTest() override
    {
        DialogAnswers::current().launch = nullptr;
        qputenv("PATH", path_);
    }
    const QByteArray path_ = qgetenv("PATH");
};

TEST_F(GuideTest, F1OpensItAtThePageInFront)
{
    std::string opened;
    DialogAnswers::current().launch = [&opened](const std::string& path) {
        opened = path;
        return true;
    };
    addSmallCatalogue();
    choose("companyEventType", "Split");
    follow({{{{"txtCompanyEventDate", "10/3/2024"}}, "btnAddCompanyEvent", ""}});
    const struct {
        Page page;
        const char* button; // of the page, which opens a window; empty without one
        const char* file;
        const char* section;
    } cases[] = {
        {kCurrencyPage, "", "currency.html", "#currency"},
        {kPortoFolioPage, "", "portofolio.html", "#portofolio"},
        {kOperationPage, "", "operations.html", "#operations"},
        {kParameterPage, "", "parameters.html", "#parameters"},
        {kCompanyPage, "", "company.html", "#company"},
        {kCompanyPage, "btnApplySplit", "split.html", "#6-when-a-share-is-split"},
    };
    for (const auto& c : cases) {
        show(c.page);
        if (*c.button != '\0')
            click(c.button);
        key(Qt::Key_F1);
        EXPECT_EQ(std::filesystem::path(opened).filename(), c.file);
        EXPECT_THAT(contentOf(opened), HasSubstr(std::string("url=index.html") + c.section + '"'));
        EXPECT_EQ(notice().find("guide"), std::string::npos);
    }
    QTest::keyClick(QApplication::activeModalWidget(), Qt::Key_Escape); // it outlives the other window
    settle();
}

TEST_F(GuideTest, WhereNoBrowserOpensItTheFileIsNamed)
{
    dismissOffer();
    show(kCompanyPage);
    const std::string opened = folder() + "/opened";
    const std::pair<std::string, bool> openers[] = {
        {"", false}, {"exit 4", false}, {"kill -9 $$", false}, {"echo \"$1\" > '" + opened + "'", true}};
    for (const auto& [opener, succeeds] : openers) {
        SCOPED_TRACE(opener);
        const std::string script = folder() + "/xdg-open";
        if (!opener.empty())
            std::ofstream(script) << "#!/bin/sh\n" << opener << '\n';
        if (!opener.empty())
            std::filesystem::permissions(script, std::filesystem::perms::owner_all);
        qputenv("PATH", QByteArray::fromStdString(folder()));
        key(Qt::Key_F1);
        EXPECT_TRUE(QTest::qWaitFor([&, succeeds = succeeds] {
            return succeeds ? std::filesystem::exists(opened) : notice().ends_with("/pelorin/company.html");
        })) << notice();
        if (!succeeds)
            press("txtNotice");
    }
    EXPECT_TRUE(QTest::qWaitFor([&] { return contentOf(opened).ends_with("/pelorin/company.html\n"); }));
    EXPECT_EQ(notice(), "");
}

} // namespace
