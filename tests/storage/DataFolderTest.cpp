#include "storage/DataFolder.h"
#include "tests/support/PlainUser.h"
#include "tests/support/ToolRun.h"

#include <gtest/gtest.h>
#include <sys/stat.h>

namespace {

namespace fs = std::filesystem;

/// Gives the environment back what the test changes in it.
class DataFolderTest : public testing::Test {
protected:
    ~DataFolderTest() override
    {
        setenv("HOME", home_.c_str(), 1);
        unsetenv("XDG_CONFIG_HOME");
    }

    const std::string home_ = std::getenv("HOME");
    const TemporaryFolder folder_{"DataFolderTest"};
};

} // namespace

TEST_F(DataFolderTest, IsWhereTheDesktopKeepsDocuments)
{
    const std::string home = folder_.path / "home";
    setenv("HOME", home.c_str(), 1);
    const struct {
        const char* lines;
        std::string path;
        const char* why;
    } cases[] = {
        {"", home + "/Documents/Pelorin", "nothing said"},
        {"XDG_DOCUMENTS_DIR=\"$HOME/Texte\"\n", home + "/Texte/Pelorin", "below the home folder"},
        {" XDG_DOCUMENTS_DIR = \"/data/My \\\"Docs\\\"/\" # mine\n", "/data/My \"Docs\"/Pelorin", "anywhere else"},
        {"XDG_DOCUMENTS_DIR=\"$HOME/\"\n", home + "/Pelorin", "none of its own"},
        {"XDG_DOCUMENTS_DIR=\"/a\"\nXDG_DOCUMENTS_DIR=\"/b\"", "/b/Pelorin", "the last line counts"},
        {"# XDG_DOCUMENTS_DIR=\"/a\"\nXDG_MUSIC_DIR=\"/m\"\nXDG_DOCUMENTS_DIR=/b\n", home + "/Documents/Pelorin",
         "a comment, another folder, no quotation marks"},
        {"XDG_DOCUMENTS_DIR=\"Texte\"\n", home + "/Documents/Pelorin", "neither absolute nor below the home folder"},
    };
    for (const auto& c : cases)
        for (const bool isElsewhere : {false, true}) {
            const fs::path configuration = isElsewhere ? folder_.path / "config" : fs::path(home) / ".config";
            setenv("XDG_CONFIG_HOME", isElsewhere ? configuration.c_str() : "not/absolute", 1);
            fs::create_directories(configuration);
            std::ofstream(configuration / "user-dirs.dirs") << c.lines;
            EXPECT_EQ(DataFolder().path(), c.path) << c.why;
            fs::remove_all(configuration);
        }
    fs::create_directory(folder_.path / "config");
    ASSERT_EQ(mkfifo((folder_.path / "config/user-dirs.dirs").c_str(), 0600), 0);
    EXPECT_EQ(DataFolder().path(), home + "/Documents/Pelorin") << "a pipe is not waited for";
    unsetenv("HOME");
    EXPECT_EQ(DataFolder().path().front(), '/') << "the user's entry has a home folder, too";
}

TEST_F(DataFolderTest, MakesWhatIsNeededAndSaysWhyItCannot)
{
    const PlainUser user(folder_.path);
    const DataFolder data(folder_.path / "Documents/Pelorin");
    std::string error = "former";
    EXPECT_EQ(data.companies(&error), data.path() + "/Companies");
    EXPECT_EQ(data.companies(&error) + error, data.path() + "/Companies") << "there already";
    EXPECT_FALSE(fs::exists(data.path() + "/PortoFolios")) << "not needed yet";
    data.portoFolios(&error);
    EXPECT_TRUE(fs::is_directory(data.path() + "/PortoFolios"));
    data.backups(&error);
    EXPECT_EQ(error, "");
    EXPECT_EQ(fs::status(data.path() + "/Backups").permissions(), fs::perms::owner_all);

    std::ofstream(folder_.path / "file") << "old";
    fs::create_symlink("nowhere", folder_.path / "dangling");
    fs::create_directory(folder_.path / "locked");
    fs::permissions(folder_.path / "locked", fs::perms(0555));
    for (const char* place : {"file", "file/x", "dangling", "dangling/x", "locked/x"}) {
        const std::string path = folder_.path / place;
        EXPECT_EQ(DataFolder(path).companies(&error), path + "/Companies");
        EXPECT_TRUE(error.starts_with(path + "/Companies: cannot be made: ")) << error;
    }
    fs::permissions(folder_.path / "locked", fs::perms(0755)); // to be removed in the end
    DataFolder("").companies(&error);
    EXPECT_NE(error, "") << "no home folder";
}
