#include "app/DurableSave.h"
#include "tests/support/PlainUser.h"
#include "tests/support/ToolRun.h"

#include <fcntl.h>
#include <gtest/gtest.h>
#include <ostream>
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

TEST_F(DurableSaveTest, DealsWithWhateverThePathLeadsTo)
{
    folder_.write("folder/file", "old");
    folder_.write("locked/f", "old");
    fs::permissions(folder_ / "locked", fs::perms(0555));
    fs::create_symlink("ring", folder_ / "ring");
    fs::create_symlink("made", folder_ / "dangling");
    fs::create_symlink("missing/made", folder_ / "lost");
    const struct {
        std::string path;
        DurableSave::Outcome outcome;
    } cases[] = {
        {folder_ / "folder", kOpenFailed},   {folder_ / "missing/f", kOpenFailed},
        {folder_ / "ring", kOpenFailed},     {folder_ / std::string(300, 'x'), kOpenFailed},
        {folder_ / "locked/f", kOpenFailed}, {folder_ / "locked/new", kOpenFailed},
        {folder_ / "lost", kOpenFailed},     {folder_ / "dangling", kSaved},
        {"/dev/full", kWriteFailed},         {"/dev/null", kSaved},
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
    EXPECT_TRUE(fs::is_symlink(folder_ / "dangling"));
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

TEST_F(DurableSaveTest, ATerminalThatIsStoppedFailsTheSaveInsteadOfHoldingItUp)
{
    const int controller = posix_openpt(O_RDWR | O_NOCTTY);
    ASSERT_EQ(unlockpt(controller), 0);
    alarm(20); // ends a save that waits until the terminal is read
    EXPECT_EQ(save_.save(ptsname(controller), writeMuch).outcome, kWriteFailed);
    alarm(0);
    close(controller);
}
