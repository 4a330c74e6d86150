#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>
#include <zlib.h>

/// The records of a CSV file (RFC 4180), plain or gzipped, one after the other.
///
/// The separator - tab, ';' or ',' - is guessed from the first line. A byte order mark in front and CR LF line ends are
/// taken, blank lines left out. A file that cannot be opened or read to its end throws std::runtime_error with one line
/// for the user.
class CsvReader {
public:
    enum class Outcome { kRecord, kMalformed, kEnd };

    explicit CsvReader(const std::string& path);
    ~CsvReader();
    CsvReader(const CsvReader&) = delete;
    CsvReader& operator=(const CsvReader&) = delete;

    /// Goes to the next record. A malformed one - a quote that is not closed, or not at the end of its field, or a
    /// record longer than `kLongestRecord` - costs a single line: reading goes on with the line after that.
    Outcome next();

    /// The fields of the record, without their quotes; valid until the next call of `next`. None when malformed.
    const std::vector<std::string_view>& fields() const { return fields_; }
    /// The line, counted from 1, on which the record begins. A quoted field may stretch over more lines.
    unsigned long line() const { return line_; }
    char separator() const { return separator_; }

    static constexpr std::size_t kLongestRecord = std::size_t{1} << 18; // bytes

private:
    static constexpr int kEndOfFile = -1;
    static constexpr std::size_t kTooLong = ~std::size_t{0};

    void skipByteOrderMark();
    void guessSeparator();

    bool splitPlain();
    bool splitQuoted();
    bool takeQuotedField(std::size_t* at);
    void takeBareField(std::size_t* at);
    void skipLine();
    bool isBlank() const;

    std::size_t lineEnd();
    int peek(std::size_t at);
    bool fill();

    std::string path_;
    gzFile file_;
    std::vector<char> buffer_;
    std::size_t begin_ = 0; // of the record in the buffer; the private functions count from here
    std::size_t end_ = 0;   // of what was read
    bool ended_ = false;    // the file has no more

    char separator_ = ',';
    std::size_t length_ = 0; // of the record with its line end
    unsigned long line_ = 0;
    unsigned long linesInRecord_ = 1;
    std::vector<std::string_view> fields_;
    std::string unquoted_;               // the fields of a record with quotes, one behind the other,
    std::vector<std::size_t> fieldEnds_; // and where in it each ends
};
