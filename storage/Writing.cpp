#include "storage/Writing.h"

#include "storage/AtomicFile.h"

#include <cerrno>
#include <cstring>

void failWriting(const std::string& path)
{
    throw AtomicFile::WriteError(
        path + ": cannot be written: " + (errno != 0 ? std::strerror(errno) : "not all of it can be saved"));
}

void fill(FILE* stream, const std::string& path, const FileWriter& write)
{
    errno = 0;
    if (write(stream) != 0 || std::ferror(stream) != 0)
        failWriting(path);
}

SizeSignalIgnored::SizeSignalIgnored()
{
    struct sigaction ignore {};
    ignore.sa_handler = SIG_IGN;
    sigaction(SIGXFSZ, &ignore, &former_);
}

SizeSignalIgnored::~SizeSignalIgnored()
{
    sigaction(SIGXFSZ, &former_, nullptr);
}
