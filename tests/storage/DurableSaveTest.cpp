#include "storage/DurableSave.h"
#include "tests/support/PlainUser.h"
#include "tests/support/ToolRun.h"

#include <fcntl.h>
#include <gtest/gtest.h>
#include <ostream>
#include <set>
#include <sys/file.h>
#include <sys/resource.h>

namespace {

namespace fs = std::filesystem;
using enum DurableSave::Outcome;

int writeNew(FILE* file)
{
    return std::fputs("new", file) < 0 ? -1 : 0;
}

int writeHalf(FILE* file)
{
    std::fputs("ne", file);
    return -1;
}

/// More than fits into the stream's buffer, and than the test lets a file have.
int writeMuch(FILE* file)
{
    const std::string much(1 << 20, 'x');
    return std::fwrite(much.data(), 1, much.size(), file) == much.size() ? 0 : -1;
}

/// Starts a program that saves `content` as soon as `start` is closed. @return its number; it exits with the outcome.
pid_t startSave(const DataFolder& data, const std::string& path, const std::string& content, const int (&start)[2])
{
    const pid_t child = fork();
    if (child != 0)
        return child;
    close(start[1]);
    char none;
    (void)!read(start[0], &none, 1);
    const auto write = [&content](FILE* file) { return std::fputs(content.c_str(), file) < 0 ? -1 : 0; };
    _exit(static_cast<int>(DurableSave(data).save(path, write).outcome));
}

class DurableSaveTest : public testing::Test {
protected:
    /// The names in the folder, with the number of versions of `name` behind it.
    std::string names(const std::string& name) const
    {
        std::string all;
        for (const auto& entry : fs::directory_iterator(folder_ / "files"))
            all += entry.path().filename().string() + ' ';
        return all + std::to_string(KeptVersions(data_).versionsOf(folder_ / ("files/" + name)).size());
    }

    /// What is in `path` and among the versions of either data folder.
    std::set<std::string> contents(const std::string& path) const
    {
        std::set<std::string> all{contentOf(path)};
        for (const char* data : {"Pelorin", "Other"})
            for (const auto& entry : fs::recursive_directory_iterator(folder_ / data))
                if (entry.is_regular_file())
                    all.insert(contentOf(entry.path()));
        return all;
    }

    TemporaryFolder folder_{"DurableSaveTest"};
    PlainUser user_{folder_.path};
    DataFolder data_{folder_ / "Pelorin"};
    DurableSave save_{data_};
};

} // namespace

TEST_F(DurableSaveTest, GivesTheOldFileOrTheNewOneAndSaysWhich)
{
    const struct {
        const char* why;
        int mode; // of the file that is there; -1 for none
        DurableSave::Writer write;
        DurableSave::Outcome outcome;
        const char* content;
        const char* names;
    } cases[] = {
        {"a new name", -1, writeNew, kSaved, "new", "f 0"},
        {"an old file", 0640, writeNew, kSaved, "new", "f 1"},
        {"a file not to be read", 0200, writeNew, kSaved, "new", "f 1"},
        {"a file not to be written", 0444, writeNew, kOpenFailed, "old", "f 0"},
        {"a record that fails", 0644, writeHalf, kWriteFailed, "old", "f 0"},
        {"a record of a new file that fails", -1, writeHalf, kWriteFailed, "", "0"},
    };
    for (const auto& c : cases) {
        fs::create_directory(folder_ / "files");
        if (c.mode >= 0)
            folder_.write("files/f", "old", c.mode);
        const DurableSave::Result result = save_.save(folder_ / "files/f", c.write);
        EXPECT_EQ(result.outcome, c.outcome) << c.why << ": " << result.reason;
        EXPECT_EQ(result.reason.empty(), c.outcome == kSaved) << c.why;
        EXPECT_EQ(names("f"), c.names) << c.why;
        if (c.mode >= 0) {
            EXPECT_EQ(fs::status(folder_ / "files/f").permissions(), fs::perms(c.mode)) << c.why;
            fs::permissions(folder_ / "files/f", fs::perms(0600));
        }
        EXPECT_EQ(folder_.content("files/f"), c.content) << c.why;
        fs::remove_all(folder_ / "files");
        fs::remove_all(data_.path());
    }
}

