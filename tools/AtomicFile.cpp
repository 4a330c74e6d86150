#include "tools/AtomicFile.h"

#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <filesystem>
#include <stdexcept>
#include <sys/stat.h>
#include <unistd.h>

namespace {

std::string withoutLinks(const std::string& path)
{
    std::error_code error;
    const auto target = std::filesystem::canonical(path, error);
    return error ? path : target.string();
}

std::string folderOf(const std::string& path)
{
    const std::string folder = std::filesystem::path(path).parent_path().string();
    return folder.empty() ? "." : folder;
}

[[noreturn]] void failForExisting(const std::string& path)
{
    throw std::runtime_error(path + ": exists already and is left as it is");
}

/// Creates a file in the folder of `target`. @return its descriptor, with `*name` set; -1 with errno set.
int createBeside(const std::string& target, std::string* name)
{
    // A name of its own length, since that of the target may already be as long as the file system allows.
    const std::string stem = folderOf(target) + "/.pelorin-" + std::to_string(getpid()) + "-";
    constexpr int kAttempts = 100; // a crash may have left such a file behind
    int descriptor = -1;
    for (int i = 0; i < kAttempts; ++i) {
        *name = stem + std::to_string(i) + ".tmp";
        descriptor = open(name->c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, 0666);
        if (descriptor >= 0 || errno != EEXIST)
            break;
    }
    return descriptor;
}

} // namespace

void AtomicFile::check(const std::string& path, Existing existing)
{
    struct stat status;
    if (lstat(path.c_str(), &status) != 0)
        return;
    if (existing == Existing::kKeep)
        failForExisting(path);
    // Renaming would put a file in the place of a device or a pipe.
    if (stat(path.c_str(), &status) == 0 && !S_ISREG(status.st_mode))
        throw std::runtime_error(path + ": is not an ordinary file");
}

AtomicFile::AtomicFile(const std::string& path, Existing existing)
    : path_(path), target_(withoutLinks(path)), existing_(existing)
{
    check(path, existing);
    create();
}

AtomicFile::~AtomicFile()
{
    if (stream_ != nullptr)
        std::fclose(stream_);
    if (!temporary_.empty())
        unlink(temporary_.c_str());
}

void AtomicFile::create()
{
    const int descriptor = createBeside(target_, &temporary_);
    if (descriptor < 0)
        fail("cannot be created");
    stream_ = fdopen(descriptor, "wb");
    if (stream_ == nullptr) {
        close(descriptor);
        unlink(temporary_.c_str());
        fail("cannot be created");
    }
}

void AtomicFile::commit()
{
    keepPermissions();
    flushAndClose();
    giveName();
    temporary_.clear();
    // The name itself is on the disk only when the folder is. Some file systems cannot do that; the file is whole
    // anyway.
    const int folder = open(folderOf(target_).c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
    if (folder >= 0) {
        (void)fsync(folder);
        close(folder);
    }
}

void AtomicFile::keepPermissions() const
{
    struct stat status;
    if (existing_ == Existing::kReplace && stat(target_.c_str(), &status) == 0)
        (void)fchmod(fileno(stream_), status.st_mode & 07777);
}

void AtomicFile::flushAndClose()
{
    const bool written = std::ferror(stream_) == 0 && std::fflush(stream_) == 0 && fsync(fileno(stream_)) == 0;
    const int reason = errno;
    const bool closed = std::fclose(stream_) == 0;
    stream_ = nullptr;
    if (!written)
        errno = reason;
    if (!written || !closed)
        fail("cannot be written");
}

void AtomicFile::giveName()
{
    if (existing_ == Existing::kKeep) {
        // Unlike a rename, a link never replaces a file that has come up since the check.
        if (link(temporary_.c_str(), target_.c_str()) == 0) {
            unlink(temporary_.c_str());
            return;
        }
        if (errno == EEXIST)
            failForExisting(path_);
        check(path_, existing_); // a file system without links
    }
    if (rename(temporary_.c_str(), target_.c_str()) != 0)
        fail("cannot be replaced");
}

void AtomicFile::fail(const char* what) const
{
    throw std::runtime_error(path_ + ": " + what + ": " + std::strerror(errno));
}
