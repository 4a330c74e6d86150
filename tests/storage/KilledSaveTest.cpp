#include "storage/DurableSave.h"
#include "storage/RescueCopies.h"
#include "tests/support/ToolRun.h"

#include <algorithm>
#include <cerrno>
#include <csignal>
#include <cstddef>
#include <cstring>
#include <functional>
#include <gtest/gtest.h>
#include <sys/ptrace.h>
#include <sys/syscall.h>
#include <sys/user.h>
#include <vector>

namespace {

namespace fs = std::filesystem;

/// More than a block, with the number at both ends.
std::string contentOfSave(int number)
{
    return std::to_string(number) + std::string(10000, ' ') + std::to_string(number);
}

/// Which save has written this; -1 when it is not whole.
int numberOf(const std::string& content)
{
    const int number = std::atoi(content.c_str());
    return content == contentOfSave(number) ? number : -1;
}

constexpr int kNotTraced = 2; // what a child exits with that cannot be traced

/// Starts a child that does `work`, and lets it go until it is on its way into system call number `n`, from 0.
/// @return its number; `*status` is what waitpid says, that it has stopped unless it has ended before.
pid_t startUntilCall(int n, const std::function<int()>& work, int* status)
{
    const pid_t child = fork();
    if (child == 0) {
        if (ptrace(PTRACE_TRACEME, 0, nullptr, nullptr) != 0)
            _exit(kNotTraced);
        raise(SIGSTOP);
        _exit(work());
    }
    waitpid(child, status, 0);
    for (int stops = 2 * n + 1; stops > 0 && WIFSTOPPED(*status); --stops) { // it stops on its way out, too
        ptrace(PTRACE_SYSCALL, child, nullptr, nullptr);
        waitpid(child, status, 0);
    }
    return child;
}

/// Kills the child. @return the new status.
int killChild(pid_t child)
{
    int status;
    kill(child, SIGKILL);
    waitpid(child, &status, 0);
    return status;
}

#ifdef __x86_64__
/// Lets the call that the child is about to make fail with `error`, and the child go on to its end. Calls that are not
/// about files are made: no file or disk makes them fail, and the end of a process cannot.
/// @return the new status.
int failCall(pid_t child, int error)
{
    constexpr long kOthers[] = {
        SYS_brk,   SYS_mmap,         SYS_munmap,         SYS_mremap,          SYS_mprotect,    SYS_madvise,
        SYS_futex, SYS_rt_sigaction, SYS_rt_sigprocmask, SYS_clock_nanosleep, SYS_sigaltstack, SYS_exit_group};
    auto* const number = reinterpret_cast<void*>(offsetof(user_regs_struct, orig_rax));
    auto* const result = reinterpret_cast<void*>(offsetof(user_regs_struct, rax));
    int status;
    if (std::ranges::find(kOthers, ptrace(PTRACE_PEEKUSER, child, number, nullptr)) == std::end(kOthers)) {
        ptrace(PTRACE_POKEUSER, child, number, reinterpret_cast<void*>(-1L)); // there is no such call
        ptrace(PTRACE_SYSCALL, child, nullptr, nullptr);
        waitpid(child, &status, 0);
        ptrace(PTRACE_POKEUSER, child, result, reinterpret_cast<void*>(-static_cast<long>(error)));
    }
    ptrace(PTRACE_CONT, child, nullptr, nullptr);
    waitpid(child, &status, 0);
    return status;
}
#else
int failCall(pid_t child, int)
{
    return killChild(child);
}
#endif

/// A file that is saved over and over, and what is found in its folder.
struct Saves {
    Saves() { fs::create_symlink("file", link); }
    DurableSave::Result result(int number) const
    {
        const auto write = [number](FILE* file) {
            return std::fputs(contentOfSave(number).c_str(), file) < 0 ? -1 : 0;
        };
        return DurableSave(data).save(link, write);
    }
    bool save(int number) const { return result(number).outcome == DurableSave::Outcome::kSaved; }
    /// Saves after a save that was disturbed, and looks at what is left of that.
    void saveAgain(int number, bool isCopied) const
    {
        const int now = numberOf(contentOf(path));
        EXPECT_TRUE(save(number));
        EXPECT_TRUE(fs::is_symlink(link));
        EXPECT_EQ(temporaryFiles(), 0);
        const std::vector<int> kept = versions();
        EXPECT_TRUE(std::ranges::is_sorted(kept) && kept.front() >= 0);
        EXPECT_TRUE(isCopied || std::ranges::adjacent_find(kept) == kept.end()) << "the link of a killed save stays";
        EXPECT_LE(kept.size(), KeptVersions::kVersions);
        EXPECT_EQ(kept.back(), now);
    }
    /// Gives the file a second name or takes it away, so that it has to be copied or can be linked.
    void setInUse(bool isCopied) const
    {
        fs::remove(folder / "in use");
        if (isCopied)
            fs::create_hard_link(path, folder / "in use");
    }
    /// The saves that have written the versions, in their order.
    std::vector<int> versions() const
    {
        std::vector<int> numbers;
        for (const std::string& version : KeptVersions(data).versionsOf(path))
            numbers.push_back(numberOf(contentOf(version)));
        return numbers;
    }
    std::ptrdiff_t temporaryFiles() const
    {
        const auto isTemporary = [](const fs::path& file) { return file.extension() == ".tmp"; };
        return std::count_if(fs::recursive_directory_iterator(folder.path), fs::recursive_directory_iterator(),
                             isTemporary);
    }

