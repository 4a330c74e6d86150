#pragma once

#include "exchange/MarketPlan.h"
#include "market/Catalogue.h"
#include "storage/FileStamp.h"
#include "storage/InputFile.h"

#include <optional>

/// A market data file that is there, to be added to: what it holds, and the writing of it anew.
///
/// What nothing was added to is written byte by byte as it stands in the file, and not as the model has it: nobody has
/// asked to put a series in order that is not, or has a day twice. In one that does change, the days that were not
/// named keep their records and places; of a day that has two, both get the new value.
class MarketFile {
public:
    /// Reads the file. Throws std::runtime_error with one line for the user when it is no market data file, or not
    /// whole.
    explicit MarketFile(const std::string& path);

    const std::string& path() const { return file_.path(); }
    Catalogue& catalogue() { return catalogue_; }
    /// The symbol of the reference as the file names it, even when it has no currency of that symbol; empty when it
    /// names none.
    std::string reference() const { return std::string(reference_.comparedBytes()); }
    /// Carries out `plan`, which was made for the catalogue, and saves the file as a save of the window does. Throws
    /// std::runtime_error with the reason when it could not be saved, or is not as it was read any more; then nothing
    /// has happened to it.
    /// @param latestDay of the values. A file that bears a later one keeps that.
    void save(MarketPlan& plan, const Date& latestDay);

    /// Writes the file with what a plan has added to the catalogue. `changed` are those of whose quotes or rates some
    /// are other than in the file; all else that the file has is copied from it.
    /// @return 0; -1 when reading or writing fails.
    int write(FILE* to, const MarketPlan::Owners& changed, const Date& stamp) const;

private:
    void read();

    InputFile file_;
    std::optional<FileStamp> stamp_; // tells the file as it was read from what another program has put in its place
    Catalogue catalogue_;
    String reference_;
    Date latestStamp_; // the latest of the dates that the currencies bear; undefined when none has a real one
};
