#include "storage/InputFile.h"

#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <new>
#include <stdexcept>
#include <sys/stat.h>
#include <unistd.h>

namespace {

/// What is wrong with a file of this status; null for an ordinary one.
const char* oddityOf(const struct stat& status)
{
    if (S_ISREG(status.st_mode))
        return nullptr;
    return S_ISDIR(status.st_mode) ? "is a folder" : "is not an ordinary file";
}

} // namespace

int openForReading(const std::string& path)
{
    // Opening alone may do harm: it lets a pipe's writer go on, who then writes to nobody, and some devices start.
    struct stat status {};
    if (const char* oddity = stat(path.c_str(), &status) == 0 ? oddityOf(status) : nullptr)
        throw std::runtime_error(path + ": " + oddity);
    // By now it could be something else, so it is looked at again once it is open. To an ordinary file the flags mean
    // nothing; without them opening a pipe would wait for a writer, and a terminal could become the program's own.
    const int descriptor = open(path.c_str(), O_RDONLY | O_NONBLOCK | O_NOCTTY | O_CLOEXEC);
    if (descriptor < 0)
        throw std::runtime_error(path + ": cannot be opened: " + std::strerror(errno));
    const char* oddity = fstat(descriptor, &status) == 0 ? oddityOf(status) : "cannot be looked at";
    if (oddity == nullptr)
        return descriptor;
    close(descriptor);
    throw std::runtime_error(path + ": " + oddity);
}

InputFile::InputFile(const std::string& path) : path_(path), stream_(fdopen(openForReading(path), "rb"), std::fclose)
{
    // The file is open by now: all that can be missing is the memory for a stream.
    if (stream_ == nullptr)
        throw std::bad_alloc();
}
