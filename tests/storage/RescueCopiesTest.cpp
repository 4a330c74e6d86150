#include "storage/RescueCopies.h"
#include "tests/support/ToolRun.h"

#include <array>
#include <csignal>
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <set>

namespace {

namespace fs = std::filesystem;
using enum RescueNote::Kind;

FileWriter writing(const std::string& content)
{
    return [content](FILE* file) { return std::fputs(content.c_str(), file) < 0 ? -1 : 0; };
}

class RescueCopiesTest : public testing::Test {
protected:
    /// The files below "Unsaved", with the names of the copies cut off before their time.
    std::string files() const
    {
        std::set<std::string> names;
        for (const auto& entry : fs::recursive_directory_iterator(unsaved_))
            if (entry.is_regular_file()) {
                const std::string name = fs::relative(entry.path(), unsaved_);
                names.insert(name.substr(0, name.find('/') + 1) +
                             name.substr(name.find_first_of(".(", name.size() - 5)));
            }
        std::string all;
        for (const std::string& name : names)
            all += name + ' ';
        return all;
    }
    std::vector<std::shared_ptr<RescueCopies>> take() const { return RescueCopies::takeLeftBehind(data_); }
    /// What `take` finds, as the contents of the copies.
    std::string taken() const
    {
        std::string all;
        for (const auto& copies : take())
            for (const auto kind : {kMarkets, kPortfolio})
                all += copies->note().parts[kind].isCopied() ? contentOf(copies->copyOf(kind)) + ' ' : "- ";
        return all;
    }

    const TemporaryFolder folder_{"RescueCopiesTest"};
    const DataFolder data_{folder_ / "Pelorin"};
    const std::string unsaved_ = folder_ / "Pelorin/Backups/Unsaved";
};

} // namespace

TEST_F(RescueCopiesTest, AGenerationTakesThePlaceOfTheOneBeforeAndHasWhatIsUnsaved)
{
    auto copies = std::make_shared<RescueCopies>(data_);
    const struct {
        const char* why;
        RescueCopies::Sources sources;
        const char* files;
        const char* taken;
    } cases[] = {
        {"nothing yet", {}, ".lock ", ""},
        {"both",
         {{{"m", false, writing("M1"), false}, {"p", false, writing("P1"), false}}},
         ".lock .note Companies/(1) PortoFolios/(1) ",
         "M1 P1 "},
        {"both anew",
         {{{"m", false, writing("M2"), false}, {"p", false, writing("P2"), false}}},
         ".lock .note Companies/(2) PortoFolios/(2) ",
         "M2 P2 "},
        {"the portfolio was saved",
         {{{"m", false, nullptr, true}, {"p", false, nullptr, false}}},
         ".lock .note Companies/(2) ",
         "M2 - "},
        {"the market data stays, and never has been the portfolio's",
         {{{"m", false, nullptr, true}, {"p", false, nullptr, true}}},
         ".lock .note Companies/(2) ",
         "M2 - "},
        {"the portfolio changes again",
         {{{"m", false, nullptr, true}, {"p", false, writing("P3"), false}}},
         ".lock .note Companies/(2) PortoFolios/(3) ",
         "M2 P3 "},
        {"all is saved", {}, ".lock ", ""},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.why);
        copies->write(c.sources);
        EXPECT_EQ(files(), c.files);
        EXPECT_EQ(taken(), "") << "its program lives";
        copies.reset();
        EXPECT_EQ(taken(), c.taken);
        const auto found = take(); // who takes them over goes on with them
        EXPECT_EQ(taken(), "") << "only one can";
        copies = found.empty() ? std::make_shared<RescueCopies>(data_) : found.front();
    }
    copies.reset();
    EXPECT_EQ(files(), "");
}

