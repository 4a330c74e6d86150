#pragma once

#include <cstdio>
#include <cstdlib>
#include <new>
#include <string>

/// What `write(FILE*)` writes, as bytes.
template <class Write>
std::string bytesWritten(Write write)
{
    char* buffer = nullptr;
    std::size_t size = 0;
    FILE* file = open_memstream(&buffer, &size);
    if (file == nullptr)
        throw std::bad_alloc();
    write(file);
    std::fclose(file); // `buffer` is whole from here on
    std::string bytes(buffer, size);
    std::free(buffer);
    return bytes;
}

/// Bytes, not none, to be read as a file. They outlive this.
class MemoryFile {
public:
    explicit MemoryFile(const std::string& bytes)
        : file_(fmemopen(const_cast<char*>(bytes.data()), bytes.size(), "rb")) // only read
    {
        if (file_ == nullptr)
            throw std::bad_alloc();
    }
    ~MemoryFile() { std::fclose(file_); }
    MemoryFile(const MemoryFile&) = delete;
    MemoryFile& operator=(const MemoryFile&) = delete;

    operator FILE*() const { return file_; }

private:
    FILE* file_;
};
