// Undo and redo: whatever a person did, the way back passes the same moments, and the way on again.

#include "platform/Button.h"
#include "platform/CheckBox.h"
#include "platform/Entry.h"
#include "platform/ListItem.h"
#include "platform/Message.h"
#include "platform/TabView.h"
#include "tests/gui/RandomCommands.h"

#include <cstdlib>
#include <filesystem>
#include <map>

namespace {

/// Tells of each message that was handled.
class WatchedWindow final : public PLWindow {
public:
    using PLWindow::PLWindow;

    void MessageReceived(BMessage* message) override
    {
        PLWindow::MessageReceived(message);
        if (handled)
            handled();
    }

    std::function<void()> handled;
};

class UndoTest : public RandomCommands, public testing::WithParamInterface<unsigned> {
protected:
    UndoTest() : RandomCommands(GetParam())
    {
        setMaker([](BRect frame, const DataFolder& folder) { return new WatchedWindow(frame, folder); });
        restart();
        watched().handled = [this] { noteMoment(); };
    }
    ~UndoTest() override { watched().handled = nullptr; }

    WatchedWindow& watched() { return dynamic_cast<WatchedWindow&>(window()); }

    /// All that shall come back: both files, all lists with what is selected, the totals, the lists of holdings.
    std::string fingerprint()
    {
        std::string print = bytes();
        for (const auto& [page, name] : kLists) {
            const BListView& rows = listOf(page, name);
            print += std::string("\n-- ") + page + ' ' + name;
            for (int32 i = 0; i < rows.CountItems(); ++i)
                print += (rows.IsItemSelected(i) ? "\n* " : "\n") + rows.ItemAt(i)->Text();
        }
        print += "\n--";
        for (const char* field : {"txtTotalDeposit", "txtTotalValue", "txtProfit", "txtAnnualRevenu"})
            print += std::string(" ") + dynamic_cast<BTextControl&>(*window().FindView(field)).Text();
        for (const Market* market : window().catalogue().getMarkets())
            for (const Company* company : market->companies())
                for (const Share* share : company->shares()) {
                    unsigned place = 0;
                    while (wallet().shares()[place] != share)
                        ++place;
                    print += "\nholding " + std::to_string(place) + ' ';
                    for (const ShareOperation* operation : share->shareOperations())
                        print += dateOf(operation->getDate(), 0) + (operation->isAutomatic() ? "a " : " ");
                }
        return print;
    }

    /// Of the moments between two steps the last one counts: it is what the next step is taken back to.
    void noteMoment()
    {
        if (isGoing_)
            return;
        moments_[window().changeSerial() - begin_] = fingerprint();
    }

    void loadAndReinit()
    {
        settle();
        const auto load = [this](int32 tab, const std::string& name) {
            dynamic_cast<BTabView&>(*window().FindView("TabView")).Select(tab);
            settle();
            if (under(2) == 0)
                window().Save((folder() + '/' + name).c_str());
            BMessage answer(B_REFS_RECEIVED);
            const entry_ref ref{folder(), name};
            answer.AddRef("refs", &ref);
            window().PostMessage(&answer);
            settle();
        };
        switch (under(4)) {
        case 0:
            return load(0, "market" + std::to_string(under(2)));
        case 1:
            return send({'WBRe'});
        default:
            return load(2, "wallet" + std::to_string(under(2)));
        }
    }

    void removeMuch()
    {
        for (const uint32 removal : {'CBRm', 'CBRc', 'RBRe', 'WBRa'})
            if (under(30) == 0)
                send({removal});
    }

    /// Along the steps by a button, and at each moment all is as it was.
    void go(const char* button, long from, long to)
    {
        isGoing_ = true;
        for (long step = from; step != to && !HasFailure();) {
            step += to > from ? 1 : -1;
            dynamic_cast<BButton&>(*window().FindView(button)).Invoke();
            settle();
            ASSERT_EQ(fingerprint(), moments_[static_cast<std::uint64_t>(step)]) << button << " to step " << step;
        }
        isGoing_ = false;
    }
    long stepCount() { return static_cast<long>(window().changeSerial() - begin_); }
    bool isEnabled(const char* button) { return dynamic_cast<BButton&>(*window().FindView(button)).IsEnabled(); }

