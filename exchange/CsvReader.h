#pragma once

#include <cstddef>
#include <memory>
#include <string>
#include <vector>
#include <zlib.h>

/// The records of a CSV file, plain or gzipped: one a line, with fields that may be quoted as in RFC 4180.
///
/// The separator - tab, ';' or ',' - is guessed from the first record. A byte order mark in front and CR LF line ends
/// are taken. A file that cannot be opened or read to its end throws std::runtime_error with one line for the user.
class CsvReader {
public:
    /// @param separator '\0' to guess it.
    explicit CsvReader(const std::string& path, char separator = '\0');

    /// Goes to the next line that has a text in any field. @return false at the end of the file.
    bool next();

    /// The fields of the line, without their quotes. None when the line is malformed: a quote is not closed, or not at
    /// the end of its field, or the line is longer than `kLongestLine`.
    const std::vector<std::string>& fields() const { return fields_; }
    /// The number of the line, counted from 1.
    unsigned long line() const { return line_; }
    char separator() const { return separator_; }

    static constexpr std::size_t kLongestLine = std::size_t{1} << 16; // bytes

private:
    bool readLine();
    void guessSeparator();
    bool split();
    bool takeQuoted(std::size_t* at, std::string* field) const;

    std::string path_;
    std::unique_ptr<gzFile_s, int (*)(gzFile)> file_;
    char separator_; // '\0' as long as it is not known
    unsigned long line_ = 0;
    std::string text_; // of the line
    std::vector<std::string> fields_;
};
