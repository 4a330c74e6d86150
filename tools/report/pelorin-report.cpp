#include "foundation/Today.h"
#include "platform/Application.h"
#include "report/PortfolioReport.h"
#include "report/ReportFile.h"
#include "tools/Program.h"
#include "tools/Valuation.h"
#include "valuation/WalletFigures.h"

#include <filesystem>
#include <iostream>

namespace {

const char* const kPurpose =
    "Makes a report of a Pelorin portfolio on a day, as a PDF file to be read and printed.\n"
    "Example: pelorin-report Companies/Sample PortoFolios/Sample --date 31/12/2024 --out Sample.pdf";

const char* const kOutput =
    R"(The report has the totals and returns, the value from day to day as a chart, the accounts, the holdings with
what they have brought, and the operations of a year with their sums.

Exit status: 0, 1 when a file cannot be read or the report not be written, 2 for bad arguments.)";

struct Arguments {
    std::string market;
    std::string portfolio;
    std::string out;
    std::string name;
    Date date = today();
    Date from;
    std::string year;
    std::string paper = "a4";
    bool force = false;
};

std::string checkYear(const std::string& text)
{
    constexpr std::size_t kLongest = 4;
    const bool isYear =
        !text.empty() && text.size() <= kLongest && text.find_first_not_of("0123456789") == std::string::npos;
    return isYear || text == "all" ? "" : "is neither a year nor \"all\": " + text;
}

void describe(Program& program, Arguments& arguments)
{
    program.setFooter(kOutput);
    program.add("MARKET_FILE", arguments.market, "Currencies, markets and companies with their quotes").required();
    program.add("PORTFOLIO_FILE", arguments.portfolio, "Accounts and holdings with their operations").required();
    program.addText("--out", arguments.out, "FILE", "The PDF file to write").required();
    program.addDate("--date", arguments.date, "Day of the report; without it today");
    program.addDate("--from", arguments.from,
                    "Begin the returns and the gains behind this day; without it with the first operation");
    program.add("--year", arguments.year, "Year whose operations are listed, or all; without it the last one with any")
        .type("YEAR|all")
        .check(checkYear);
    program.add("--paper", arguments.paper, "Size of the paper: a4, as without it, or letter")
        .type("SIZE")
        .oneOf({"a4", "letter"});
    program.addText("--name", arguments.name, "NAME",
                    "What the report calls the portfolio; without it the name of its file");
    program.addFlag("--force", arguments.force, "Replace the file if it is there");
}

std::optional<int> yearOf(const Arguments& arguments, const PortfolioReport& report)
{
    if (arguments.year == "all")
        return std::nullopt;
    if (!arguments.year.empty())
        return std::stoi(arguments.year);
    const std::vector<int> years = report.years();
    return years.empty() ? std::nullopt : std::optional(years.front());
}

/// What is read is never what is replaced, by whichever name or link.
void checkIsNotRead(const std::string& out, const std::string& input)
{
    std::error_code isMissing;
    if (std::filesystem::equivalent(out, input, isMissing))
        throw std::runtime_error(out + ": is read here, and is left as it is");
}

void run(const Arguments& arguments)
{
    const auto existing = arguments.force ? AtomicFile::Existing::kReplace : AtomicFile::Existing::kKeep;
    AtomicFile::check(arguments.out, existing);
    checkIsNotRead(arguments.out, arguments.market);
    checkIsNotRead(arguments.out, arguments.portfolio);
    Valuation valuation(arguments.market, arguments.portfolio);
    const WalletFigures figures(valuation.wallet(), valuation.catalogue(), arguments.date, arguments.from);
    const std::string name =
        arguments.name.empty() ? std::filesystem::path(arguments.portfolio).filename().string() : arguments.name;
    BApplication::UseNoDisplay();
    const BApplication application("application/x-vnd.Pelorin-report");
    const PortfolioReport report(figures, name);
    const PaperSize size = arguments.paper == "a4" ? PaperSize::kA4 : PaperSize::kLetter;
    writePdf(*report.make(yearOf(arguments, report), size), arguments.out, existing);
    if (const std::string doubt = valuation.doubt(); !doubt.empty())
        std::cerr << "pelorin-report: " << doubt << '\n';
}

} // namespace

int main(int argc, char** argv)
{
    Arguments arguments;
    Program program(kPurpose, "pelorin-report");
    describe(program, arguments);
    return program.run(argc, argv, [&] { run(arguments); });
}
