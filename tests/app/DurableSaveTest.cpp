#include "app/DurableSave.h"
#include "tests/support/PlainUser.h"
#include "tests/support/ToolRun.h"

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

int writeNothing(FILE*)
{
    return 0;
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
    std::string path(const std::string& name) const { return folder_.path / name; }
    std::string content(const std::string& name) const { return contentOf(path(name)); }
    void file(const std::string& name, int mode = 0644) const
    {
        std::ofstream(path(name), std::ios::binary) << "old";
        fs::permissions(path(name), fs::perms(mode));
    }
    /// The names in the folder, with the number of versions of `name` behind it.
    std::string names(const std::string& name) const
    {
        std::string all;
        for (const auto& entry : fs::directory_iterator(folder_.path / "files"))
            all += entry.path().filename().string() + ' ';
        return all + std::to_string(KeptVersions(data_).versionsOf(path("files/" + name)).size());
    }

    TemporaryFolder folder_{"DurableSaveTest"};
    PlainUser user_{folder_.path};
    DataFolder data_{folder_.path / "Pelorin"};
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
        {"an empty one", 0644, writeNothing, kSaved, "", "f 1"},
        {"a file not to be read", 0200, writeNew, kSaved, "new", "f 1"},
        {"a file not to be written", 0444, writeNew, kOpenFailed, "old", "f 0"},
        {"a record that fails", 0644, writeHalf, kWriteFailed, "old", "f 0"},
        {"a record of a new file that fails", -1, writeHalf, kWriteFailed, "", "0"},
    };
    for (const auto& c : cases) {
        fs::create_directory(path("files"));
        if (c.mode >= 0)
            file("files/f", c.mode);
        const DurableSave::Result result = save_.save(path("files/f"), c.write);
        EXPECT_EQ(result.outcome, c.outcome) << c.why << ": " << result.reason;
        EXPECT_EQ(result.reason.empty(), c.outcome == kSaved) << c.why;
        EXPECT_EQ(names("f"), c.names) << c.why;
        if (c.mode >= 0) {
            EXPECT_EQ(fs::status(path("files/f")).permissions(), fs::perms(c.mode)) << c.why;
            fs::permissions(path("files/f"), fs::perms(0600));
        }
        EXPECT_EQ(content("files/f"), c.content) << c.why;
        fs::remove_all(path("files"));
        fs::remove_all(data_.path());
    }
}

TEST_F(DurableSaveTest, DealsWithWhateverThePathLeadsTo)
{
    fs::create_directory(path("folder"));
    fs::create_directory(path("locked"));
    file("locked/f");
    fs::permissions(path("locked"), fs::perms(0555));
    fs::create_symlink("made", path("dangling"));
    fs::create_symlink("missing/made", path("lost"));
    const struct {
        std::string path;
        DurableSave::Outcome outcome;
    } cases[] = {
        {path("folder"), kOpenFailed},
        {path("folder/"), kOpenFailed},
        {path("missing/f"), kOpenFailed},
        {path("locked/f"), kOpenFailed},
        {path("locked/new"), kOpenFailed},
        {path("lost"), kOpenFailed},
        {path("dangling"), kSaved},
        {"/dev/full", kWriteFailed},
        {"/dev/null", kSaved},
        {"", kOpenFailed},
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
    EXPECT_TRUE(fs::is_symlink(path("dangling")));
    EXPECT_EQ(content("made"), "new");
    EXPECT_EQ(content("locked/f"), "old");
    EXPECT_EQ(save_.save(path("locked/a\nb"), writeNew).reason.find('\n'), std::string::npos) << "one line";
    fs::permissions(path("locked"), fs::perms(0755)); // to be removed in the end
}

TEST_F(DurableSaveTest, AFullDiskLeavesTheOldFile)
{
    fs::create_directory(path("files"));
    file("files/f");
    rlimit former;
    getrlimit(RLIMIT_FSIZE, &former);
    const rlimit little{1 << 16, former.rlim_max};
    setrlimit(RLIMIT_FSIZE, &little);
    const DurableSave::Result result = save_.save(path("files/f"), writeMuch);
    setrlimit(RLIMIT_FSIZE, &former);
    EXPECT_EQ(result.outcome, kWriteFailed);
    EXPECT_EQ(result.reason, path("files/f") + ": cannot be written: File too large");
    EXPECT_EQ(content("files/f"), "old");
    EXPECT_EQ(names("f"), "f 0");
}

TEST_F(DurableSaveTest, WithoutAVersionTheOldFileStays)
{
    file("f");
    fs::create_directory(data_.path());
    file("Pelorin/Backups"); // no folder can have that name now
    const DurableSave::Result result = save_.save(path("f"), writeNew);
    EXPECT_EQ(result.outcome, kWriteFailed);
    EXPECT_EQ(result.reason, path("f") + ": its former version cannot be kept: " + path("Pelorin/Backups") +
                                 ": cannot be made: Not a directory");
    EXPECT_EQ(content("f"), "old");
    EXPECT_EQ(save_.save(path("new"), writeNew).outcome, kSaved) << "there is nothing to keep";
}
