#pragma once

#include <cctype>
#include <cstdio>
#include <cstdlib>
#include <string>
#include <string_view>
#include <utility>

/// The bytes that `text` spells: pairs of hex digits, and 'characters' between apostrophes; the rest separates.
inline std::string bytesOf(std::string_view text)
{
    std::string bytes;
    bool quoted = false;
    for (std::size_t i = 0; i < text.size(); ++i)
        if (text[i] == '\'')
            quoted = !quoted;
        else if (quoted)
            bytes += text[i];
        else if (std::isxdigit(static_cast<unsigned char>(text[i])) != 0)
            bytes += static_cast<char>(std::stoi(std::string(text.substr(i++, 2)), nullptr, 16));
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

/// What `object.wrt` puts into a file; whole files have a stamp besides.
template <class Object, class... Stamp>
std::string bytesWritten(const Object& object, const Stamp&... stamp)
{
    return written([&](FILE* file) { object.wrt(file, stamp...); });
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

private:
    std::string bytes_;
    FILE* file_;
};