    const TemporaryFolder folder{"KilledSaveTest"};
    const DataFolder data{folder / "Pelorin"};
    const std::string path = fs::canonical(folder.path) / "file";
    const std::string link = folder / "link"; // to the file
};

} // namespace

TEST(KilledSaveTest, AKillBetweenAnyTwoSystemCallsLeavesTheOldFileOrTheNewOne)
{
    for (const bool isCopied : {false, true}) {
        const Saves files;
        int status = 0, found[2] = {}, number = 1, kept = 0;
        ASSERT_TRUE(files.save(kept) && files.save(number));
        bool isKilled = true;
        for (int call = 0; isKilled; ++call) {
            SCOPED_TRACE("call " + std::to_string(call));
            files.setInUse(isCopied);
            const pid_t child = startUntilCall(
                call, [&] { return files.save(number + 1) ? 0 : 1; }, &status);
            if (WIFEXITED(status) && WEXITSTATUS(status) == kNotTraced)
                GTEST_SKIP() << "processes cannot be traced here";
            isKilled = WIFSTOPPED(status);
            if (isKilled)
                killChild(child);
            const int now = numberOf(contentOf(files.path));
            ASSERT_TRUE(now == number || now == number + 1) << now;
            ++found[now - number];
            const int lastKept = files.versions().back();
            EXPECT_TRUE(lastKept == number || (lastKept == kept && now == number));
            number += 2;
            files.saveAgain(number, isCopied);
            kept = now;
        }
        EXPECT_TRUE(WIFEXITED(status) && WEXITSTATUS(status) == 0);
        EXPECT_GT(found[0], 20);
        EXPECT_GT(found[1], 3);
    }
}

