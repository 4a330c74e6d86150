#include "app/KeptVersions.h"

#include "foundation/AtomicFile.h"
#include "foundation/Folders.h"

#include <algorithm>
#include <cerrno>
#include <cstdint>
#include <cstdio>
#include <cstring>
#include <fcntl.h>
#include <filesystem>
#include <stdexcept>
#include <string_view>
#include <sys/stat.h>
#include <unistd.h>

namespace {

namespace fs = std::filesystem;

constexpr mode_t kPrivate = 0700;

/// A file descriptor that is closed in the end.
struct Descriptor {
    explicit Descriptor(const std::string& path) : number(open(path.c_str(), O_RDONLY | O_NOFOLLOW | O_CLOEXEC)) {}
    ~Descriptor()
    {
        if (number >= 0)
            close(number);
    }
    Descriptor(const Descriptor&) = delete;
    Descriptor& operator=(const Descriptor&) = delete;

    const int number;
};

/// `name` or, if that leaves too little room for the time, its beginning and a number made of all of it.
std::string stemFor(const std::string& name)
{
    constexpr std::size_t kLongest = 110; // encrypting file systems have names of 143 bytes
    if (name.size() <= kLongest)
        return name;
    std::uint64_t hash = 14695981039346656037U; // FNV-1a
    for (const char c : name)
        hash = (hash ^ static_cast<unsigned char>(c)) * 1099511628211U;
    char number[18];
    std::snprintf(number, sizeof number, "~%016llx", static_cast<unsigned long long>(hash));
    std::size_t length = kLongest - std::strlen(number);
    while (length > 0 && (static_cast<unsigned char>(name[length]) & 0xC0) == 0x80)
        --length; // not within a UTF-8 character
    return name.substr(0, length) + number;
}

std::string stampOf(std::time_t now)
{
    std::tm local{};
    localtime_r(&now, &local);
    char text[64];
    std::strftime(text, sizeof text, "%Y-%m-%d %H.%M.%S", &local);
    return text;
}

/// The place of a version in time: its stamp, and its number within that second.
struct Moment {
    std::string stamp;
    unsigned number = 1;

    auto operator<=>(const Moment&) const = default;

    std::string text() const
    {
        char suffix[16] = "";
        if (number > 1)
            std::snprintf(suffix, sizeof suffix, "-%03u", number);
        return stamp + suffix;
    }
    /// @return false when `text` is no moment.
    bool read(std::string_view text)
    {
        constexpr std::string_view kPattern = "0000-00-00 00.00.00";
        const auto isLike = [](char c, char pattern) { return pattern == '0' ? c >= '0' && c <= '9' : c == pattern; };
        if (text.size() < kPattern.size() ||
            !std::equal(kPattern.begin(), kPattern.end(), text.begin(), [&](char p, char c) { return isLike(c, p); }))
            return false;
        stamp = text.substr(0, kPattern.size());
        const std::string_view suffix = text.substr(kPattern.size());
        if (suffix.empty())
            return true;
        constexpr std::size_t kDigits = 9;
        if (suffix.size() < 2 || suffix.size() > 1 + kDigits || suffix[0] != '-' ||
            suffix.find_first_not_of("0123456789", 1) != std::string_view::npos)
            return false;
        number = static_cast<unsigned>(std::stoul(std::string(suffix.substr(1))));
        return true;
    }
};

/// The moments of the versions of one file that lie in `folder`, in order of time.
std::vector<Moment> momentsIn(const std::string& folder, const std::string& stem)
{
    std::vector<Moment> moments;
    std::error_code error;
    for (fs::directory_iterator entry(folder, error); !error && entry != fs::directory_iterator();
         entry.increment(error)) {
        const std::string name = entry->path().filename();
        Moment moment;
        if (name.starts_with(stem + ' ') && moment.read(std::string_view(name).substr(stem.size() + 1)))
            moments.push_back(moment);
    }
    std::sort(moments.begin(), moments.end());
    return moments;
}

/// Where the versions of one file go: `folder/stem moment`.
struct Shelf {
    Shelf(const std::string& aFolder, const std::string& path)
        : folder(aFolder), stem(stemFor(fs::path(path).filename()))
    {}
    std::string pathOf(const Moment& moment) const { return folder + '/' + stem + ' ' + moment.text(); }
    std::vector<Moment> moments() const { return momentsIn(folder, stem); }

