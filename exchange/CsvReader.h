#pragma once

#include <cstddef>
#include <memory>
#include <string>
#include <vector>
#include <zlib.h>

/// The records of a CSV file, plain or gzipped: one a line, with fields that may be quoted as in RFC 4180.
///
/// The separator - tab, ';' or ',' - is guessed from the first record. A byte order mark of UTF-8 in front and CR LF
/// line ends are taken. A file that is no such text throws std::runtime_error with one line for the user: one that
/// cannot be opened or read to its end, that has zero bytes, as UTF-16 has, or a line longer than `kLongestLine`,
/// `kMostBlank` lines without text in a row, or a quote that is not closed on its line. Whatever the file is, no more
/// than a line of it is held.
class CsvReader {
public:
    /// @param separator '\0' to guess it.
    explicit CsvReader(const std::string& path, char separator = '\0');

    /// Goes to the next line that has a text in any field. @return false at the end of the file.
    bool next();

    /// Makes UTF-8 of the fields of a line that is none, and so is in Windows-1252.
    void decode();
    /// The fields of the line, without their quotes. None when the line is malformed: a quote is not closed at the end
    /// of its field.
    const std::vector<std::string>& fields() const { return fields_; }
    /// The number of the line, counted from 1.
    unsigned long line() const { return line_; }
    char separator() const { return separator_; }
    /// How much of the file has been read, from 0 to 1.
    double progress() const;

    static constexpr std::size_t kMostBlank = 1'000'000;
    static constexpr std::size_t kLongestLine = std::size_t{1} << 20; // bytes; a column each for 100,000 shares

private:
    bool readLine();
    bool refill();
    void checkText() const;
    void guessSeparator();
    bool split();
    bool takeQuoted(std::size_t* at, std::string* field) const;
    [[noreturn]] void fail(const std::string& reason) const;

    std::string path_;
    std::unique_ptr<gzFile_s, int (*)(gzFile)> file_;
    double size_ = 1;   // of the file on the disk, in bytes
    std::string block_; // bytes that were read, up to `end_`; those from `at_` on are yet to be looked at
    std::size_t at_ = 0;
    std::size_t end_ = 0;
    char separator_; // '\0' as long as it is not known
    unsigned long line_ = 0;
    std::string text_; // of the line
    std::vector<std::string> fields_;
};
