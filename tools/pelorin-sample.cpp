#include "foundation/Today.h"
#include "market/Catalogue.h"
#include "portfolio/Wallet.h"
#include "storage/AtomicFile.h"
#include "storage/DataFolder.h"
#include "storage/InputFile.h"
#include "tools/Program.h"
#include "tools/SampleMarket.h"
#include "tools/SamplePortfolio.h"
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

bool isThere(const std::string& path)
{
    std::error_code error; // of a folder that cannot be searched; making the file tells it
    return std::filesystem::exists(std::filesystem::symlink_status(path, error));
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

/// Lets `object` write itself to `path` unless that is there. @return whether it has.
template <class Object>
bool writeSample(const std::filesystem::path& path, const Object& object, const Date& stamp)
{
    if (isThere(path))
        return false;
    std::error_code error;
    std::filesystem::create_directories(path.parent_path(), error);
    if (error)
        throw std::runtime_error(path.parent_path().string() + ": cannot be made: " + error.message());
    AtomicFile file(path, AtomicFile::Existing::kKeep);
    if (object.wrt(file.stream(), stamp) != 0)
        file.fail("cannot be written");
    file.commit();
    return true;
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
    const std::vector<Date> days = sampleDays(last);
    Catalogue catalogue;
    Wallet wallet;
    fillSampleMarket(catalogue, days);
    fillSamplePortfolio(wallet, catalogue, days);

    const std::filesystem::path folder = dataFolder(arguments);
    const std::filesystem::path market = folder / "Companies" / "Sample";
    const std::filesystem::path portfolio = folder / "PortoFolios" / "Sample";
    // Each file by itself: an owner who has removed one of them gets it back, and keeps the other as it is.
    const bool isMarketNew = writeSample(market, catalogue, last);
    const bool isPortfolioNew = writeSample(portfolio, wallet, last);
    if (!arguments.quiet && (!arguments.onlyNews || isMarketNew || isPortfolioNew)) {
        tell(market, isMarketNew);
        tell(portfolio, isPortfolioNew);
    }
    if (arguments.quotes.empty())
        return;
    writeQuotes(arguments.quotes, market, last);
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
