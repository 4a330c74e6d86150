#pragma once

#include <ctime>
#include <optional>
#include <string>
#include <sys/types.h>

/// What tells the state that a file is in from any other one: which file it is, how long it is, and when it was last
/// written, to the nanosecond.
struct FileStamp {
    /// Of an open file. Nothing when it cannot be looked at, or is no ordinary file.
    static std::optional<FileStamp> of(int descriptor);
    /// Of the file at `path`, links followed. Nothing when there is none, too.
    static std::optional<FileStamp> of(const std::string& path);

    bool operator==(const FileStamp&) const = default;

    dev_t device;
    ino_t inode;
    off_t size;
    std::time_t seconds;
    long nanoseconds;
};