TEST_F(RescueCopiesTest, TheNoteSaysWhatBelongsTogether)
{
    RescueCopies copies(data_);
    copies.write({{{"/a b\n\xC3\xA9", true, writing("abc"), false}, {"", false, nullptr, false}}}, 1800000000);
    const std::string expected = "Pelorin unsaved 1\n"
                                 "1800000000\n"
                                 "1 3 e71fa2190541574b 1 7 /a b\n\xC3\xA9\n"
                                 "0 0 0 0 0 \n";
    std::string note;
    for (const auto& entry : fs::directory_iterator(unsaved_))
        if (entry.path().extension() == ".note")
            note = contentOf(entry.path());
    EXPECT_EQ(note.substr(0, expected.size()), expected);
    const auto read = RescueNote::read(note);
    ASSERT_TRUE(read.has_value());
    EXPECT_EQ(read->text(), note);
    EXPECT_EQ(read->parts[kMarkets].path, "/a b\n\xC3\xA9");
}

TEST_F(RescueCopiesTest, WhatIsDamagedIsNotOfferedAndStays)
{
    const auto leave = [this] {
        RescueCopies copies(data_);
        copies.write({{{"m", false, writing("markets"), false}, {"p", false, writing("portfolio"), false}}});
        return std::vector<std::string>{copies.copyOf(kMarkets), copies.copyOf(kPortfolio)};
    };
    std::vector<std::string> paths = leave();
    for (const auto& entry : fs::directory_iterator(unsaved_))
        if (entry.path().extension() == ".note")
            paths.push_back(entry.path());
    ASSERT_EQ(paths.size(), 3U);
    ASSERT_EQ(taken(), "markets portfolio ");
    for (const std::string& path : paths) {
        const std::string whole = contentOf(path);
        const auto expectRefused = [&](const std::string& content) {
            std::ofstream(path, std::ios::binary) << content;
            EXPECT_EQ(taken(), "") << path << ":\n" << content;
            EXPECT_EQ(contentOf(path), content);
        };
        for (std::size_t i = 0; i < whole.size(); ++i) {
            expectRefused(whole.substr(0, i));
            std::string changed = whole;
            changed[i] = static_cast<char>(changed[i] ^ 1);
            expectRefused(changed);
        }
        expectRefused(whole + ' ');
        fs::remove(path);
        if (path != paths.back()) {
            EXPECT_EQ(taken(), "") << path << " is missing";
        }
        std::ofstream(path, std::ios::binary) << whole;
        EXPECT_EQ(taken(), "markets portfolio ") << "whole again";
    }
}

TEST_F(RescueCopiesTest, AFailedWriteLeavesTheLastGeneration)
{
    const auto fail = [](FILE* file) { return std::fputs("half", file) < 0 ? 0 : -1; };
    auto copies = std::make_unique<RescueCopies>(data_);
    copies->write({{{"m", false, writing("M1"), false}, {"p", false, writing("P1"), false}}});
    EXPECT_THROW(copies->write({{{"m", false, writing("M2"), false}, {"p", false, fail, false}}}), std::runtime_error);
    copies.reset();
    EXPECT_EQ(taken(), "M1 P1 ");
}

TEST_F(RescueCopiesTest, OfManyStartsAtOnceOneTakesThemOver)
{
    constexpr int kRounds = 20, kStarts = 4;
    for (int round = 0; round < kRounds; ++round) {
        const pid_t killed = fork();
        if (killed == 0) {
            RescueCopies copies(data_);
            copies.write({{{"m", false, writing("M"), false}, {}}});
            raise(SIGKILL);
        }
        int status;
        waitpid(killed, &status, 0);
        int start[2];
        ASSERT_EQ(pipe(start), 0);
        std::array<pid_t, kStarts> children{};
        for (pid_t& child : children)
            if ((child = fork()) == 0) {
                close(start[1]);
                char none;
                (void)!read(start[0], &none, 1);
                const auto found = take();
                for (const auto& copies : found)
                    copies->remove();
                _exit(static_cast<int>(found.size()));
            }
        for (const int descriptor : start)
            close(descriptor);
        int taken = 0;
        for (const pid_t child : children) {
            waitpid(child, &status, 0);
            taken += WEXITSTATUS(status);
        }
        EXPECT_EQ(taken, 1);
        take();
        EXPECT_EQ(files(), "") << "locks are cleared away";
    }
}
