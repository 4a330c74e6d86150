// A window that is killed at any moment of any commands: what the next start offers is whole, and not older than the
// interval.

#include "app/Rescue.h"
#include "foundation/Today.h"
#include "storage/Checksum.h"
#include "tests/gui/RandomCommands.h"
#include "tests/support/Bytes.h"
#include "tests/support/ToolRun.h"

#include <QCoreApplication>
#include <QProcess>
#include <algorithm>
#include <fcntl.h>
#include <filesystem>
#include <fstream>

namespace {

namespace fs = std::filesystem;
using Clock = std::chrono::steady_clock; // one for all processes

constexpr std::chrono::milliseconds kInterval(200);
constexpr std::chrono::milliseconds kWriting(800); // what a copy and one command may take on a busy machine
constexpr const char* kLog = "PELORIN_KILL_LOG";
constexpr const char* kSeed = "PELORIN_KILL_SEED";

/// What the window had at a time, and what of it no file had.
struct State {
    Clock::rep time;
    std::uint64_t sums[2];
    bool isUnsaved[2];
};

struct ShortPace {
    ShortPace() { Rescue::pace() = {kInterval, 1}; }
    ~ShortPace() { Rescue::pace() = {}; }
};

/// The program that is killed. It writes down each state before a copy of it can be made.
class KilledWindow : ShortPace, public QObject, public RandomCommands {
protected:
    KilledWindow() : RandomCommands(static_cast<unsigned>(qEnvironmentVariableIntValue(kSeed)))
    {
        log_ = ::open(qgetenv(kLog).constData(), O_WRONLY | O_CREAT | O_APPEND, 0600);
        tell(folder());
        DialogAnswers::current().panel = [this](const BFilePanel& panel) {
            return panel.PanelDirectory() + "/File " + std::to_string(under(3));
        };
        QCoreApplication::instance()->installEventFilter(this);
    }

    bool eventFilter(QObject*, QEvent* event) override
    {
        if (event->type() == QEvent::Timer)
            noteState();
        return false;
    }
    /// @param saving what is noted is how it will be once that file is saved.
    void noteState(std::optional<FileKind> saving = {})
    {
        const auto sum = [](const std::string& bytes) { return std::to_string(checksumOf(bytes)) + ' '; };
        std::string line = sum(bytesWritten(window().catalogue(), today())) + sum(bytesWritten(wallet(), today()));
        for (const FileKind kind : {FileKind::kMarkets, FileKind::kWallet})
            line += kind != saving && window().unsavedChanges(kind) > 0 ? "1 " : "0 ";
        if (line != std::exchange(last_, line))
            tell(line + std::to_string(Clock::now().time_since_epoch().count()));
    }

private:
    void tell(const std::string& line) const { (void)!write(log_, (line + '\n').data(), line.size() + 1); }

    int log_;
    std::string last_;
};

TEST_F(KilledWindow, DISABLED_GivesCommandsUntilItIsKilled)
{
    constexpr unsigned kRarely = 30;
    for (;;) {
        (this->*anyAction().run)();
        for (const uint32 code : {'CBRm', 'CBRc', 'WBRa', 'HUnd', 'HUnd', 'HRed'})
            if (under(kRarely) == 0)
                send({code});
        if (under(2 * kRarely) == 0)
            send({'WBRe'});
        if (under(20 * kRarely) == 0) { // a save makes copies, too, and those of the timer are to count
            settle();
            const bool isMarkets = under(2) == 0;
            show(isMarkets ? kCompanyPage : kPortoFolioPage);
            noteState(isMarkets ? FileKind::kMarkets : FileKind::kWallet);
            post('CBSv');
        }
        settle();
        noteState();
    }
}

class KilledWindowTest : public testing::Test {
protected:
    KilledWindowTest() { setToday(Date(21, 11, 2024)); } // as the killed window has it
    ~KilledWindowTest() override { setToday(Date()); }

