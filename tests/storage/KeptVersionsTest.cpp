#include "storage/KeptVersions.h"
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
    /// The contents of the versions, in the order of the saves.
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

TEST_F(KeptVersionsTest, AVersionIsNamedAfterFileTimeAndNumber)
{
    const std::string outside = "/Elsewhere" + folder_.path.string();
    const struct {
        std::string file, version;
    } cases[] = {
        {"Pelorin/Companies/Sample", "/Companies/Sample 2026-11-21 10.53.04 (1)"},
        {"Pelorin/PortoFolios/Sample", "/PortoFolios/Sample 2026-11-21 10.53.04 (1)"},
        {"Pelorin/PortoFolios/a/Sample", "/PortoFolios/a/Sample 2026-11-21 10.53.04 (1)"},
        {"Pelorin/Sample", outside + "/Pelorin/Sample 2026-11-21 10.53.04 (1)"},
        {"Companies/Sample", outside + "/Companies/Sample 2026-11-21 10.53.04 (1)"},
        {"odd/%s \n*\xFF", outside + "/odd/%s \n*\xFF 2026-11-21 10.53.04 (1)"},
        {"Pelorin/Companies/Sample 2026-11-21 10.53.04 (1)",
         "/Companies/Sample 2026-11-21 10.53.04 (1) 2026-11-21 10.53.04 (1)"},
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

TEST_F(KeptVersionsTest, TheLastTwentyStayHoweverQuicklyTheyComeAndWhateverTheClockDoes)
{
    constexpr std::time_t kHour = 3600, kYear = 31557600;
    const std::time_t clocks[] = {0,     -kHour,        9 * kYear, -30 * kYear,  9000 * kYear,
                                  kHour, -3000 * kYear, 0,         -1500 * kYear};
    folder_.write("Sample", "0");
    folder_.write("Sample 2026-11-21 10.53.04 (1)", "other");
    const std::string other = versions_.keep(path("Sample 2026-11-21 10.53.04 (1)"), kNow);
    const std::string note = fs::path(other).parent_path() / "Sample 2026-11-21 note";
    std::ofstream(note) << "the user's";
    std::string expected;
    for (int i = 0; i < 230; ++i) { // the first ones within a second
        save("Sample", std::to_string(i + 1), kNow + (i < 125 ? 0 : clocks[i % std::size(clocks)]));
        expected += std::to_string(i) + ' ';
        if (i >= 20)
            expected.erase(0, expected.find(' ') + 1);
        EXPECT_EQ(contents("Sample"), expected) << i;
    }
    EXPECT_TRUE(fs::exists(other) && fs::exists(note));
}

TEST_F(KeptVersionsTest, NamesOfTheFirstReleaseGoFirstAndByTheirTime)
{
    folder_.write("Pelorin/Companies/Sample", "now");
    const char* const names[] = {"-5-01-01 00.00.00",       "905-01-01 00.00.00",      "2026-11-21 10.53.04",
                                 "2026-11-21 10.53.04-002", "2026-11-21 10.53.04-011", "2026-11-21 10.53.04-1000",
                                 "12026-01-01 00.00.00"};
    for (const char* name : names)
        folder_.write(std::string("Pelorin/Backups/Companies/Sample ") + name, name);
    std::string expected;
    for (int i = 0; i < 18; ++i) {
        save("Pelorin/Companies/Sample", "now", kNow);
        expected += "now ";
    }
    EXPECT_EQ(contents("Pelorin/Companies/Sample"), names[5] + (' ' + (names[6] + (' ' + expected))));
    save("Pelorin/Companies/Sample", "now", kNow);
    EXPECT_EQ(contents("Pelorin/Companies/Sample"), names[6] + (' ' + expected) + "now ");
}

TEST_F(KeptVersionsTest, BehindTheHighestNumberTheTimeSettlesTheOrder)
{
    folder_.write("Pelorin/Companies/Sample", "0");
    folder_.write("Pelorin/Backups/Companies/Sample 2026-11-20 00.00.00 (999999999999999)", "made by hand");
    std::string expected;
    for (int i = 0; i < 25; ++i) {
        save("Pelorin/Companies/Sample", std::to_string(i + 1), kNow + i);
        if (i >= 5)
            expected += std::to_string(i) + ' ';
    }
    EXPECT_EQ(contents("Pelorin/Companies/Sample"), expected);
}
