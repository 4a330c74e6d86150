#include "app/DurableSave.h"
#include "market/Catalogue.h"
#include "tests/support/Bytes.h"
#include "tests/support/SmallPortfolio.h"
#include "tests/support/ToolRun.h"

#include <chrono>
#include <csignal>
#include <cstring>
#include <functional>
#include <map>
#include <sys/ptrace.h>
#include <sys/wait.h>
#include <thread>

namespace {

namespace fs = std::filesystem;

/// Contents of a market file that follow each other, each different from those before. The stamps at the heads of the
/// currencies, at the front of the file and near its end, tell which it is; every second one is longer.
class Generations {
public:
    explicit Generations(int quotes)
    {
        for (SmallPortfolio& market : markets_) {
            for (int i = 0; i < quotes; ++i)
                new CompanyQuote(market.alpha, daysAfterStart(i), static_cast<float>(i));
            quotes += quotes / 3;
        }
        for (int i = 0; i < 2; ++i)
            bytes_[i] = written([this, i](FILE* file) { write(i, file); });
    }
    int write(int generation, FILE* file) const
    {
        return markets_[generation % 2].catalogue.wrt(file, stamp(generation));
    }
    /// Which one a file holds; -1 when it is none, whole.
    int generationOf(const std::string& content) const
    {
        if (content.size() < kStamp + 8)
            return -1;
        const auto at = [&content](std::size_t i) { return static_cast<unsigned char>(content[kStamp + i]); };
        const int generation = at(0) - 1 + 28 * (at(2) - 1 + 12 * (at(4) + 256 * at(5) - kYear));
        return generation >= 0 && content == bytes(generation) ? generation : -1;
    }

private:
    static constexpr std::size_t kStamp = 11; // behind the reference, "EUR", and the number of currencies
    static constexpr int kYear = 9000;        // later than any quote

    static Date stamp(int generation)
    {
        return {static_cast<short>(generation % 28 + 1), static_cast<short>(generation / 28 % 12 + 1),
                kYear + generation / 336};
    }
    std::string bytes(int generation) const
    {
        const std::string former = bytesWritten(stamp(generation % 2)), now = bytesWritten(stamp(generation));
        std::string result = bytes_[generation % 2];
        for (std::size_t i = 0; (i = result.find(former, i)) != std::string::npos; i += now.size())
            result.replace(i, now.size(), now);
        return result;
    }

    SmallPortfolio markets_[2];
    std::string bytes_[2];
};

/// A data folder with a market file, and what is found in it after a kill.
struct Files {
    explicit Files(const Generations& someGenerations) : generations(someGenerations) {}

    bool save(int generation) const
    {
        const auto write = [this, generation](FILE* file) { return generations.write(generation, file); };
        return DurableSave(data).save(path, write).outcome == DurableSave::Outcome::kSaved;
    }
    int generation() const { return generations.generationOf(contentOf(path)); }
    /// The versions' generations, by time; each file is read once, since a version never changes.
    std::vector<int> versions()
    {
        std::vector<int> result;
        for (const std::string& version : KeptVersions(data).versionsOf(path)) {
            const auto known = seen.try_emplace({version, fs::last_write_time(version)}, 0);
            if (known.second)
                known.first->second = generations.generationOf(contentOf(version));
            result.push_back(known.first->second);
        }
        return result;
    }
    int temporaryFiles() const
    {
        int n = 0;
        for (const auto& entry : fs::recursive_directory_iterator(folder.path))
            n += entry.path().extension() == ".tmp";
        return n;
    }

    const Generations& generations;
    const TemporaryFolder folder{"KilledSaveTest"};
    const DataFolder data{folder.path.string()};
    const std::string path = [this] {
        std::string error;
        return fs::canonical(data.companies(&error)) / "Large";
    }();
    std::map<std::pair<std::string, fs::file_time_type>, int> seen;
};

/// Saves one generation after the other until it is killed, and tells of each that is saved.
[[noreturn]] void saveForever(const Files& files, int generation, int report)
{
    while (files.save(generation) && write(report, &generation, sizeof generation) == sizeof generation)
        ++generation;
    _exit(1);
}

/// Lets a child save from `generation` on and kills it after a while. @return the last one that it said was saved.
int killAfter(std::chrono::microseconds time, const Files& files, int generation)
{
    int ends[2];
    EXPECT_EQ(pipe(ends), 0);
    const pid_t child = fork();
    if (child == 0)
        saveForever(files, generation, ends[1]);
    close(ends[1]);
    std::this_thread::sleep_for(time);
    kill(child, SIGKILL);
    int status = 0;
    waitpid(child, &status, 0);
    EXPECT_TRUE(WIFSIGNALED(status)) << "a save has failed";
    int last = generation - 1;
    while (read(ends[0], &generation, sizeof generation) == sizeof generation)
        last = generation;
    close(ends[0]);
    return last;
}

/// Lets a child do `work` and kills it on its way into system call number `n`, from 0.
/// @return false when it has ended before; `*status` is what waitpid says.
bool killAtCall(int n, const std::function<bool()>& work, int* status)
{
    const pid_t child = fork();
    if (child == 0) {
        if (ptrace(PTRACE_TRACEME, 0, nullptr, nullptr) != 0)
            _exit(2);
        raise(SIGSTOP);
        _exit(work() ? 0 : 1);
    }
    waitpid(child, status, 0);
    for (int stops = 2 * n + 1; stops > 0 && WIFSTOPPED(*status); --stops) { // it stops on its way out, too
        ptrace(PTRACE_SYSCALL, child, nullptr, nullptr);
        waitpid(child, status, 0);
    }
    const bool isKilled = WIFSTOPPED(*status);
    if (isKilled) {
        kill(child, SIGKILL);
        waitpid(child, status, 0);
    }
    return isKilled;
}

} // namespace

