#include "storage/AtomicFile.h"
#include "tests/support/ToolRun.h"

#include <gtest/gtest.h>

namespace {

namespace fs = std::filesystem;
using enum AtomicFile::Existing;

class AtomicFileTest : public testing::Test {
protected:
    auto files() const { return std::distance(fs::directory_iterator(folder_.path), fs::directory_iterator()); }

    TemporaryFolder folder_{"AtomicFileTest"};
};

} // namespace

TEST_F(AtomicFileTest, IsWholeOrNotThere)
{
    {
        AtomicFile abandoned(folder_ / "new", kKeep);
    }
    EXPECT_EQ(files(), 0);
    AtomicFile late(folder_ / "late", kKeep);
    folder_.write("late", "somebody else's");
    EXPECT_THROW(late.commit(), AtomicFile::WriteError);
    EXPECT_THROW(AtomicFile(folder_ / "late", kKeep), AtomicFile::OpenError);
    EXPECT_EQ(folder_.content("late"), "somebody else's");
}

TEST_F(AtomicFileTest, RemovesWhatAKilledProgramLeftButNotWhatALivingOneWrites)
{
    folder_.write(".pelorin-4194999-0.tmp", "half", 0200);
    const char* const others[] = {"pelorin.tmp",        ".pelorin-.tmp",    ".pelorin-notes.tmp",
                                  ".pelorin-12-0x.tmp", ".pelorin-12-.tmp", ".pelorin-12-0.tmp.tmp"};
    for (const char* name : others)
        folder_.write(name, "the user's");
    AtomicFile slow(folder_ / "slow", kReplace);
    AtomicFile(folder_ / "quick", kReplace).commit();
    slow.commit();
    EXPECT_TRUE(fs::exists(folder_ / "slow") && fs::exists(folder_ / "quick"));
    for (const char* name : others)
        EXPECT_TRUE(fs::exists(folder_ / name)) << name;
    EXPECT_EQ(files(), 2 + std::ssize(others));
}