    /// Starts a window, and kills it some time after it has begun.
    void run(int round)
    {
        const TemporaryFolder folder("KilledWindowTest");
        QProcessEnvironment environment = QProcessEnvironment::systemEnvironment();
        environment.insert("TMPDIR", QString::fromStdString(folder.path));
        environment.insert(kLog, QString::fromStdString(folder / "log"));
        environment.insert(kSeed, QString::number(2 * round)); // even: names that are no other's
        QProcess child;
        child.setProcessEnvironment(environment);
        child.setStandardOutputFile(QProcess::nullDevice());
        child.start(QCoreApplication::applicationFilePath(),
                    {"--gtest_filter=KilledWindow.*", "--gtest_also_run_disabled_tests"});
        ASSERT_TRUE(QTest::qWaitFor([&] { return contentOf(folder / "log").find('\n') != std::string::npos; }, 60000));
        std::mt19937 random(static_cast<unsigned>(round));
        QTest::qWait(static_cast<int>(below(random, 3000)));
        const Clock::rep killed = Clock::now().time_since_epoch().count();
        child.kill();
        ASSERT_TRUE(child.waitForFinished());
        ASSERT_EQ(child.exitStatus(), QProcess::CrashExit) << "it has ended by itself";
        read(folder / "log");
        expectOffer(killed);
    }
    void read(const std::string& path)
    {
        std::ifstream log(path);
        std::getline(log, data_);
        states_.clear();
        for (State s; log >> s.sums[0] >> s.sums[1] >> s.isUnsaved[0] >> s.isUnsaved[1] >> s.time;)
            states_.push_back(s);
    }
    /// That one of the states which were there in the last interval is what is left.
    void expectOffer(Clock::rep killed)
    {
        std::vector<std::uint64_t> sums[2];
        {
            const auto left = RescueCopies::takeLeftBehind(DataFolder(data_));
            ASSERT_LE(left.size(), 1U);
            for (const auto kind : {RescueNote::kMarkets, RescueNote::kPortfolio})
                if (!left.empty() && left.front()->note().parts[kind].isCopied())
                    sums[kind].push_back(left.front()->note().parts[kind].copy.sum);
        }
        const auto fits = [&](const State& state) {
            for (const auto kind : {RescueNote::kMarkets, RescueNote::kPortfolio})
                if (sums[kind].empty() ? state.isUnsaved[kind] : sums[kind].front() != state.sums[kind])
                    return false;
            return true;
        };
        const auto found = std::find_if(states_.rbegin(), states_.rend(), fits);
        if (found == states_.rend()) {
            EXPECT_TRUE(sums[0].empty() && sums[1].empty()) << "what is offered never was there";
        }
        const Clock::rep until = found == states_.rbegin() ? killed
                                 : found == states_.rend() ? states_.empty() ? killed : states_.front().time
                                                           : std::prev(found)->time;
        const auto behind = std::chrono::nanoseconds(killed - until);
        behind_.push_back(behind);
        EXPECT_LT(behind, kInterval + kWriting);
        if (!sums[0].empty() || !sums[1].empty())
            expectRestored(sums[0].empty() ? std::optional<std::uint64_t>() : sums[0].front());
    }
    void expectRestored(std::optional<std::uint64_t> marketSum)
    {
        auto* window = new PLWindow({50, 50, 850, 850}, DataFolder(data_));
        window->Show();
        window->makeOtherPages();
        auto* button = window->widget().findChild<QAbstractButton*>("btnNotice1");
        EXPECT_TRUE(button->isVisible());
        QTest::mouseClick(button, Qt::LeftButton);
        QCoreApplication::processEvents();
        const auto* notice = window->widget().findChild<QWidget*>("txtNotice");
        EXPECT_FALSE(notice->isVisible()) << notice->accessibleName().toStdString();
        if (marketSum) {
            EXPECT_EQ(checksumOf(bytesWritten(window->catalogue(), today())), *marketSum);
        }
        ++restored_;
        window->Quit();
    }

    std::string data_; // the killed window's data folder
    std::vector<State> states_;
    std::vector<std::chrono::nanoseconds> behind_;
    int restored_ = 0;
};

/// For a long run: see CONTRIBUTING.md.
TEST_F(KilledWindowTest, WhatIsOfferedIsWholeAndNotOlderThanTheInterval)
{
    const char* text = std::getenv("PELORIN_KILLS");
    const char* first = std::getenv("PELORIN_FIRST_KILL");
    const int kills = text != nullptr ? std::atoi(text) : 6;
    const int begin = first != nullptr ? std::atoi(first) : 0;
    for (int round = begin; round < begin + kills && !HasFailure(); ++round) {
        SCOPED_TRACE("kill " + std::to_string(round));
        run(round);
    }
    std::ranges::sort(behind_);
    const auto milliseconds = [](auto span) { return std::to_string(span.count() / 1000000); };
    RecordProperty("restored", restored_);
    std::printf("%d kills, %d restored; behind at most %s ms, half of them at most %s ms\n", kills, restored_,
                milliseconds(behind_.back()).c_str(), milliseconds(behind_[behind_.size() / 2]).c_str());
    EXPECT_GT(restored_, kills / 2);
}

} // namespace
