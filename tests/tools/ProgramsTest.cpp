#include "tests/support/ServerRun.h"
#include "tests/support/ToolRun.h"

#include <csignal>
#include <fcntl.h>
#include <gmock/gmock.h>
#include <sys/stat.h>

using testing::HasSubstr;

TEST(ProgramsTest, FailureIsOneLineThatNamesTheReasonAndMakesNoFile)
{
    const TemporaryFolder folder("ProgramsTest");
    ASSERT_EQ(ToolRun(PELORIN_SAMPLE, "data --date 20/07/2025", folder).status, 0);
    std::filesystem::rename(folder / "data/Companies/Sample", folder / "market");
    std::filesystem::rename(folder / "data/PortoFolios/Sample", folder / "wallet");
    folder.write("short", folder.content("wallet").substr(0, 200));
    folder.write("file", "x");
    folder.write("bare", std::string(8, '\0'));
    folder.write("IBM.csv", "Date,Close\n2005-01-03,97.75\n");
    folder.write("r.csv", "2005-01-03,USD,1.25\n");
    std::filesystem::create_symlink("market", folder.path / "link");
    ASSERT_EQ(mkfifo((folder / "pipe").c_str(), 0600), 0);
    const pid_t writer = fork(); // waits until somebody opens the pipe for reading, and would lose what it writes
    if (writer == 0)
        _exit(open((folder / "pipe").c_str(), O_WRONLY));
    const ServerRun server(PELORIN_QUOTES, folder.path);
    const std::string taken = ". --port " + std::to_string(server.port());
    const struct {
        const char* program;
        std::string arguments;
        int status;
        const char* message;
    } cases[] = {
        {PELORIN_VALUE, "market wallet --date 31/02/1999", 2, "--date: is not a date DD/MM/YYYY: 31/02/1999"},
        {PELORIN_VALUE, "market", 2, "PORTFOLIO_FILE is required"},
        {PELORIN_VALUE, "market none --json", 1, "pelorin-value: none: cannot be opened: No such file or directory\n"},
        {PELORIN_VALUE, "market . --json", 1, "pelorin-value: .: is a folder\n"},
        {PELORIN_VALUE, "wallet wallet", 1, "pelorin-value: wallet: this is a portfolio file\n"},
        {PELORIN_VALUE, "market market", 1, "pelorin-value: market: this is a market file\n"},
        {PELORIN_VALUE, "market short", 1, "pelorin-value: short: the file ends in the middle of holding "},
        {PELORIN_VALUE, "market wallet >/dev/full", 1, "pelorin-value: standard output: No space left on device\n"},
        {PELORIN_VALUE, "pipe wallet", 1, "pelorin-value: pipe: is not an ordinary file\n"},
        {PELORIN_VALUE, "link pipe --json", 1, "pelorin-value: pipe: is not an ordinary file\n"},
        {PELORIN_VALUE, "--help", 0, ""},
        {PELORIN_QUOTES, taken, 1, ": cannot be listened on: "},
        {PELORIN_QUOTES, "none --port 0", 1, "none: No such"},
        {PELORIN_QUOTES, ". --bind localhost", 2, "--bind"},
        {PELORIN_QUOTES, "", 2, "Either FOLDER or --update"},
        {PELORIN_QUOTES, ". --update market --source finance-quote", 2, "FOLDER excludes --update"},
        {PELORIN_QUOTES, ". --source 'finance-quote:-e x'", 2, "--source: is no method of Finance::Quote: -e x"},
        {PELORIN_QUOTES, "--update none --source finance-quote", 1, "none: cannot be opened: No such file"},
        {PELORIN_QUOTES, "--update wallet --source finance-quote", 1, "wallet: this is a portfolio file\n"},
        {PELORIN_REPORT, "market wallet", 2, "--out is required"},
        {PELORIN_REPORT, "market wallet --out new --year MM", 2, "--year: is neither a year nor \"all\": MM"},
        {PELORIN_REPORT, "market wallet --out new --paper a5", 2, "--paper"},
        {PELORIN_REPORT, "market wallet --out file", 1, "pelorin-report: file: exists already"},
        {PELORIN_REPORT, "market short --out new", 1, "pelorin-report: short: "},
        {PELORIN_SAMPLE, "file", 1, "pelorin-sample: file/Companies: cannot be made: Not a directory\n"},
        {PELORIN_SAMPLE, "''", 2, "FOLDER"},
        {PELORIN_SAMPLE, "new --date 29/02/2025", 2, "--date"},
        {PELORIN_IMPORT, "new", 2, "--quotes"},
        {PELORIN_IMPORT, "new --rates r.csv --rates-are odd", 2, "--rates-are"},
        {PELORIN_IMPORT, "new --rates r.csv --reference ''", 2, "--reference"},
        {PELORIN_IMPORT, "new --rates none.csv", 1, "none.csv: "},
        {PELORIN_IMPORT, "new --quotes pipe", 1, "pelorin-import: pipe: is not an ordinary file\n"},
        {PELORIN_IMPORT, "new --quotes IBM.csv", 1, "IBM.csv"},
        {PELORIN_IMPORT, "market --rates r.csv", 1, "market: exists already and is left as it is\n"},
        {PELORIN_IMPORT, "market --into market --rates r.csv", 2, "--into"},
        {PELORIN_IMPORT, "--rates r.csv", 2, "--into"},
        {PELORIN_IMPORT, "--into none --rates r.csv", 1, "without --into a new file is made"},
        {PELORIN_IMPORT, "--into wallet --rates r.csv", 1, "wallet: this is a portfolio file\n"},
        {PELORIN_IMPORT, "--into short --rates r.csv", 1, "short: "},
        {PELORIN_IMPORT, "--into market --rates r.csv --reference CHF", 1, "\"CHF\" as --reference says"},
        {PELORIN_IMPORT, "--into bare --rates r.csv", 1, "bare: has no reference currency; --reference tells"},
        {PELORIN_IMPORT, "--into market --quotes IBM.csv --ticker-from-name --market X --currency XXX", 1,
         "no rate of \"XXX\", in which \"IBM\" is quoted: add a table with its --rates"},
        {PELORIN_IMPORT, "new --quotes IBM.csv --ticker-from-name --reference EUR", 1, "--reference of a new file"},
    };
    for (const auto& c : cases) {
        const ToolRun run(c.program, c.arguments, folder);
        EXPECT_EQ(run.status, c.status) << c.program << c.arguments;
        EXPECT_THAT(run.err, HasSubstr(c.message)) << c.program << c.arguments;
        EXPECT_EQ(run.out.empty(), c.status != 0) << c.program << c.arguments;
        EXPECT_TRUE(c.status != 1 || std::ranges::count(run.err, '\n') == 1) << run.err;
    }
    EXPECT_FALSE(std::filesystem::exists(folder / "new"));
    EXPECT_EQ(waitpid(writer, nullptr, WNOHANG), 0) << "the pipe is not even opened";
    kill(writer, SIGKILL);
    waitpid(writer, nullptr, 0);
}
