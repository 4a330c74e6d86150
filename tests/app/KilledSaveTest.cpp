#include "app/DurableSave.h"
#include "tests/support/ToolRun.h"

#include <algorithm>
#include <csignal>
#include <functional>
#include <gtest/gtest.h>
#include <sys/ptrace.h>
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

/// A file that is saved over and over, and what is found in its folder.
struct Saves {
    bool save(int number) const
    {
        const auto write = [number](FILE* file) {
            return std::fputs(contentOfSave(number).c_str(), file) < 0 ? -1 : 0;
        };
        return DurableSave(data).save(path, write).outcome == DurableSave::Outcome::kSaved;
    }
    /// The saves that have written the versions, in their order.
    std::vector<int> versions() const
    {
        std::vector<int> numbers;
        for (const std::string& version : KeptVersions(data).versionsOf(path))
            numbers.push_back(numberOf(contentOf(version)));
        return numbers;
    }
    auto temporaryFiles() const
    {
        const auto isTemporary = [](const fs::path& file) { return file.extension() == ".tmp"; };
        return std::count_if(fs::recursive_directory_iterator(folder.path), fs::recursive_directory_iterator(),
                             isTemporary);
    }

    const TemporaryFolder folder{"KilledSaveTest"};
    const DataFolder data{folder / "Pelorin"};
    const std::string path = fs::canonical(folder.path) / "file";
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
            fs::remove(files.folder / "in use");
            if (isCopied)
                fs::create_hard_link(files.path, files.folder / "in use");
            const auto work = [&files, number] { return files.save(number + 1); };
            isKilled = killAtCall(call, work, &status);
            if (WIFEXITED(status) && WEXITSTATUS(status) == 2)
                GTEST_SKIP() << "processes cannot be traced here";
            const int now = numberOf(contentOf(files.path));
            ASSERT_TRUE(now == number || now == number + 1) << "call " << call << ": " << now;
            ++found[now - number];
            const int lastKept = files.versions().back();
            EXPECT_TRUE(lastKept == number || (lastKept == kept && now == number)) << "call " << call;

            number += 2;
            EXPECT_TRUE(files.save(number)) << "call " << call;
            EXPECT_EQ(files.temporaryFiles(), 0) << "call " << call;
            const std::vector<int> versions = files.versions();
            EXPECT_TRUE(std::ranges::is_sorted(versions) && versions.front() >= 0) << "call " << call;
            EXPECT_TRUE(isCopied || std::ranges::adjacent_find(versions) == versions.end())
                << "call " << call << ": the link of a killed save stays";
            EXPECT_LE(versions.size(), KeptVersions::kVersions) << "call " << call;
            EXPECT_EQ(versions.back(), now) << "call " << call;
            kept = now;
        }
        EXPECT_TRUE(WIFEXITED(status) && WEXITSTATUS(status) == 0);
        EXPECT_GT(found[0], 20);
        EXPECT_GT(found[1], 3);
    }
}