TEST_F(DurableSaveTest, AFileThatIsNoLongerTheFormerOneStays)
{
    const std::string path = folder_.write("files/f", "old");
    const auto former = FileStamp::of(path);
    EXPECT_EQ(save_.save(path, writeNew, former).outcome, kSaved);
    const auto empty = [](FILE*) { return 0; };
    EXPECT_EQ(save_.save(path, empty, former).outcome, kWriteFailed) << "it is the new one by now";
    EXPECT_EQ(folder_.content("files/f"), "new");
    EXPECT_EQ(names("f"), "f 1");
}

TEST_F(DurableSaveTest, DealsWithWhateverThePathLeadsTo)
{
    folder_.write("folder/file", "old");
    folder_.write("locked/f", "old");
    fs::permissions(folder_ / "locked", fs::perms(0555));
    fs::create_symlink("ring", folder_ / "ring");
    fs::create_symlink("made", folder_ / "dangling");
    fs::create_symlink("dangling", folder_ / "chain");
    fs::create_symlink("missing/made", folder_ / "lost");
    const struct {
        std::string path;
        DurableSave::Outcome outcome;
    } cases[] = {
        {folder_ / "folder", kOpenFailed},
        {folder_ / "missing/f", kOpenFailed},
        {folder_ / "ring", kOpenFailed},
        {folder_ / std::string(300, 'x'), kOpenFailed},
        {folder_ / "locked/f", kOpenFailed},
        {folder_ / "locked/new", kOpenFailed},
        {folder_ / "lost", kOpenFailed},
        {folder_ / "dangling", kSaved},
        {folder_ / "chain", kSaved},
        {"/dev/full", kWriteFailed},
        {"/dev/null", kSaved},
    };
    for (const auto& c : cases) {
        bool isCalled = false;
        const DurableSave::Result result = save_.save(c.path, [&isCalled](FILE* file) {
            isCalled = true;
            return writeNew(file);
        });
        EXPECT_EQ(result.outcome, c.outcome) << c.path << ' ' << result.reason;
        EXPECT_EQ(isCalled, c.outcome != kOpenFailed) << c.path;
        EXPECT_EQ(result.reason.starts_with(c.path + ": "), c.outcome != kSaved) << result.reason;
    }
    EXPECT_TRUE(fs::is_symlink(folder_ / "dangling") && fs::is_symlink(folder_ / "chain"));
    EXPECT_EQ(folder_.content("made"), "new");
    EXPECT_EQ(folder_.content("locked/f"), "old");
    EXPECT_EQ(save_.save(folder_ / "locked/a\nb", writeNew).reason.find('\n'), std::string::npos) << "one line";
    fs::permissions(folder_ / "locked", fs::perms(0755)); // to be removed in the end
}

TEST_F(DurableSaveTest, AFullDiskLeavesTheOldFile)
{
    folder_.write("files/f", "old");
    rlimit former;
    getrlimit(RLIMIT_FSIZE, &former);
    const rlimit little{1 << 16, former.rlim_max};
    setrlimit(RLIMIT_FSIZE, &little);
    const DurableSave::Result result = save_.save(folder_ / "files/f", writeMuch);
    setrlimit(RLIMIT_FSIZE, &former);
    EXPECT_EQ(result.outcome, kWriteFailed);
    EXPECT_EQ(result.reason, folder_ / "files/f" + ": cannot be written: File too large");
    EXPECT_EQ(folder_.content("files/f"), "old");
    EXPECT_EQ(names("f"), "f 0");
}

