#include "app/KeptVersions.h"
#include "tests/support/ToolRun.h"

#include <gtest/gtest.h>

namespace {

namespace fs = std::filesystem;

constexpr std::time_t kNow = 1795258384; // 21/11/2026 10:53:04

class KeptVersionsTest : public testing::Test {
protected:
    KeptVersionsTest()
    {
        setenv("TZ", "UTC", 1);
        tzset();
    }
    std::string path(const std::string& name) const { return folder_ / name; }
    /// What a save of `content` does. @return the version.
    std::string save(const std::string& name, const std::string& content, std::time_t now) const
    {
        const std::string version = versions_.keep(path(name), now);
        fs::rename(folder_.write("temporary", content), path(name));
        versions_.prune(path(name), version);
        return version;
    }
    /// The contents of the versions, by time.
    std::string contents(const std::string& name) const
    {
        std::string all;
        for (const std::string& version : versions_.versionsOf(path(name)))
            all += contentOf(version) + ' ';
        return all;
    }

    TemporaryFolder folder_{"KeptVersionsTest"};
    KeptVersions versions_{DataFolder(folder_ / "Pelorin")};
};

} // namespace

TEST_F(KeptVersionsTest, AVersionIsNamedAfterFileAndTime)
{
    const std::string outside = "/Elsewhere" + folder_.path.string();
    const struct {
        std::string file, version;
    } cases[] = {
        {"Pelorin/Companies/Sample", "/Companies/Sample 2026-11-21 10.53.04"},
        {"Pelorin/PortoFolios/Sample", "/PortoFolios/Sample 2026-11-21 10.53.04"},
        {"Pelorin/PortoFolios/a/Sample", "/PortoFolios/a/Sample 2026-11-21 10.53.04"},
        {"Pelorin/Sample", outside + "/Pelorin/Sample 2026-11-21 10.53.04"},
        {"Companies/Sample", outside + "/Companies/Sample 2026-11-21 10.53.04"},
        {"odd/%s \n*\xFF", outside + "/odd/%s \n*\xFF 2026-11-21 10.53.04"},
        {"Pelorin/Companies/Sample 2026-11-21 10.53.04", "/Companies/Sample 2026-11-21 10.53.04 2026-11-21 10.53.04"},
    };
    for (const auto& c : cases)
        EXPECT_EQ(versions_.keep(folder_.write(c.file, c.file), kNow), path("Pelorin/Backups") + c.version);
    for (const auto& c : cases)
        EXPECT_EQ(contents(c.file), c.file + ' ') << "its own and nobody else's";
}

TEST_F(KeptVersionsTest, TheLongestNamesHaveVersionsOfTheirOwn)
{
    std::string euros;
    for (int i = 0; i < 84; ++i)
        euros += "\u20AC"; // three bytes each
    for (const std::string& name : {euros + "1", euros + "2", std::string(255, 'x'), std::string(110, 'x')}) {
        const std::string version = versions_.keep(folder_.write(name, name), kNow);
        EXPECT_EQ(contents(name), name + ' ');
        EXPECT_LT(fs::path(version).filename().string().size(), 143U);
        if (name.starts_with(euros.substr(0, 3))) {
            EXPECT_TRUE(version.find("\u20AC~") != std::string::npos) << "cut between characters: " << version;
        }
    }
}

TEST_F(KeptVersionsTest, TheLastTwentyStayHoweverQuicklyTheyCome)
{
    folder_.write("Sample", "0");
    folder_.write("Sample 2026-11-21 10.53.04", "other");
    const std::string other = versions_.keep(path("Sample 2026-11-21 10.53.04"), kNow);
    const std::string note = fs::path(other).parent_path() / "Sample 2026-11-21 note";
    std::ofstream(note) << "the user's";
    std::string expected;
    for (int i = 0; i < 130; ++i) {
        save("Sample", std::to_string(i + 1), kNow + i / 125);
        if (i >= 110)
            expected += std::to_string(i) + ' ';
    }
    EXPECT_EQ(contents("Sample"), expected);
    EXPECT_TRUE(fs::exists(other) && fs::exists(note));
}

TEST_F(KeptVersionsTest, AClockSetBackDoesNotCostTheNewVersions)
{
    folder_.write("Sample", "a");
    constexpr int kHour = 3600; // as every autumn
    for (int i = 0; i < 20; ++i)
        save("Sample", i < 19 ? "a" : "b", kNow + kHour + i);
    for (int i = 0; i < 3; ++i)
        save("Sample", "b", kNow + i);
    std::string expected = "b b b ";
    for (int i = 0; i < 17; ++i)
        expected += "a ";
    EXPECT_EQ(contents("Sample"), expected);
}
