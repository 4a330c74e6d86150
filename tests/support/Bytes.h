#pragma once

#include <cctype>
#include <cstdio>
#include <cstdlib>
#include <string>
#include <string_view>
#include <utility>

/// The bytes that `text` spells: pairs of hex digits, and 'characters' between apostrophes; the rest only separates.
inline std::string bytesOf(std::string_view text)
{
    std::string bytes;
    std::string digits;
    bool quoted = false;
    for (const char c : text) {
        if (c == '\'')
            quoted = !quoted;
        else if (quoted)
            bytes += c;
        else if (std::isxdigit(static_cast<unsigned char>(c)) != 0)
            digits += c;
        if (digits.size() == 2) {
            bytes += static_cast<char>(std::stoi(digits, nullptr, 16));
            digits.clear();
        }
    }
    return bytes;
}

/// What `write(FILE*)` puts into a file.
template <class Write>
std::string written(Write write)
{
    char* buffer = nullptr;
    std::size_t size = 0;
    FILE* file = open_memstream(&buffer, &size);
    write(file);
    std::fclose(file);
    std::string bytes(buffer, size);
    std::free(buffer);
    return bytes;
}

/// What `object.wrt` puts into a file.
template <class Object>
std::string bytesWritten(const Object& object)
{
    return written([&object](FILE* file) { object.wrt(file); });
}

/// A file of these bytes, open for reading.
class BytesFile {
public:
    explicit BytesFile(std::string bytes)
        : bytes_(std::move(bytes)), file_(fmemopen(bytes_.data(), bytes_.size(), "rb"))
    {}
    ~BytesFile() { std::fclose(file_); }
    BytesFile(const BytesFile&) = delete;
    BytesFile& operator=(const BytesFile&) = delete;

    operator FILE*() const { return file_; }
    long position() const { return std::ftell(file_); }

private:
    std::string bytes_;
    FILE* file_;
};
