#include "foundation/InputFile.h"

#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <new>
#include <stdexcept>
#include <sys/stat.h>
#include <unistd.h>

namespace {

/// What is wrong with the open file; null for an ordinary one.
const char* oddityOf(int descriptor)
{
    struct stat status {};
    if (fstat(descriptor, &status) == 0 && S_ISREG(status.st_mode))
        return nullptr;
    return S_ISDIR(status.st_mode) ? "is a folder" : "is not an ordinary file";
}

} // namespace

int openForReading(const std::string& path)
{
    // Opening a pipe would wait for a writer, and a terminal could become the program's own. The file is looked at once
    // it is open: by its path it could be another one by then. To an ordinary file the flags mean nothing.
    const int descriptor = open(path.c_str(), O_RDONLY | O_NONBLOCK | O_NOCTTY | O_CLOEXEC);
    if (descriptor < 0 && errno != ENXIO) // which is what a socket gives
        throw std::runtime_error(path + ": cannot be opened: " + std::strerror(errno));
    const char* oddity = descriptor < 0 ? "is not an ordinary file" : oddityOf(descriptor);
    if (oddity == nullptr)
        return descriptor;
    if (descriptor >= 0)
        close(descriptor);
    throw std::runtime_error(path + ": " + oddity);
}

InputFile::InputFile(const std::string& path) : path_(path), stream_(fdopen(openForReading(path), "rb"))
{
    if (stream_ == nullptr)
        throw std::bad_alloc();
}

InputFile::~InputFile()
{
    std::fclose(stream_);
}
