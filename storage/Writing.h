#pragma once

#include <csignal>
#include <cstdio>
#include <functional>
#include <string>

/// Writes what a file is to hold, perhaps nothing. @return 0, or -1 when that failed.
using FileWriter = std::function<int(FILE*)>;

/// Lets `write` write to `stream`. Throws an AtomicFile::WriteError for `path` when that fails.
void fill(FILE* stream, const std::string& path, const FileWriter& write);

/// Throws an AtomicFile::WriteError for `path` with the reason in errno, or without one when that is 0.
[[noreturn]] void failWriting(const std::string& path);

/// As long as this object is there, a file that grows past the user's limit is a failed write, not the end of the
/// program.
class SizeSignalIgnored {
public:
    SizeSignalIgnored();
    ~SizeSignalIgnored();
    SizeSignalIgnored(const SizeSignalIgnored&) = delete;
    SizeSignalIgnored& operator=(const SizeSignalIgnored&) = delete;

private:
    struct sigaction former_ {};
};
