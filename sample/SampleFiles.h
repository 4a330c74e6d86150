#pragma once

#include "foundation/Date.h"

#include <filesystem>

/// The files of the sample in a data folder.
struct SampleFiles {
    static constexpr const char* kName = "Sample";

    std::filesystem::path markets;
    std::filesystem::path portfolio;
    bool areMarketsNew = false; ///< made by the call, or else there before
    bool isPortfolioNew = false;

    /// Writes Companies/Sample and PortoFolios/Sample, with quotes up to `last`, into the folder, which is made when it
    /// is missing. By their times they are older than any file that somebody has saved. A file that is there is left as
    /// it is: of an owner who has removed one, the other one stays. What cannot be written throws std::runtime_error.
    static SampleFiles make(const std::filesystem::path& folder, const Date& last);
};
