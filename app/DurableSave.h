#pragma once

#include "app/KeptVersions.h"

#include <cstdio>
#include <functional>
#include <string>

/// Saves a file so that a crash, a full disk or a pulled plug at any moment leaves the old file or the new one, whole,
/// and keeps the old one among the kept versions.
///
/// The new contents go to a temporary file and to the disk; then the old file is kept, then replaced. Whatever fails
/// leaves the old file as it was. A link at the path stays, and so do the file's permissions. A file that the user may
/// not write to is not replaced, nor one in a folder where he may not make files.
class DurableSave {
public:
    enum class Outcome { kSaved, kOpenFailed, kWriteFailed };
    struct Result {
        Outcome outcome;
        std::string reason; // one line for the user, with the file's path; empty when it is saved
    };
    /// Writes the contents, perhaps none. @return 0, or -1 when that failed.
    using Writer = std::function<int(FILE*)>;

    explicit DurableSave(const DataFolder& folder) : versions_(folder) {}

    /// Saves what `write` writes to `path`. It is called at most once, and only when the file could be opened.
    /// @return kWriteFailed also when the old file could not be kept.
    Result save(const std::string& path, const Writer& write) const;

private:
    void replace(const std::string& path, const Writer& write) const;

    KeptVersions versions_;
};
