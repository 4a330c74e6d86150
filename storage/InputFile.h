#pragma once

#include <cstdio>
#include <memory>
#include <string>

/// Opens a file that a person has named. Only ordinary files, and links to them, are opened: reading anything else, a
/// pipe or a device, could take for ever, and opening it have effects. What is not opened throws std::runtime_error
/// with one line for the user.
/// @return the descriptor, which the caller closes.
int openForReading(const std::string& path);

/// A data file open for reading, by `openForReading`.
class InputFile {
public:
    explicit InputFile(const std::string& path);

    const std::string& path() const { return path_; }
    FILE* stream() const { return stream_.get(); }

private:
    std::string path_;
    std::unique_ptr<FILE, int (*)(FILE*)> stream_;
};
