#include "storage/Folders.h"

#include "storage/Descriptor.h"

#include <cerrno>
#include <fcntl.h>
#include <filesystem>
#include <sys/stat.h>
#include <unistd.h>

std::string folderOf(const std::string& path)
{
    const std::string folder = std::filesystem::path(path).parent_path().string();
    return folder.empty() ? "." : folder;
}

std::error_code makeFolders(const std::string& path, mode_t mode)
{
    struct stat status;
    if (stat(path.c_str(), &status) == 0)
        return S_ISDIR(status.st_mode) ? std::error_code() : std::make_error_code(std::errc::not_a_directory);
    // Nothing of this name can be seen. The folders above are made first, each with its entry on the disk.
    const std::string above = folderOf(path);
    if (errno == ENOENT && above != path)
        if (const std::error_code error = makeFolders(above, mode))
            return error;
    // Somebody else may have made it in the meantime.
    if (mkdir(path.c_str(), mode) != 0 && errno != EEXIST)
        return {errno, std::generic_category()};
    syncFolder(above);
    // A link that leads nowhere has its name taken, too, but is no folder.
    if (stat(path.c_str(), &status) != 0)
        return {errno, std::generic_category()};
    return {};
}

void syncFolder(const std::string& path)
{
    // Where it cannot be opened there is nothing to bring to the disk: the call below fails, and nobody minds.
    const Descriptor folder(open(path.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC));
    (void)fsync(folder.number);
}
