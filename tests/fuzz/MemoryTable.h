#pragma once

#include "tests/fuzz/Require.h"

#include <string>
#include <string_view>
#include <sys/mman.h>
#include <unistd.h>

/// A file of these bytes, in memory, which still has a path.
class MemoryTable {
public:
    explicit MemoryTable(std::string_view bytes) : descriptor_(memfd_create("table", MFD_CLOEXEC))
    {
        require(write(descriptor_, bytes.data(), bytes.size()) == static_cast<ssize_t>(bytes.size()),
                "there is memory for the file");
    }
    ~MemoryTable() { close(descriptor_); }
    MemoryTable(const MemoryTable&) = delete;
    MemoryTable& operator=(const MemoryTable&) = delete;

    std::string path() const { return "/proc/self/fd/" + std::to_string(descriptor_); }

private:
    int descriptor_;
};