TEST_F(DurableSaveTest, WithoutAVersionTheOldFileStays)
{
    folder_.write("f", "old");
    folder_.write("Pelorin/Backups", "old"); // no folder can have that name now
    const DurableSave::Result result = save_.save(folder_ / "f", writeNew);
    EXPECT_EQ(result.outcome, kWriteFailed);
    EXPECT_EQ(result.reason, folder_ / "f" + ": its former version cannot be kept: " + folder_ / "Pelorin/Backups" +
                                 ": cannot be made: Not a directory");
    EXPECT_EQ(folder_.content("f"), "old");
    EXPECT_EQ(save_.save(folder_ / "new", writeNew).outcome, kSaved) << "there is nothing to keep";
}

TEST_F(DurableSaveTest, OfProgramsThatSaveAtOnceNoneLosesWhatAnotherHasSaved)
{
    const char* const text = std::getenv("PELORIN_SAVE_ROUNDS");
    const int rounds = text != nullptr ? std::atoi(text) : 20;
    const struct {
        const char* why;
        const char* secondData;
        int mode; // of the folder
    } cases[] = {
        {"a user with three windows", "Pelorin", 0755},
        {"users who share a folder", "Other", 0755},
        {"a folder that cannot be read, so cannot be locked", "Pelorin", 0333},
    };
    for (const auto& c : cases) {
        int lost = 0, refused = 0;
        for (int round = 0; round < rounds; ++round) {
            const std::string file = folder_ / "files/f", link = folder_ / "link";
            for (const char* data : {"Pelorin", "Other"})
                fs::create_directory(folder_ / data);
            fs::create_directory(folder_ / "files");
            fs::create_symlink("files/f", link);
            if (round % 2 == 0)
                folder_.write("files/f", "old");
            fs::permissions(folder_ / "files", fs::perms(c.mode));

            int start[2];
            ASSERT_EQ(pipe(start), 0);
            const pid_t programs[] = {startSave(data_, file, "0", start),
                                      startSave(DataFolder(folder_ / c.secondData), file, "1", start),
                                      startSave(data_, link, "2", start)};
            close(start[0]);
            close(start[1]);
            std::set<std::string> told;
            if (round % 2 == 0)
                told.insert("old");
            for (std::size_t i = 0; i < std::size(programs); ++i) {
                int status = -1;
                waitpid(programs[i], &status, 0);
                if (status == 0)
                    told.insert(std::to_string(i));
                else
                    ++refused;
            }
            const std::set<std::string> found = contents(file);
            for (const std::string& content : told)
                lost += found.count(content) == 0;
            fs::permissions(folder_ / "files", fs::perms(0755));
            for (const char* name : {"files", "link", "Pelorin", "Other"})
                fs::remove_all(folder_ / name);
        }
        EXPECT_EQ(lost, 0) << c.why;
        EXPECT_EQ(refused, 0) << c.why;
    }
}

TEST_F(DurableSaveTest, AProgramThatStopsWithinItsSaveHoldsUpOthersOnlyForATime)
{
    folder_.write("files/f", "old");
    const int folder = open((folder_ / "files").c_str(), O_RDONLY | O_DIRECTORY);
    ASSERT_EQ(flock(folder, LOCK_EX), 0);
    const DurableSave::Result result =
        DurableSave(data_, std::chrono::milliseconds(50)).save(folder_ / "files/f", writeNew);
    EXPECT_EQ(result.outcome, kWriteFailed);
    EXPECT_EQ(result.reason, folder_ / "files/f" + ": cannot be written: another program is saving in its folder and "
                                                   "does not come to an end");
    EXPECT_EQ(folder_.content("files/f") + ' ' + names("f"), "old f 0");
    close(folder);
    EXPECT_EQ(save_.save(folder_ / "files/f", writeNew).outcome, kSaved);
}

TEST_F(DurableSaveTest, ATerminalThatIsStoppedFailsTheSaveInsteadOfHoldingItUp)
{
    const int controller = posix_openpt(O_RDWR | O_NOCTTY);
    ASSERT_EQ(unlockpt(controller), 0);
    alarm(20); // ends a save that waits until the terminal is read
    EXPECT_EQ(save_.save(ptsname(controller), writeMuch).outcome, kWriteFailed);
    alarm(0);
    close(controller);
}
