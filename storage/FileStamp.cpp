#include "storage/FileStamp.h"

#include <sys/stat.h>

namespace {

std::optional<FileStamp> stampOf(const struct stat& status)
{
    if (!S_ISREG(status.st_mode))
        return std::nullopt;
    return FileStamp{status.st_dev, status.st_ino, status.st_size, status.st_mtim.tv_sec, status.st_mtim.tv_nsec};
}

} // namespace

std::optional<FileStamp> FileStamp::of(int descriptor)
{
    struct stat status;
    return fstat(descriptor, &status) == 0 ? stampOf(status) : std::nullopt;
}

std::optional<FileStamp> FileStamp::of(const std::string& path)
{
    struct stat status;
    return stat(path.c_str(), &status) == 0 ? stampOf(status) : std::nullopt;
}