TEST(KilledSaveTest, AKillAtAnyTimeLeavesTheOldFileOrTheNewOne)
{
    constexpr int kKills = 220;
    constexpr int kQuotes = 200000;
    const Generations generations(kQuotes);
    Files files(generations);
    const auto start = std::chrono::steady_clock::now();
    for (int i = 0; i < 3; ++i)
        ASSERT_TRUE(files.save(i));
    const auto threeSaves =
        std::chrono::duration_cast<std::chrono::microseconds>(std::chrono::steady_clock::now() - start);
    std::mt19937 random(1);
    int current = 2, leftBehind = 0, saved = 0;
    for (int i = 0; i < kKills; ++i) {
        const int last = killAfter(threeSaves * below(random, 1000) / 1500, files, current + 1);
        const int found = files.generation();
        ASSERT_TRUE(found == last || found == last + 1) << "kill " << i << ": " << found << " after " << last;
        saved += found > current;
        current = found;
        const std::vector<int> versions = files.versions();
        EXPECT_TRUE(std::ranges::is_sorted(versions) && versions.front() >= 0) << "a damaged version";
        EXPECT_GE(versions.back(), current - 1) << "the version before";
        EXPECT_LE(versions.size(), KeptVersions::kVersions + 1) << "one that was not pruned any more";
        const int temporary = files.temporaryFiles();
        EXPECT_LE(temporary, 1) << "only that of the last kill";
        leftBehind += temporary;
    }
    RecordProperty("file_bytes", static_cast<int>(fs::file_size(files.path)));
    RecordProperty("save_microseconds", static_cast<int>(threeSaves.count() / 3));
    RecordProperty("kills_within_a_save", leftBehind);
    RecordProperty("kills_after_a_save", saved);
    EXPECT_GT(leftBehind, kKills / 10) << "too few kills have met a save";
    EXPECT_GT(saved, kKills / 10) << "too few saves have got through";
}

TEST(KilledSaveTest, AKillBetweenAnyTwoSystemCallsLeavesTheOldFileOrTheNewOne)
{
    const Generations generations(200);
    for (const bool isCopied : {false, true}) {
        int calls = 0, status = 0, found[2] = {};
        for (bool isKilled = true; isKilled; ++calls) {
            Files files(generations);
            ASSERT_TRUE(files.save(0));
            if (isCopied)
                fs::create_hard_link(files.path, files.folder.path / "in use");
            isKilled = killAtCall(
                calls, [&files] { return files.save(1); }, &status);
            if (WIFEXITED(status) && WEXITSTATUS(status) == 2)
                GTEST_SKIP() << "processes cannot be traced here";
            const int generation = files.generation();
            ASSERT_TRUE(generation == 0 || generation == 1) << "call " << calls;
            ++found[generation];
            const std::vector<int> versions = files.versions();
            EXPECT_TRUE(versions.empty() || versions == std::vector<int>{0}) << "call " << calls;
            EXPECT_EQ(versions.empty() && generation == 1, false) << "call " << calls << ": no version";

            EXPECT_TRUE(files.save(2)) << "call " << calls;
            EXPECT_EQ(files.temporaryFiles(), 0) << "call " << calls;
            EXPECT_EQ(files.versions().back(), generation) << "call " << calls;
        }
        EXPECT_TRUE(WIFEXITED(status) && WEXITSTATUS(status) == 0);
        EXPECT_GT(found[0], 20);
        EXPECT_GT(found[1], 3);
        RecordProperty(isCopied ? "calls_copying" : "calls_linking", calls);
    }
}
