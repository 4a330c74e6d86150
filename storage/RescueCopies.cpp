#include "storage/RescueCopies.h"

#include "storage/AtomicFile.h"
#include "storage/Folders.h"
#include "storage/InputFile.h"

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <filesystem>
#include <set>
#include <stdexcept>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

namespace {

namespace fs = std::filesystem;

constexpr mode_t kPrivate = 0700;
constexpr const char* kLock = ".lock";
constexpr const char* kNote = ".note";
constexpr const char* kFolders[] = {DataFolder::kCompanies, DataFolder::kPortoFolios};
constexpr RescueNote::Kind kBoth[] = {RescueNote::kMarkets, RescueNote::kPortfolio};

/// @return -1 with errno set: EWOULDBLOCK while somebody else has it, ENOENT when who had it has just removed it.
int openLocked(const std::string& path, int flags)
{
    const int descriptor = open(path.c_str(), O_RDWR | O_CREAT | O_NOFOLLOW | O_CLOEXEC | flags, 0600);
    if (descriptor < 0)
        return -1;
    struct stat status {};
    int reason = ENOENT;
    if (flock(descriptor, LOCK_EX | LOCK_NB) != 0 || fstat(descriptor, &status) != 0)
        reason = errno;
    else if (status.st_nlink > 0)
        return descriptor;
    close(descriptor);
    errno = reason;
    return -1;
}

/// A lock of a new name in `folder`. @return its descriptor, with `*name` set; -1 with errno set.
int lockNewName(const std::string& folder, std::string* name)
{
    constexpr int kAttempts = 1000; // windows that begin in one second
    const std::time_t now = std::time(nullptr);
    std::tm local{};
    localtime_r(&now, &local);
    char stamp[64];
    std::strftime(stamp, sizeof stamp, "%Y-%m-%d %H.%M.%S", &local);
    for (int i = 1; i <= kAttempts; ++i) {
        *name = i == 1 ? stamp : stamp + ('-' + std::to_string(i));
        const std::string path = folder + '/' + *name;
        struct stat status;
        if (lstat((path + kNote).c_str(), &status) == 0)
            continue; // somebody's, whose lock was removed by hand
        const int descriptor = openLocked(path + kLock, O_EXCL);
        // Taken for a left-over before it was locked, it is somebody else's or gone.
        if (descriptor >= 0 || (errno != EEXIST && errno != EWOULDBLOCK && errno != ENOENT))
            return descriptor;
    }
    return -1;
}

/// The text of a file. Throws std::runtime_error when it cannot be read.
std::string contentOf(const std::string& path)
{
    const InputFile file(path);
    std::string content;
    char piece[4096];
    while (const std::size_t got = std::fread(piece, 1, sizeof piece, file.stream()))
        content.append(piece, got);
    return content;
}

/// What the names of the files in `folder` begin with, each once.
std::set<std::string> namesIn(const std::string& folder)
{
    std::set<std::string> names;
    std::error_code error; // As a rule the folder is not there, and nothing has been left.
    for (fs::directory_iterator entry(folder, error); !error && entry != fs::directory_iterator();
         entry.increment(error))
        if (const fs::path name = entry->path().filename(); name.extension() == kLock || name.extension() == kNote)
            names.insert(name.stem());
    return names;
}

} // namespace

std::vector<std::shared_ptr<RescueCopies>> RescueCopies::takeLeftBehind(const DataFolder& folder)
{
    std::vector<std::shared_ptr<RescueCopies>> found;
    const std::string unsaved = folder.path() + DataFolder::kUnsaved;
    for (const std::string& name : namesIn(unsaved)) {
        const int lock = openLocked(unsaved + '/' + name + kLock, 0);
        if (lock < 0)
            continue; // its program lives, or somebody else has just taken it
        std::shared_ptr<RescueCopies> copies(new RescueCopies(unsaved, name, lock));
        if (copies->recall())
            found.push_back(copies);
    }
    std::ranges::stable_sort(found, std::greater(), [](const auto& copies) { return copies->note().time; });
    return found;
}

