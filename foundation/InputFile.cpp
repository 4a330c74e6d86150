#include "foundation/InputFile.h"

#include <cerrno>
#include <cstring>
#include <stdexcept>
#include <sys/stat.h>

InputFile::InputFile(const std::string& path) : path_(path), stream_(std::fopen(path.c_str(), "rb"))
{
    if (stream_ == nullptr)
        throw std::runtime_error(path + ": cannot be opened: " + std::strerror(errno));
    struct stat status;
    // A folder can be opened; only reading it fails.
    if (fstat(fileno(stream_), &status) == 0 && S_ISDIR(status.st_mode)) {
        std::fclose(stream_);
        throw std::runtime_error(path + ": is a folder");
    }
}

InputFile::~InputFile()
{
    std::fclose(stream_);
}
