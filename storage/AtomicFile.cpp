#include "storage/AtomicFile.h"

#include "storage/Descriptor.h"
#include "storage/Folders.h"

#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <filesystem>
#include <string_view>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

namespace {

namespace fs = std::filesystem;

// The life of an AtomicFile: `create` makes the temporary file, empty and locked; the owner writes to `stream_`;
// `flush` brings the bytes to the disk and sets `flushed_`; `commit` renames. Up to the rename the file at `target_` is
// untouched, and the destructor removes the temporary one.
constexpr std::string_view kPrefix = ".pelorin-";
constexpr std::string_view kSuffix = ".tmp";
constexpr const char* kCannotOpen = "cannot be opened";
constexpr const char* kCannotWrite = "cannot be written";
constexpr const char* kIsKept = ": exists already and is left as it is";

template <class Error>
[[noreturn]] void failFor(const std::string& path, const char* what)
{
    throw Error(path + ": " + what + ": " + std::strerror(errno));
}

/// Whether there is something at `path`. When that cannot be told, throws an Error for `shown` that says `what`: taken
/// for nothing, it would be replaced unseen.
/// @param flags AT_SYMLINK_NOFOLLOW to look at a link itself.
template <class Error>
bool isThere(const std::string& path, int flags, const std::string& shown, const char* what, struct stat* status)
{
    if (fstatat(AT_FDCWD, path.c_str(), status, flags) == 0)
        return true;
    if (errno != ENOENT)
        failFor<Error>(shown, what);
    return false;
}

bool isLink(const std::string& path, const std::string& shown)
{
    struct stat status;
    return isThere<AtomicFile::OpenError>(path, AT_SYMLINK_NOFOLLOW, shown, kCannotOpen, &status) &&
           S_ISLNK(status.st_mode);
}

/// What `path` leads to, which need not exist. Throws an OpenError when that cannot be told.
std::string withoutLinks(const std::string& path)
{
    constexpr int kMaxLinks = 40; // those of a ring that has come up since the check
    std::error_code error;
    fs::path target = path;
    for (int links = 0; !error && isLink(target, path); ++links) {
        // A link's text counts from the folder that the link is in; an absolute one replaces all of it.
        target = target.parent_path() / fs::read_symlink(target, error);
        if (links == kMaxLinks)
            error = std::make_error_code(std::errc::too_many_symbolic_link_levels);
    }
    fs::path folder;
    if (!error)
        // The last name is kept as it is: there need not be a file of it.
        folder = fs::canonical(folderOf(target), error);
    if (error) {
        errno = error.value();
        failFor<AtomicFile::OpenError>(path, kCannotOpen);
    }
    return folder / target.filename();
}

/// Locks a temporary file that was just created. @return false when it was taken for a left-over before it was locked.
bool lockCreated(int descriptor)
{
    // Another program may have seen the file between its making and this lock, and hold the lock while it removes it.
    while (flock(descriptor, LOCK_EX) != 0 && errno == EINTR) {
    }
    struct stat status;
    return fstat(descriptor, &status) != 0 || status.st_nlink > 0;
}

/// Creates and locks a file in `folder`. @return its descriptor, with `*name` set; -1 with errno set.
int createIn(const std::string& folder, mode_t mode, std::string* name)
{
    // A name of its own length, since that of the target may already be as long as the file system allows. It never
    // comes twice, so that nobody takes a new file for the left-over that was just seen under that name.
    static unsigned number = 0;
    const std::string stem = folder + '/' + std::string(kPrefix) + std::to_string(getpid()) + '-';
    constexpr int kAttempts = 100; // a crash may have left such a file behind
    for (int i = 0; i < kAttempts; ++i) {
        *name = stem + std::to_string(number++) + std::string(kSuffix);
        const int descriptor = open(name->c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, mode);
        if (descriptor < 0 && errno != EEXIST)
            return -1;
        if (descriptor >= 0 && lockCreated(descriptor))
            return descriptor;
        // Made, but taken for a left-over: it has no name any more. The next number is tried.
        if (descriptor >= 0)
            close(descriptor);
    }
    errno = EEXIST;
    return -1;
}

bool isNumber(std::string_view text)
{
    return !text.empty() && text.find_first_not_of("0123456789") == std::string_view::npos;
}

/// Whether `createIn` gives such a name: a file of another one may be a user's.
bool isTemporary(std::string_view name)
{
    if (!name.starts_with(kPrefix) || !name.ends_with(kSuffix))
        return false;
    const std::string_view numbers = name.substr(kPrefix.size(), name.size() - kPrefix.size() - kSuffix.size());
    const std::size_t hyphen = numbers.find('-');
    return hyphen != std::string_view::npos && isNumber(numbers.substr(0, hyphen)) &&
           isNumber(numbers.substr(hyphen + 1));
}

/// Removes a temporary file unless it is locked: it is still being written.
void removeUnlessLocked(const std::string& path)
{
    constexpr int kFlags = O_NOFOLLOW | O_NONBLOCK | O_CLOEXEC;
    // The permissions of a left-over may be any: it may allow reading, or only writing.
    const int readable = open(path.c_str(), O_RDONLY | kFlags);
    const Descriptor file(readable >= 0 ? readable : open(path.c_str(), O_WRONLY | kFlags));
    // Nobody writes what nobody has locked: its program has died.
    if (file.number >= 0 && flock(file.number, LOCK_EX | LOCK_NB) == 0)
        unlink(path.c_str());
}

} // namespace

