#include "market/Catalogue.h"
#include "portfolio/Wallet.h"
#include "foundation/AtomicFile.h"
#include "tools/DateText.h"
#include "tools/Program.h"
#include "tools/SampleMarket.h"
#include "tools/SamplePortfolio.h"

#include <filesystem>
#include <iostream>
#include <stdexcept>
#include <string>

namespace {

const char* const kPurpose = "Writes a made-up market file and portfolio into a data folder, as Companies/Sample and\n"
                             "PortoFolios/Sample. A file that is there is left as it is.\n"
                             "Example: pelorin-sample ~/Documents/Pelorin";

const char* const kOutput = "The same date gives the same files. Companies and prices are invented.\n\n"
                            "Exit status: 0, 1 when a file cannot be written, 2 for bad arguments.";

struct Arguments {
    std::string folder;
    std::string date;
    bool quiet = false;
};

void describe(CLI::App& app, Arguments& arguments)
{
    app.footer(kOutput);
    app.add_option("FOLDER", arguments.folder, "Data folder; made when it is missing")
        ->required()
        ->check(checkNotEmpty);
    app.add_option("--date", arguments.date, "Day up to which there are quotes and rates; without it today")
        ->type_name("DD/MM/YYYY")
        ->check(checkDateArgument);
    app.add_flag("--quiet", arguments.quiet, "Do not tell what was written");
}

bool isThere(const std::string& path)
{
    std::error_code error; // of a folder that cannot be searched; making the file tells it
    return std::filesystem::exists(std::filesystem::symlink_status(path, error));
}

/// Lets `object` write itself to `folder/Sample` unless that is there. @return a line on it.
template <class Object>
std::string writeSample(const std::filesystem::path& folder, const Object& object, const Date& stamp)
{
    const std::string path = folder / "Sample";
    if (isThere(path))
        return path + ": is there and left as it is";
    std::error_code error;
    std::filesystem::create_directories(folder, error);
    if (error)
        throw std::runtime_error(folder.string() + ": cannot be made: " + error.message());
    AtomicFile file(path, AtomicFile::Existing::kKeep);
    if (object.wrt(file.stream(), stamp) != 0)
        file.fail("cannot be written");
    file.commit();
    return path + ": written";
}

void run(const Arguments& arguments)
{
    const Date last = dateArgument(arguments.date);
    const std::vector<Date> days = sampleDays(last);
    Catalogue catalogue;
    Wallet wallet;
    fillSampleMarket(catalogue, days);
    fillSamplePortfolio(wallet, catalogue, days);

    const std::filesystem::path folder = arguments.folder;
    const std::string market = writeSample(folder / "Companies", catalogue, last);
    const std::string portfolio = writeSample(folder / "PortoFolios", wallet, last);
    if (!arguments.quiet)
        std::cout << market << '\n' << portfolio << '\n';
}

} // namespace

int main(int argc, char** argv)
{
    Arguments arguments;
    CLI::App app(kPurpose, "pelorin-sample");
    describe(app, arguments);
    return runProgram(app, argc, argv, [&] { run(arguments); });
}
