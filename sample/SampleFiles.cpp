#include "sample/SampleFiles.h"

#include "market/Catalogue.h"
#include "portfolio/Wallet.h"
#include "sample/SampleMarket.h"
#include "sample/SamplePortfolio.h"
#include "storage/AtomicFile.h"
#include "storage/DataFolder.h"
#include "storage/Folders.h"

#include <chrono>
#include <stdexcept>
#include <string>

namespace {

/// Lets `object` write itself to `path` unless that is there. @return whether it has.
template <class Object>
bool writeUnlessThere(const std::filesystem::path& path, const Object& object, const Date& stamp)
{
    std::error_code error; // of a folder that cannot be searched; making the file tells it
    if (std::filesystem::exists(std::filesystem::symlink_status(path, error)))
        return false;
    error = makeFolders(path.parent_path());
    if (error)
        throw std::runtime_error(path.parent_path().string() + ": cannot be made: " + error.message());
    AtomicFile file(path, AtomicFile::Existing::kKeep);
    if (object.wrt(file.stream(), stamp) != 0)
        file.fail("cannot be written");
    file.commit();
    // Who looks for what was saved last does not mean these.
    constexpr std::chrono::years kLongAgo(20);
    std::filesystem::last_write_time(path, std::filesystem::file_time_type::clock::now() - kLongAgo, error);
    return true;
}

} // namespace

SampleFiles SampleFiles::make(const std::filesystem::path& folder, const Date& last)
{
    const std::vector<Date> days = sampleDays(last);
    Catalogue catalogue;
    Wallet wallet;
    fillSampleMarket(catalogue, days);
    fillSamplePortfolio(wallet, catalogue, days);

    SampleFiles files{folder / (DataFolder::kCompanies + 1) / kName, folder / (DataFolder::kPortoFolios + 1) / kName};
    files.areMarketsNew = writeUnlessThere(files.markets, catalogue, last);
    files.isPortfolioNew = writeUnlessThere(files.portfolio, wallet, last);
    return files;
}