void AtomicFile::check(const std::string& path, Existing existing)
{
    struct stat status;
    if (!isThere<OpenError>(path, AT_SYMLINK_NOFOLLOW, path, kCannotOpen, &status)) {
        // An empty name is refused here: it would be found to be no name only after the writing.
        if (path.empty())
            failFor<OpenError>(path, kCannotOpen);
        return;
    }
    if (existing == Existing::kKeep)
        throw OpenError(path + kIsKept);
    // The link itself was looked at above; from here on it is the file behind it that counts.
    if (!isThere<OpenError>(path, 0, path, kCannotOpen, &status))
        return; // a link to a file that is yet to be made
    // Renaming would put a file in the place of a device or a pipe.
    if (!S_ISREG(status.st_mode))
        throw OpenError(path + ": is not an ordinary file");
    // It would also replace a file that its owner has protected.
    if (faccessat(AT_FDCWD, path.c_str(), W_OK, AT_EACCESS) != 0)
        failFor<OpenError>(path, kCannotOpen);
}

void AtomicFile::removeLeftOvers(const std::string& folder)
{
    std::error_code error;
    // An error ends the search and is nobody's failure: left-overs take room, and no more.
    for (fs::directory_iterator entry(folder, error); !error && entry != fs::directory_iterator();
         entry.increment(error)) {
        if (isTemporary(entry->path().filename().string()))
            removeUnlessLocked(entry->path());
    }
}

AtomicFile::AtomicFile(const std::string& path, Existing existing) : path_(path), existing_(existing)
{
    check(path, existing);
    // The links stay: it is the file behind them that is replaced.
    target_ = withoutLinks(path);
    create();
}

AtomicFile::~AtomicFile()
{
    // Not committed: nobody may find the temporary file. After a commit there is none.
    if (!temporary_.empty())
        unlink(temporary_.c_str());
    if (stream_ != nullptr)
        std::fclose(stream_);
}

void AtomicFile::create()
{
    const std::string folder = folderOf(target_);
    removeLeftOvers(folder);
    // Until it has the permissions of the file that it replaces, its contents are for nobody else.
    struct stat status;
    const bool isOld = isThere<OpenError>(target_, AT_SYMLINK_NOFOLLOW, path_, kCannotOpen, &status);
    // A file of a new name gets the permissions that the user's mask leaves.
    const mode_t mode = isOld ? 0600 : 0666;
    const int descriptor = createIn(folder, mode, &temporary_);
    if (descriptor < 0) {
        temporary_.clear();
        failFor<OpenError>(path_, "cannot be created");
    }
    // The stream closes the descriptor from here on, and with it gives back the lock.
    stream_ = fdopen(descriptor, "wb");
    if (stream_ == nullptr) {
        const int reason = errno;
        close(descriptor);
        unlink(temporary_.c_str());
        errno = reason;
        failFor<OpenError>(path_, "cannot be created");
    }
}

void AtomicFile::flush()
{
    // The reason of a write that failed earlier may be forgotten by now.
    if (std::ferror(stream_) != 0 && errno == 0)
        errno = EIO;
    // Until here the file is for its writer alone, if it replaces another one.
    keepPermissions();
    // A write that failed is remembered by the stream. Only what all three let pass is on the disk.
    if (std::ferror(stream_) != 0 || std::fflush(stream_) != 0 || fsync(fileno(stream_)) != 0)
        fail(kCannotWrite);
    // The content is on the disk; only the name is still that of the temporary file.
    flushed_ = true;
}

std::optional<FileStamp> AtomicFile::stamp() const
{
    return FileStamp::of(fileno(stream_));
}

bool AtomicFile::replaces() const
{
    struct stat status;
    return isThere<WriteError>(target_, AT_SYMLINK_NOFOLLOW, path_, kCannotWrite, &status);
}

void AtomicFile::commit()
{
    if (!flushed_)
        flush();
    // Before: the old file or none has the name. After: the new one has it, whole, and nothing is left to remove.
    giveName();
    temporary_.clear();
    // Closed only now, because that unlocks it.
    std::fclose(stream_);
    stream_ = nullptr;
    syncFolder(folderOf(target_));
}

void AtomicFile::keepPermissions() const
{
    struct stat former;
    if (existing_ != Existing::kReplace || !isThere<WriteError>(target_, 0, path_, kCannotWrite, &former))
        return;
    // Only the administrator can give a file away, but a user may set the group to another one of his own. Whatever of
    // this is refused does not fail the save.
    constexpr auto kSameOwner = static_cast<uid_t>(-1);
    const int file = fileno(stream_);
    mode_t mode = former.st_mode & 0777;
    if (fchown(file, former.st_uid, former.st_gid) != 0 && fchown(file, kSameOwner, former.st_gid) != 0)
        // Another group may do what everybody may.
        mode = (mode & ~static_cast<mode_t>(S_IRWXG)) | (mode & S_IRWXO) << 3;
    (void)fchmod(file, mode);
}

void AtomicFile::giveName()
{
    if (existing_ == Existing::kKeep) {
        // Unlike a rename, a link never replaces a file that has come up since the check.
        if (link(temporary_.c_str(), target_.c_str()) == 0) {
            unlink(temporary_.c_str());
            return;
        }
        struct stat status;
        if (lstat(target_.c_str(), &status) == 0)
            throw WriteError(path_ + kIsKept);
        // a file system without links
    }
    if (rename(temporary_.c_str(), target_.c_str()) != 0)
        fail("cannot be replaced");
}

void AtomicFile::fail(const char* what) const
{
    failFor<WriteError>(path_, what);
}