RescueCopies::RescueCopies(const DataFolder& folder) : folder_(folder.path() + DataFolder::kUnsaved)
{
    std::string error;
    folder.backups(&error);
    if (!error.empty())
        throw std::runtime_error(error);
    for (const char* kind : kFolders)
        if (const std::error_code failure = makeFolders(folder_ + kind, kPrivate))
            throw std::runtime_error(folder_ + kind + ": cannot be made: " + failure.message());
    lock_ = lockNewName(folder_, &name_);
    if (lock_ < 0)
        throw std::runtime_error(folder_ + ": cannot be written to: " + std::strerror(errno));
}

RescueCopies::RescueCopies(const std::string& folder, const std::string& name, int lock)
    : folder_(folder), name_(name), lock_(lock)
{}

RescueCopies::~RescueCopies()
{
    struct stat status;
    if (lstat(file(kNote).c_str(), &status) != 0 && errno == ENOENT)
        unlink(file(kLock).c_str());
    close(lock_); // from here on it is anybody's
}

bool RescueCopies::recall()
{
    struct stat status;
    if (lstat(file(kNote).c_str(), &status) != 0 && errno == ENOENT) {
        removeUnnamed();
        return false;
    }
    try {
        const auto note = RescueNote::read(contentOf(file(kNote)));
        if (!note || !note->hasCopies())
            return false;
        note_ = *note;
        return std::ranges::all_of(kBoth, [this](RescueNote::Kind kind) {
            const RescueNote::Part& part = note_.parts[kind];
            return !part.isCopied() || fingerprintOf(copyOf(kind)) == part.copy;
        });
    } catch (const std::runtime_error&) {
        return false;
    }
}

std::string RescueCopies::file(RescueNote::Kind kind, unsigned generation) const
{
    return folder_ + kFolders[kind] + '/' + name_ + " (" + std::to_string(generation) + ')';
}

std::string RescueCopies::copyOf(RescueNote::Kind kind) const
{
    return file(kind, note_.parts[kind].generation);
}

RescueNote::Part RescueCopies::copied(RescueNote::Kind kind, unsigned generation, const FileWriter& write) const
{
    RescueNote::Part part;
    part.generation = generation;
    const std::string path = file(kind, generation);
    AtomicFile copy(path, AtomicFile::Existing::kReplace);
    fill(copy.stream(), path, write);
    copy.commit();
    part.copy = fingerprintOf(path);
    return part;
}

void RescueCopies::write(const Sources& sources, std::time_t now)
{
    const SizeSignalIgnored ignored;
    RescueNote note;
    note.time = note_.time;
    // No copy that the present note names is written over.
    const unsigned generation = 1 + std::max(note_.parts[0].generation, note_.parts[1].generation);
    for (const RescueNote::Kind kind : kBoth) {
        const Source& source = sources[kind];
        if (source.write) {
            note.parts[kind] = copied(kind, generation, source.write);
            note.time = now;
        } else if (source.isKept) {
            note.parts[kind] = note_.parts[kind];
        }
        note.parts[kind].path = source.path;
        note.parts[kind].isAsked = source.isAsked;
    }
    if (!note.hasCopies())
        return remove();
    AtomicFile text(file(kNote), AtomicFile::Existing::kReplace);
    fill(text.stream(), file(kNote), [&note](FILE* out) { return std::fputs(note.text().c_str(), out) < 0 ? -1 : 0; });
    text.commit();
    // The new generation counts; what the note does not name can go.
    note_ = note;
    removeUnnamed();
}

void RescueCopies::remove()
{
    if (!note_.hasCopies())
        return;
    // Without a note the copies count for nothing, should they be left.
    unlink(file(kNote).c_str());
    syncFolder(folder_);
    note_ = {};
    removeUnnamed();
}

void RescueCopies::removeUnnamed() const
{
    for (const RescueNote::Kind kind : kBoth) {
        const std::string folder = folder_ + kFolders[kind];
        std::error_code error;
        for (fs::directory_iterator entry(folder, error); !error && entry != fs::directory_iterator();
             entry.increment(error)) {
            const std::string path = entry->path();
            const bool isNamed = note_.parts[kind].isCopied() && path == copyOf(kind);
            if (path.starts_with(folder + '/' + name_ + " (") && !isNamed)
                unlink(path.c_str());
        }
    }
}
