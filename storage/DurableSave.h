#pragma once

#include "storage/FileStamp.h"
#include "storage/KeptVersions.h"
#include "storage/SaveLock.h"
#include "storage/Writing.h"

#include <optional>
#include <string>

/// Saves a file so that a crash, a full disk or a pulled plug at any moment leaves the old file or the new one, whole,
/// and keeps the old one among the kept versions.
///
/// The new contents go to a temporary file and to the disk; then the old file is kept, then replaced, under a lock, so
/// that of several programs which save one file each finds in its place what the one before it has saved. Whatever
/// fails, or cannot be looked at, leaves the old file as it was. A link at the path stays, and so do the file's
/// permissions. A file that the user may not write to is not replaced, nor one in a folder where
/// the user may not make files.
class DurableSave {
public:
    enum class Outcome { kSaved, kOpenFailed, kWriteFailed };
    struct Result {
        Outcome outcome;
        std::string reason;             // one line for the user, with the file's path; empty when it is saved
        std::optional<FileStamp> stamp; // of the new file; nothing when it is not saved, and for a device
    };
    using Writer = FileWriter;

    /// @param patience how long a save waits for another program that saves in the same folder.
    explicit DurableSave(const DataFolder& folder, SaveLock::Patience patience = kPatience)
        : folder_(folder), patience_(patience)
    {}

    /// Saves what `write` writes to `path`. It is called at most once, and only when the file could be opened.
    /// @param former what `write` is based on: a file that is another one by then is not replaced.
    /// @return kWriteFailed also when the old file could not be kept, or another program did not end its save.
    Result save(const std::string& path, const Writer& write,
                const std::optional<FileStamp>& former = std::nullopt) const;

private:
    static constexpr SaveLock::Patience kPatience{10000}; // longer than a slow disk takes to copy a large file

    std::optional<FileStamp> replace(const std::string& path, const Writer& write,
                                     const std::optional<FileStamp>& former) const;

    DataFolder folder_;
    SaveLock::Patience patience_;
};
