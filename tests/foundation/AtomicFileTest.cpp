#include "foundation/AtomicFile.h"
#include "tests/support/PlainUser.h"
#include "tests/support/ToolRun.h"

#include <gtest/gtest.h>

namespace {

namespace fs = std::filesystem;
using enum AtomicFile::Existing;

class AtomicFileTest : public testing::Test {
protected:
    std::string path(const std::string& name) const { return folder_.path / name; }
    std::string content(const std::string& name) const { return contentOf(path(name)); }
    std::string file(const std::string& name, const std::string& content) const
    {
        std::ofstream(path(name), std::ios::binary) << content;
        return path(name);
    }
    auto files() const { return std::distance(fs::directory_iterator(folder_.path), fs::directory_iterator()); }

    TemporaryFolder folder_{"AtomicFileTest"};
};

} // namespace

TEST_F(AtomicFileTest, IsWholeOrNotThere)
{
    {
        AtomicFile abandoned(path("new"), kKeep);
    }
    EXPECT_EQ(files(), 0);
    AtomicFile late(path("late"), kKeep);
    file("late", "somebody else's");
    EXPECT_THROW(late.commit(), AtomicFile::WriteError);
    EXPECT_EQ(content("late"), "somebody else's");
}

TEST_F(AtomicFileTest, ReplacesWhatALinkLeadsToAndKeepsItsPermissions)
{
    fs::create_directory(path("folder"));
    file("folder/old", "old");
    fs::permissions(path("folder/old"), fs::perms(0640));
    fs::create_symlink("old", path("folder/link"));
    fs::create_symlink("folder/link", path("link"));
    fs::create_symlink("folder/made", path("dangling"));

    AtomicFile replacing(path("link"), kReplace);
    std::fputs("new", replacing.stream());
    EXPECT_EQ(content("link"), "old") << "before the commit";
    replacing.commit();
    EXPECT_EQ(content("folder/old"), "new");
    EXPECT_TRUE(fs::is_symlink(path("link")) && fs::is_symlink(path("folder/link")));
    EXPECT_EQ(fs::status(path("folder/old")).permissions(), fs::perms(0640));

    AtomicFile(path("dangling"), kReplace).commit();
    EXPECT_TRUE(fs::is_symlink(path("dangling")));
    EXPECT_TRUE(fs::is_empty(path("folder/made")));
}

TEST_F(AtomicFileTest, RefusesInTimeWhatItCouldNotWriteInTheEnd)
{
    const PlainUser user(folder_.path);
    fs::permissions(file("protected", "old"), fs::perms(0444));
    file("file", "old");
    fs::create_symlink("ring", path("ring"));
    fs::create_directory(path("locked"));
    fs::permissions(path("locked"), fs::perms(0555));
    const struct {
        std::string path;
        AtomicFile::Existing existing;
        const char* why;
    } cases[] = {
        {path("file"), kKeep, "is there and to be kept"},
        {path("protected"), kReplace, "may be read only"},
        {path(""), kReplace, "a folder"},
        {path("locked/new"), kReplace, "in a folder that may be read only"},
        {path("missing/new"), kReplace, "in no folder"},
        {path("file/new"), kReplace, "in a file"},
        {path("ring"), kReplace, "a link to itself"},
        {path(std::string(300, 'x')), kReplace, "too long a name"},
        {"", kReplace, "no name"},
        {"/dev/full", kReplace, "a device"},
    };
    for (const auto& c : cases)
        EXPECT_THROW(AtomicFile(c.path, c.existing), AtomicFile::OpenError) << c.why;
    EXPECT_EQ(files(), 4) << "temporary files";
    fs::permissions(path("locked"), fs::perms(0755)); // to be removed in the end
}

TEST_F(AtomicFileTest, RemovesWhatAKilledProgramLeftButNotWhatALivingOneWrites)
{
    file(".pelorin-4194999-0.tmp", "half");
    fs::permissions(path(".pelorin-4194999-0.tmp"), fs::perms(0200));
    file("pelorin.tmp", "the user's");
    AtomicFile slow(path("slow"), kReplace);
    AtomicFile(path("quick"), kReplace).commit();
    slow.commit();
    EXPECT_TRUE(fs::exists(path("slow")) && fs::exists(path("quick")) && fs::exists(path("pelorin.tmp")));
    EXPECT_EQ(files(), 3);
}
