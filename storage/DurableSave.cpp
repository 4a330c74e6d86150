#include "storage/DurableSave.h"

#include "storage/AtomicFile.h"

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <memory>
#include <stdexcept>
#include <sys/stat.h>
#include <unistd.h>

namespace {

bool isDevice(const std::string& path)
{
    struct stat status;
    if (stat(path.c_str(), &status) == 0)
        return S_ISCHR(status.st_mode);
    if (errno != ENOENT)
        throw AtomicFile::OpenError(path + ": cannot be opened: " + std::strerror(errno));
    return false;
}

/// A device has no contents that could be lost, and must not be replaced by a file. One that takes nothing for the
/// time being, such as a stopped terminal, fails the save instead of holding it up.
void writeDevice(const std::string& path, const DurableSave::Writer& write)
{
    const int descriptor = open(path.c_str(), O_WRONLY | O_NOCTTY | O_NONBLOCK | O_CLOEXEC);
    FILE* const opened = descriptor >= 0 ? fdopen(descriptor, "wb") : nullptr;
    if (opened == nullptr) {
        const int reason = errno;
        if (descriptor >= 0)
            close(descriptor);
        throw AtomicFile::OpenError(path + ": cannot be opened: " + std::strerror(reason));
    }
    const std::unique_ptr<FILE, int (*)(FILE*)> stream(opened, std::fclose);
    fill(opened, path, write);
    if (std::fflush(opened) != 0)
        failWriting(path);
}

DurableSave::Result failed(DurableSave::Outcome outcome, std::string reason)
{
    // File names may contain anything.
    std::ranges::replace_if(
        reason, [](char c) { return c >= 0 && c < ' '; }, ' ');
    return {outcome, reason, std::nullopt};
}

} // namespace

DurableSave::Result DurableSave::save(const std::string& path, const Writer& write,
                                      const std::optional<FileStamp>& former) const
{
    // For as long as the save lasts, and for the device as well.
    const SizeSignalIgnored ignored;
    try {
        if (!isDevice(path))
            return {Outcome::kSaved, "", replace(path, write, former)};
        writeDevice(path, write);
        return {Outcome::kSaved, "", std::nullopt};
    } catch (const AtomicFile::OpenError& error) {
        return failed(Outcome::kOpenFailed, error.what());
    } catch (const std::runtime_error& error) {
        return failed(Outcome::kWriteFailed, error.what());
    }
}

std::optional<FileStamp> DurableSave::replace(const std::string& path, const Writer& write,
                                              const std::optional<FileStamp>& former) const
{
    AtomicFile file(path, AtomicFile::Existing::kReplace);
    fill(file.stream(), path, write);
    // The old file is kept only when it is sure to be replaced, and as late as possible.
    file.flush();
    const auto stamp = file.stamp();
    const SaveLock lock(file.target(), folder_, patience_);
    // Asked under the lock: another program may have made or changed the file since this save began.
    if (former && FileStamp::of(file.target()) != former)
        throw AtomicFile::WriteError(path + ": another program has changed it meanwhile, so it is left as it is");
    if (!file.replaces()) {
        file.commit();
        return stamp;
    }
    // Before: the old file has its name and nobody else saves here. After `keep` it has a second name, in Backups,
    // which survives the commit.
    const KeptVersions versions(folder_);
    const std::string version = versions.keep(file.target());
    try {
        file.commit();
    } catch (const AtomicFile::WriteError&) {
        // The old file still has its name, and would be kept twice.
        versions.forget(version);
        throw;
    }
    versions.prune(file.target(), version);
    return stamp;
}
