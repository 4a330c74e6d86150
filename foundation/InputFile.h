#pragma once

#include <cstdio>
#include <string>

/// A data file open for reading. What cannot be opened throws std::runtime_error with one line for the user.
class InputFile {
public:
    explicit InputFile(const std::string& path);
    ~InputFile();
    InputFile(const InputFile&) = delete;
    InputFile& operator=(const InputFile&) = delete;

    const std::string& path() const { return path_; }
    FILE* stream() const { return stream_; }

private:
    std::string path_;
    FILE* stream_;
};
