#pragma once

#include "storage/DataFolder.h"

#include <ctime>
#include <string>
#include <vector>

/// The former versions of files that saves have replaced, in the data folder's "Backups".
///
/// A version is named after its file, the local time and a serial number, "Sample 2026-11-21 10.53.04 (57)". The time
/// is for people; the number is one above the highest that is there, and alone settles which versions are the oldest,
/// because clocks go back: every autumn, on flights, when they are set. Names without a number, perhaps with "-002"
/// behind the time, are from release 0.1.0; they count as older than all with one, and go by their time. Versions of
/// files under "Companies" and "PortoFolios" lie in folders of the same name; those of all others under "Elsewhere",
/// followed by their folder's whole path. So files of equal names never meet. A name of more than 110 bytes is
/// shortened, and a number made of the whole name put behind it, because the time must have room.
///
/// A version is a hard link to the file where that works, so that it costs the same for large files as for small ones:
/// the save then gives the name to a new file, and the link keeps the old one. Until then the two names are one file,
/// and a program that wrote into it in place would change both. That can only be in the moment between `keep` and the
/// rename; a link that a killed save has left is removed by the next one, and a file that already has other names is
/// copied, because they stay in use.
class KeptVersions {
public:
    static constexpr std::size_t kVersions = 20; // of each file

    explicit KeptVersions(const DataFolder& folder) : folder_(folder) {}

    /// Keeps the file at `path` (absolute, no links) as it is now; the version is on the disk on return. From here to
    /// the end of `prune` the caller holds a SaveLock: the link of another save that is under way would be taken for
    /// one that a killed save has left.
    /// Throws std::runtime_error with one line for the user when it cannot be kept.
    /// @return the version's path.
    std::string keep(const std::string& path, std::time_t now = std::time(nullptr)) const;
    /// Removes `version` again, since the save that kept it did not come about.
    void forget(const std::string& version) const;
    /// Removes the oldest versions of the file at `path`, up to `kVersions`. `newest` is what `keep` has returned.
    /// Never throws, because the save has come about. `keep` removes what a save that was killed before this has left,
    /// so that there is never more than one too many.
    void prune(const std::string& path, const std::string& newest) const;

    /// The paths of the versions of the file at `path`, in the order of the saves. Throws as `keep` does.
    std::vector<std::string> versionsOf(const std::string& path) const;

private:
    std::string folderFor(const std::string& path) const;

    DataFolder folder_;
};