TEST(KilledSaveTest, AKillBetweenAnyTwoSystemCallsLeavesTheLastRescueOrTheNextOneWhole)
{
    const TemporaryFolder folder("KilledSaveTest");
    const DataFolder data(folder / "Pelorin");
    const auto save = [&](int number) {
        const auto write = [number](FILE* file) {
            return std::fputs(contentOfSave(number).c_str(), file) < 0 ? -1 : 0;
        };
        const auto left = RescueCopies::takeLeftBehind(data);
        const auto copies = left.empty() ? std::make_shared<RescueCopies>(data) : left.front();
        copies->write({{{"m", false, write, false}, {"p", false, write, false}}});
        return 0;
    };
    int number = -1, found[2] = {}; // -1: there is none yet
    for (const int first : {-1, 0}) {
        for (int call = 0, status = 0;; ++call) {
            SCOPED_TRACE("call " + std::to_string(call));
            const pid_t child = startUntilCall(
                call, [&] { return save(number + 1); }, &status);
            if (WIFEXITED(status) && WEXITSTATUS(status) == kNotTraced)
                GTEST_SKIP() << "processes cannot be traced here";
            const bool isKilled = WIFSTOPPED(status);
            if (isKilled)
                killChild(child);
            auto left = RescueCopies::takeLeftBehind(data);
            ASSERT_LE(left.size(), 1U);
            const int now = left.empty() ? -1 : numberOf(contentOf(left.front()->copyOf(RescueNote::kMarkets)));
            const int other = left.empty() ? -1 : numberOf(contentOf(left.front()->copyOf(RescueNote::kPortfolio)));
            ASSERT_TRUE(now == other && (now == number || now == number + 1)) << now << ' ' << other;
            ++found[now - number];
            number = now;
            if (!isKilled)
                break;
            if (first < 0 && now >= 0) { // from the beginning again
                left.front()->remove();
                number = -1;
            }
        }
    }
    EXPECT_GT(found[0], 100);
    EXPECT_GT(found[1], 10);
    RescueCopies::takeLeftBehind(data).front()->remove();
    const auto isFile = [](const fs::directory_entry& entry) { return entry.is_regular_file(); };
    EXPECT_EQ(std::count_if(fs::recursive_directory_iterator(folder.path), fs::recursive_directory_iterator(), isFile),
              0)
        << "what killed ones have left is cleared away";
}

TEST(KilledSaveTest, AnErrorOfAnySystemCallFailsTheSaveWithAReasonOrDoesNoHarm)
{
#ifndef __x86_64__
    GTEST_SKIP() << "how a call is made to fail is known for x86_64 only";
#endif
    enum { kSaved, kRefused = kNotTraced + 1, kUntold };
    const int errors[] = {EIO, EACCES, ENOSPC, ELOOP, ENAMETOOLONG};
#ifdef __SANITIZE_ADDRESS__
    const int step = 5; // a fork takes its time there: each call has one of the errors
#else
    const int step = 1;
#endif
    const Saves files;
    int refused = 0, number = 1;
    ASSERT_TRUE(files.save(0) && files.save(number));
    const auto work = [&] {
        const DurableSave::Result result = files.result(number + 1);
        const bool isSaved = result.outcome == DurableSave::Outcome::kSaved;
        return isSaved != result.reason.empty() ? kUntold : isSaved ? kSaved : kRefused;
    };
    bool isReached = true;
    for (int call = 0; isReached; ++call) {
        isReached = false;
        for (int i = 0; i < 2 * std::ssize(errors); ++i) {
            if ((i / 2 + call) % step != 0)
                continue;
            const int error = errors[i / 2];
            SCOPED_TRACE(std::strerror(error) + (" in call " + std::to_string(call)));
            files.setInUse(i % 2 == 1); // a copy is written
            int status;
            const pid_t child = startUntilCall(call, work, &status);
            if (WIFEXITED(status) && WEXITSTATUS(status) == kNotTraced)
                GTEST_SKIP() << "processes cannot be traced here";
            if (WIFSTOPPED(status)) {
                isReached = true;
                status = failCall(child, error);
            }
            ASSERT_TRUE(WIFEXITED(status)) << status;
            const int now = numberOf(contentOf(files.path));
            EXPECT_EQ(WEXITSTATUS(status), now == number ? kRefused : kSaved);
            ASSERT_TRUE(now == number || (now == number + 1 && files.versions().back() == number)) << now;
            refused += now == number;
            number = now;
        }
        files.saveAgain(++number, true);
    }
    EXPECT_GT(refused, 200 / step);
}