    const std::string folder;
    const std::string stem;
};

/// Removes a version that a killed save has linked but not replaced: it still is the file itself.
void removeLinkTo(const struct stat& file, const Shelf& shelf, const std::vector<Moment>& moments)
{
    if (file.st_nlink == 1)
        return;
    struct stat version;
    for (const Moment& moment : moments) {
        const std::string path = shelf.pathOf(moment);
        if (lstat(path.c_str(), &version) == 0 && version.st_ino == file.st_ino && version.st_dev == file.st_dev)
            unlink(path.c_str());
    }
}

/// Removes the oldest of the versions. Those after `present` come from a time when the clock was ahead, and count as
/// older than all others.
void removeOldest(const Shelf& shelf, std::vector<Moment> moments, const Moment& present)
{
    std::rotate(moments.begin(), std::upper_bound(moments.begin(), moments.end(), present), moments.end());
    for (std::size_t i = 0; i + KeptVersions::kVersions < moments.size(); ++i)
        unlink(shelf.pathOf(moments[i]).c_str());
}

/// Links the file to `version` unless it has other names. @return false when it has to be copied.
bool linkVersion(const std::string& path, const std::string& version)
{
    struct stat file;
    if (lstat(path.c_str(), &file) != 0 || file.st_nlink != 1 || link(path.c_str(), version.c_str()) != 0)
        return false;
    // Whoever wrote the file may not have brought it to the disk. It cannot always be opened; it is kept even so.
    const Descriptor written(version);
    if (written.number >= 0)
        (void)fsync(written.number);
    return true;
}

/// Copies what is left of `from` to `to`. @return false with errno set.
bool copyContents(int from, int to)
{
    constexpr std::size_t kClone = std::size_t{1} << 30;
    // Shares the blocks where the file system can. What it did not do, for whatever reason, is done by hand.
    while (copy_file_range(from, nullptr, to, nullptr, kClone, 0) > 0) {
    }
    char block[1 << 16];
    ssize_t size;
    while ((size = read(from, block, sizeof block)) > 0)
        for (ssize_t done = 0; done < size;) {
            const ssize_t more = write(to, block + done, static_cast<std::size_t>(size - done));
            if (more < 0)
                return false;
            done += more;
        }
    return size == 0;
}

/// Throws AtomicFile's errors.
void copyVersion(const std::string& path, const std::string& version)
{
    const Descriptor from(path);
    struct stat status;
    if (from.number < 0 || fstat(from.number, &status) != 0)
        throw AtomicFile::OpenError(std::strerror(errno));
    AtomicFile copy(version, AtomicFile::Existing::kKeep);
    const int to = fileno(copy.stream());
    (void)fchmod(to, status.st_mode & 0777);
    if (!copyContents(from.number, to))
        throw AtomicFile::WriteError(std::strerror(errno));
    const timespec times[] = {status.st_atim, status.st_mtim};
    (void)futimens(to, times);
    copy.commit();
}

[[noreturn]] void failFor(const std::string& path, const std::string& reason)
{
    throw std::runtime_error(path + ": its former version cannot be kept: " + reason);
}

} // namespace

std::string KeptVersions::folderFor(const std::string& path) const
{
    const fs::path folder = fs::path(path).parent_path();
    const std::string backups = folder_.path() + DataFolder::kBackups;
    for (const char* kind : {DataFolder::kCompanies, DataFolder::kPortoFolios}) {
        std::error_code error;
        const fs::path base = fs::weakly_canonical(folder_.path() + kind, error);
        const fs::path within = folder.lexically_relative(base);
        if (within == ".")
            return backups + kind;
        if (!within.empty() && *within.begin() != "..")
            return backups + kind + '/' + within.string();
    }
    return backups + "/Elsewhere" + (folder == "/" ? "" : folder.string());
}

std::string KeptVersions::keep(const std::string& path, std::time_t now) const
{
    std::string error;
    folder_.backups(&error);
    if (!error.empty())
        failFor(path, error);
    const Shelf shelf(folderFor(path), path);
    if (const std::error_code reason = makeFolders(shelf.folder, kPrivate))
        failFor(path, shelf.folder + ": cannot be made: " + reason.message());
    AtomicFile::removeLeftOvers(shelf.folder); // of copies
    struct stat file;
    if (lstat(path.c_str(), &file) != 0)
        failFor(path, std::strerror(errno));
    const std::vector<Moment> moments = shelf.moments();
    removeLinkTo(file, shelf, moments);

    Moment moment{stampOf(now)};
    for (const Moment& former : moments) // a number is not used again, even if its version is gone
        if (former.stamp == moment.stamp)
            moment.number = former.number + 1;
    removeOldest(shelf, moments, moment); // of saves that were killed before they could prune
    const std::string version = shelf.pathOf(moment);
    if (!linkVersion(path, version)) {
        try {
            copyVersion(path, version);
        } catch (const std::runtime_error& reason) {
            failFor(path, reason.what());
        }
    }
    syncFolder(shelf.folder);
    return version;
}

void KeptVersions::forget(const std::string& version) const
{
    unlink(version.c_str());
}

void KeptVersions::prune(const std::string& path, const std::string& newest) const
{
    const Shelf shelf(folderFor(path), path);
    const std::vector<Moment> moments = shelf.moments();
    const auto present =
        std::find_if(moments.begin(), moments.end(), [&](const Moment& m) { return shelf.pathOf(m) == newest; });
    if (present != moments.end())
        removeOldest(shelf, moments, *present);
}

std::vector<std::string> KeptVersions::versionsOf(const std::string& path) const
{
    const Shelf shelf(folderFor(path), path);
    std::vector<std::string> versions;
    for (const Moment& moment : shelf.moments())
        versions.push_back(shelf.pathOf(moment));
    return versions;
}
