#include "storage/KeptVersions.h"

#include "storage/AtomicFile.h"
#include "storage/Checksum.h"
#include "storage/Descriptor.h"
#include "storage/Folders.h"

#include <algorithm>
#include <array>
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
#include <utility>

namespace {

namespace fs = std::filesystem;

constexpr mode_t kPrivate = 0700;
constexpr int kToRead = O_RDONLY | O_NOFOLLOW | O_CLOEXEC;

/// `name` or, if that leaves too little room for the time, its beginning and a number made of all of it.
std::string stemFor(const std::string& name)
{
    constexpr std::size_t kLongest = 110; // encrypting file systems have names of 143 bytes
    if (name.size() <= kLongest)
        return name;
    char number[18];
    std::snprintf(number, sizeof number, "~%016llx", static_cast<unsigned long long>(checksumOf(name)));
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

/// A version of a file, and what settles its place in the order of the saves: its serial number, which is 0 in names of
/// release 0.1.0; then year to second of its stamp; then the number that 0.1.0 put behind the later ones of a second.
struct Version {
    std::array<std::int64_t, 8> place{};
    std::string name;

    auto operator<=>(const Version&) const = default;
};

constexpr std::size_t kSerialDigits = 15;
constexpr std::int64_t kLastSerial = 999'999'999'999'999; // only ever reached from a name that was made by hand

bool take(char c, std::string_view* text)
{
    if (!text->starts_with(c))
        return false;
    text->remove_prefix(1);
    return true;
}

/// Takes a number of so many digits off the front of `*text`. @return false when it is not there.
bool takeNumber(std::size_t fewest, std::size_t most, std::string_view* text, std::int64_t* number)
{
    const std::size_t digits = std::min(text->find_first_not_of("0123456789"), text->size());
    if (digits < fewest || digits > most)
        return false;
    *number = std::stoll(std::string(text->substr(0, digits)));
    text->remove_prefix(digits);
    return true;
}

/// @return false when `text` is not what stands behind the name of a version's file.
bool readPlace(std::string_view text, Version* version)
{
    auto& [serial, year, month, day, hour, minute, second, number] = version->place;
    // The forms: "2026-11-21 10.53.04", the same with "-002" behind it, and with " (57)" behind it.
    const bool isNegative = take('-', &text); // whatever a clock may say
    if (!takeNumber(1, 10, &text, &year))
        return false;
    if (isNegative)
        year = -year;
    const std::pair<char, std::int64_t*> parts[] = {
        {'-', &month}, {'-', &day}, {' ', &hour}, {'.', &minute}, {'.', &second}};
    for (const auto& [before, part] : parts)
        if (!take(before, &text) || !takeNumber(2, 2, &text, part))
            return false;
    if (text.empty())
        return true;
    if (take('-', &text))
        return takeNumber(1, 9, &text, &number) && text.empty();
    return take(' ', &text) && take('(', &text) && takeNumber(1, kSerialDigits, &text, &serial) && text == ")";
}

/// Where the versions of one file go: `folder/stem stamp (serial number)`.
struct Shelf {
    Shelf(const std::string& aFolder, const std::string& path)
        : folder(aFolder), stem(stemFor(fs::path(path).filename()))
    {}
    std::string pathOf(const Version& version) const { return folder + '/' + version.name; }
    std::string newPath(std::int64_t serial, std::time_t now) const
    {
        return folder + '/' + stem + ' ' + stampOf(now) + " (" + std::to_string(serial) + ')';
    }
    /// In the order of the saves. Where `*error` is set, some may be missing.
    std::vector<Version> versions(std::error_code* error) const
    {
        std::vector<Version> versions;
        for (fs::directory_iterator entry(folder, *error); !*error && entry != fs::directory_iterator();
             entry.increment(*error)) {
            Version version;
            version.name = entry->path().filename();
            if (version.name.starts_with(stem + ' ') &&
                readPlace(std::string_view(version.name).substr(stem.size() + 1), &version))
                versions.push_back(version);
        }
        std::sort(versions.begin(), versions.end());
        return versions;
    }

    const std::string folder;
    const std::string stem;
};

/// Removes a version that a killed save has linked but not replaced: it still is the file itself.
void removeLinkTo(const struct stat& file, const Shelf& shelf, std::vector<Version>* versions)
{
    // A killed save leaves the file with two names, of which one is a version's. A file with a single name has none
    // here.
    if (file.st_nlink == 1)
        return;
    std::erase_if(*versions, [&](const Version& version) {
        struct stat status;
        const std::string path = shelf.pathOf(version);
        return lstat(path.c_str(), &status) == 0 && status.st_ino == file.st_ino && status.st_dev == file.st_dev &&
               unlink(path.c_str()) == 0;
    });
}

void removeOldest(const Shelf& shelf, const std::vector<Version>& versions)
{
    for (std::size_t i = 0; i + KeptVersions::kVersions < versions.size(); ++i)
        unlink(shelf.pathOf(versions[i]).c_str());
}

/// Links the file to `version` unless it has other names. Throws a WriteError when it cannot be brought to the disk.
/// @return false when it has to be copied.
bool linkVersion(const std::string& path, const std::string& version)
{
    struct stat file;
    if (lstat(path.c_str(), &file) != 0 || file.st_nlink != 1 || link(path.c_str(), version.c_str()) != 0)
        return false;
    // Whoever wrote the file may not have brought it to the disk. One that may not be read is kept even so.
    const Descriptor written(open(version.c_str(), kToRead));
    if (written.number >= 0 ? fsync(written.number) == 0 || errno == EINVAL : errno == EACCES)
        return true;
    const int reason = errno;
    unlink(version.c_str());
    throw AtomicFile::WriteError(std::strerror(reason));
}

/// Copies what is left of `from` to `to`. @return false with errno set.
bool copyContents(int from, int to)
{
    constexpr std::size_t kClone = std::size_t{1} << 30;
    // Shares the blocks where the file system can. What it did not do, for whatever reason, is done by hand.
    // Each call goes on where the last one has ended, and so does `read` below: both move the place in the file.
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
    const Descriptor from(open(path.c_str(), kToRead));
    struct stat status;
    if (from.number < 0 || fstat(from.number, &status) != 0)
        throw AtomicFile::OpenError(std::strerror(errno));
    AtomicFile copy(version, AtomicFile::Existing::kKeep);
    const int to = fileno(copy.stream());
    (void)fchmod(to, status.st_mode & 0777);
    if (!copyContents(from.number, to))
        throw AtomicFile::WriteError(std::strerror(errno));
    // So that file managers show when the version was saved, and not when it was copied.
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
        if (error)
            failFor(path, folder_.path() + kind + ": " + error.message());
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
    if (const std::error_code failure = makeFolders(shelf.folder, kPrivate))
        failFor(path, shelf.folder + ": cannot be made: " + failure.message());
    AtomicFile::removeLeftOvers(shelf.folder); // of copies
    struct stat file;
    if (lstat(path.c_str(), &file) != 0)
        failFor(path, std::strerror(errno));
    std::error_code reason;
    std::vector<Version> versions = shelf.versions(&reason);
    if (reason)
        failFor(path, shelf.folder + ": cannot be read: " + reason.message());
    // `versions` is sorted, so the last one has the highest number.
    const std::int64_t serial = versions.empty() ? 1 : std::min(versions.back().place.front() + 1, kLastSerial);
    removeLinkTo(file, shelf, &versions);
    removeOldest(shelf, versions); // of saves that were killed before they could prune
    const std::string version = shelf.newPath(serial, now);
    try {
        if (!linkVersion(path, version))
            copyVersion(path, version);
    } catch (const std::runtime_error& failure) {
        failFor(path, failure.what());
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
    const Shelf shelf(folderOf(newest), path);
    std::error_code error; // The next save prunes what this one does not see.
    removeOldest(shelf, shelf.versions(&error));
}

std::vector<std::string> KeptVersions::versionsOf(const std::string& path) const
{
    const Shelf shelf(folderFor(path), path);
    std::error_code error;
    std::vector<std::string> paths;
    for (const Version& version : shelf.versions(&error))
        paths.push_back(shelf.pathOf(version));
    return paths;
}
