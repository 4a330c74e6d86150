#include "foundation/Today.h"
#include "market/Catalogue.h"
#include "sample/SampleFiles.h"
#include "storage/DataFolder.h"
#include "storage/InputFile.h"
#include "tools/Program.h"
#include "tools/SampleQuotes.h"

#include <filesystem>
#include <iostream>
#include <stdexcept>
#include <string>

namespace {

const char* const kPurpose = "Writes a made-up market file and portfolio into a data folder, as Companies/Sample and\n"
                             "PortoFolios/Sample. A file that is there is left as it is.\n"
                             "Example: pelorin-sample --quotes ~/quotes";

const char* const kOutput =
    R"(The same date gives the same files. Companies and prices are invented.

With --quotes there are also tables to serve with pelorin-quotes: of the companies in Companies/Sample that the sample
has invented, the quotes of the last 100 days in it, and prices for the days since and for the last one, which are news
to that file. Tables that are there are renewed.

Exit status: 0, 1 when a file cannot be read or written, 2 for bad arguments.)";

struct Arguments {
    std::string folder;
    Date date = today();
    std::string quotes;
    bool quiet = false;
    bool onlyNews = false;
};

void describe(Program& program, Arguments& arguments)
{
    program.setFooter(kOutput);
    program.addText("FOLDER", arguments.folder, "TEXT",
                    "Data folder, made when it is missing; without it the one that Pelorin keeps your files in");
    program.addDate("--date", arguments.date, "Day up to which there are quotes and rates; without it today");
    program.addText("--quotes", arguments.quotes, "FOLDER",
                    "Folder of tables TICKER.csv to write; made when it is missing");
    program.addFlag("--quiet", arguments.quiet, "Do not tell what was written");
    program.addFlag("--only-news", arguments.onlyNews, "Do not tell of the two files when both are there already");
}

std::filesystem::path dataFolder(const Arguments& arguments)
{
    if (!arguments.folder.empty())
        return arguments.folder;
    const DataFolder users;
    if (users.path().empty())
        throw std::runtime_error("There is no home folder to keep files in; name a FOLDER.");
    return users.path();
}

void tell(const std::filesystem::path& path, bool isWritten)
{
    std::cout << path.string() << (isWritten ? ": written\n" : ": is there and left as it is\n");
}

/// Goes by the market file that is there, which may be older than `last`, and changed by its owner.
void writeQuotes(const std::string& folder, const std::string& marketFile, const Date& last)
{
    const InputFile file(marketFile);
    Catalogue catalogue;
    if (catalogue.rd(file.stream()) != 0)
        throw std::runtime_error(marketFile + ": cannot be read as a market file");
    writeSampleQuotes(folder, catalogue, last);
}

void run(const Arguments& arguments)
{
    const Date& last = arguments.date;
    const SampleFiles files = SampleFiles::make(dataFolder(arguments), last);
    if (!arguments.quiet && (!arguments.onlyNews || files.areMarketsNew || files.isPortfolioNew)) {
        tell(files.markets, files.areMarketsNew);
        tell(files.portfolio, files.isPortfolioNew);
    }
    if (arguments.quotes.empty())
        return;
    writeQuotes(arguments.quotes, files.markets, last);
    if (!arguments.quiet)
        std::cout << arguments.quotes << ": quotes up to " << last.toString().bytes() << " written\n";
}

} // namespace

int main(int argc, char** argv)
{
    Arguments arguments;
    Program program(kPurpose, "pelorin-sample");
    describe(program, arguments);
    return program.run(argc, argv, [&] { run(arguments); });
}
