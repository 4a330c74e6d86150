#include "storage/SaveLock.h"

#include "storage/AtomicFile.h"
#include "storage/Folders.h"

#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <sys/file.h>
#include <thread>

namespace {

using Clock = std::chrono::steady_clock;

[[noreturn]] void failFor(const std::string& path, const std::string& reason)
{
    throw AtomicFile::WriteError(path + ": cannot be written: " + reason);
}

/// Locks what was opened as `descriptor`, or closes it. @return `descriptor`; -1 with errno set, ETIMEDOUT when
/// somebody else had it locked all the time.
int lockOpened(int descriptor, Clock::time_point end)
{
    constexpr std::chrono::milliseconds kPause(2);
    if (descriptor < 0)
        return -1;
    // Asked again and again, because a lock that is waited for has no time limit.
    while (flock(descriptor, LOCK_EX | LOCK_NB) != 0) {
        const int reason = errno;
        if (reason == EINTR || (reason == EWOULDBLOCK && Clock::now() < end)) {
            std::this_thread::sleep_for(kPause);
            continue;
        }
        close(descriptor);
        errno = reason == EWOULDBLOCK ? ETIMEDOUT : reason;
        return -1;
    }
    return descriptor;
}

/// Whether `reason` says that a folder is of the kind that cannot be locked. All who save there find it so.
bool isWithoutLocks(int reason)
{
    return reason == EACCES || reason == EBADF || reason == EINVAL || reason == ENOLCK || reason == ENOSYS ||
           reason == EOPNOTSUPP;
}

/// Locks the folder of `path`, or what stands in for it. Throws a WriteError when that fails. @return its descriptor.
int lockFor(const std::string& path, const DataFolder& folder, SaveLock::Patience patience)
{
    // One patience for both attempts.
    const Clock::time_point end = Clock::now() + patience;
    int descriptor = lockOpened(open(folderOf(path).c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC), end);
    if (descriptor < 0 && isWithoutLocks(errno)) {
        // Who may not look into the folder, and who saves where locks are unknown, meet at one file of the data folder.
        std::string error;
        const std::string file = folder.backups(&error) + "/.lock";
        if (!error.empty())
            failFor(path, error);
        descriptor = lockOpened(open(file.c_str(), O_RDWR | O_CREAT | O_NOFOLLOW | O_CLOEXEC, 0600), end);
    }
    if (descriptor < 0)
        failFor(path, errno == ETIMEDOUT ? "another program is saving in its folder and does not come to an end"
                                         : std::string("its folder cannot be locked: ") + std::strerror(errno));
    return descriptor;
}

} // namespace

SaveLock::SaveLock(const std::string& path, const DataFolder& folder, Patience patience)
    : descriptor_(lockFor(path, folder, patience))
{}