    std::uint64_t begin_ = 0;
    bool isGoing_ = false;
    std::map<std::uint64_t, std::string> moments_;
};

TEST_P(UndoTest, TheWayBackAndOnPassesTheSameMoments)
{
    // What is valued, and how, is no part of a step: it stays the same here. Some runs simulate sales.
    dynamic_cast<BCheckBox&>(*window().FindView("cbxPrevision")).SetValue(GetParam() % 4 < 2);
    send({'OCPr'});
    settle();
    noteMoment();
    const char* text = std::getenv("PELORIN_UNDO_STEPS");
    const int steps = text != nullptr ? std::atoi(text) : 300;
    for (int i = 0; i < steps; ++i) {
        if (under(25) == 0)
            loadAndReinit();
        else if (const Action& action = anyAction(); std::string(action.name) != "revalue")
            (this->*action.run)();
        settle(); // else a step may end while a list still waits to follow the selection in another one
        removeMuch();
        settle();
        send({'WTDa'}); // some commands leave the former totals there until the next valuation, an undo does not
        settle();
    }
    const long last = stepCount();
    EXPECT_GT(last, steps / 5);
    go("btnUndo", last, 0);
    EXPECT_FALSE(isEnabled("btnUndo"));
    go("btnRedo", 0, last);
    EXPECT_FALSE(isEnabled("btnRedo"));
}

class UndoStepTest : public WindowTest {
protected:
    std::string tip(const char* button) { return window().FindView(button)->widget()->toolTip().toStdString(); }
    void addMarket(const std::string& name)
    {
        enter("txtMarketName", name);
        enter("txtMarketCurrencyRepresentation", "EUR");
        click("btnAddMarket");
    }
};

TEST_F(UndoStepTest, CountsWhatTheFilesDoNotHave)
{
    loadSample();
    show(kCompanyPage);
    EXPECT_EQ(openFile(), "Sample");
    addMarket("Xetra");
    EXPECT_EQ(openFile(), "Sample - 1 change not saved");
    EXPECT_EQ(tip("btnUndo"), "Undo: Add market Xetra  Ctrl+Z");
    addMarket("Milan");
    ctrl(Qt::Key_S);
    EXPECT_EQ(openFile(), "Sample");
    // Past a save the file has more than there is here.
    ctrl(Qt::Key_Z);
    EXPECT_EQ(openFile(), "Sample - 1 change not saved");
    EXPECT_EQ(tip("btnRedo"), "Redo: Add market Milan  Ctrl+Shift+Z");
    ctrl(Qt::Key_Z, Qt::ShiftModifier);
    EXPECT_EQ(openFile(), "Sample");
    // Another way on from there: one step back and one on.
    ctrl(Qt::Key_Z);
    addMarket("Zurich");
    EXPECT_EQ(openFile(), "Sample - 2 changes not saved");
    show(kParameterPage);
    EXPECT_EQ(openFile(), "Sample"); // the portfolio's
}

TEST_F(UndoStepTest, TakesBackALoadAndAReinitWithTheirFiles)
{
    loadSample();
    show(kPortoFolioPage);
    click("btnReinitPortoFolio");
    EXPECT_EQ(openFile(), "No file");
    EXPECT_EQ(tip("btnUndo"), "Undo: Reinit  Ctrl+Z");
    ctrl(Qt::Key_Z);
    EXPECT_EQ(openFile(), "Sample");
    EXPECT_GT(wallet().getNbrAccounts(), 0U);
    // A save after the undo of a load writes to the file of before.
    std::filesystem::copy(walletFile(), folder() + "/PortoFolios/Other");
    loadWallet(folder() + "/PortoFolios/Other");
    EXPECT_EQ(openFile(), "Other");
    ctrl(Qt::Key_Z);
    EXPECT_EQ(openFile(), "Sample");
    show(kParameterPage);
    enter("txtBuyCost", "77");
    EXPECT_EQ(openFile(), "Sample - 1 change not saved");
    const auto other = std::filesystem::last_write_time(folder() + "/PortoFolios/Other");
    ctrl(Qt::Key_S);
    EXPECT_EQ(message(), "Wallet successfully saved...");
    EXPECT_EQ(std::filesystem::last_write_time(folder() + "/PortoFolios/Other"), other);
}

TEST_F(UndoStepTest, ASaveGivesANameThatStaysOnTheWayBackAndOn)
{
    makeSample();
    loadMarkets(marketFile());
    show(kPortoFolioPage);
    fill({{"txtAccountName", "Main"}, {"txtAccountCurrency", "EUR"}});
    click("btnAddAccount");
    click("btnSavePortoFolio");
    answerPanel("SavePanel", "Named");
    EXPECT_EQ(openFile(), "Named");
    for (const auto modifiers : {Qt::ControlModifier | Qt::NoModifier, Qt::ControlModifier | Qt::ShiftModifier}) {
        key(Qt::Key_Z, modifiers);
        key(Qt::Key_Z, modifiers);
    }
    EXPECT_EQ(openFile(), "Named");
    clearMessage();
    ctrl(Qt::Key_S);
    EXPECT_EQ(message(), "Wallet successfully saved...") << "and nothing is asked: the file is as this window wrote it";

    // The portfolio's file has names of the market data, and no places in it.
    show(kCompanyPage);
    select("lstMarkets", 1);
    select("lstCompanies", 0);
    answerNextAlert("Continue");
    click("btnRemoveCompany");
    EXPECT_EQ(openFile(), "Sample - 1 change not saved");
    show(kParameterPage);
    EXPECT_EQ(openFile(), "Named");
    show(kCurrencyPage);
    select("lstCurrencies", 0);
    enter("txtCurrencyName", "Other");
    click("btnUpdateCurrency");
    EXPECT_EQ(openFile(), "Sample - 2 changes not saved");
    show(kParameterPage);
    EXPECT_EQ(openFile(), "Named - 1 change not saved");
}

TEST_F(UndoStepTest, LeavesCtrlZToAFieldThatIsBeingTypedIn)
{
    show(kCurrencyPage);
    enter("txtCurrencyRepresentation", "EUR");
    type("txtCurrencyName", "Euro");
    ctrl(Qt::Key_N); // adds; the keyboard stays in the field
    ASSERT_EQ(rows("lstCurrencies").size(), 1U);
    QTest::keyClicks(QApplication::focusWidget(), "s");
    ctrl(Qt::Key_Z);
    EXPECT_EQ(text("txtCurrencyName"), "Euro");
    EXPECT_EQ(rows("lstCurrencies").size(), 1U);
    ctrl(Qt::Key_Z);
    EXPECT_EQ(rows("lstCurrencies").size(), 0U);
    ctrl(Qt::Key_Z, Qt::ShiftModifier);
    EXPECT_EQ(rows("lstCurrencies").size(), 1U);
}

INSTANTIATE_TEST_SUITE_P(Seeds, UndoTest, testing::Range(firstSeed(), firstSeed() + 4));

} // namespace
