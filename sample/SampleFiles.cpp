#include "sample/SampleFiles.h"

#include "market/Catalogue.h"
#include "portfolio/Wallet.h"
#include "sample/SampleMarket.h"
#include "sample/SamplePortfolio.h"
#include "storage/AtomicFile.h"
#include "storage/DataFolder.h"
#include "storage/Folders.h"

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

    SampleFiles files{folder / (DataFolder::kCompanies + 1) / "Sample",
                      folder / (DataFolder::kPortoFolios + 1) / "Sample"};
    files.areMarketsNew = writeUnlessThere(files.markets, catalogue, last);
    files.isPortfolioNew = writeUnlessThere(files.portfolio, wallet, last);
    return files;
}
