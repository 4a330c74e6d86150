#include "tools/CsvReader.h"

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <stdexcept>

CsvReader::CsvReader(const std::string& path) : path_(path), file_(gzopen(path.c_str(), "rb")), buffer_(kLongestRecord)
{
    if (file_ == nullptr)
        throw std::runtime_error(path + ": cannot be opened: " + std::strerror(errno));
    constexpr unsigned kCompressedBuffer = 1U << 17; // bytes; the library's own 8 KiB make it slower
    gzbuffer(file_, kCompressedBuffer);
    try {
        fill();
        skipByteOrderMark();
        guessSeparator();
    } catch (...) {
        gzclose(file_);
        throw;
    }
}

CsvReader::~CsvReader()
{
    gzclose(file_);
}

void CsvReader::skipByteOrderMark()
{
    constexpr std::string_view kMark = "\xEF\xBB\xBF";
    if (std::string_view(buffer_.data(), end_).starts_with(kMark))
        begin_ = kMark.size();
}

/// Commas also stand within numbers, and semicolons within names: the rarest separator on the first line wins.
void CsvReader::guessSeparator()
{
    std::string_view line(buffer_.data() + begin_, end_ - begin_);
    line.remove_prefix(std::min(line.size(), line.find_first_not_of("\r\n")));
    bool quoted = false, tab = false, semicolon = false;
    for (const char c : line.substr(0, line.find('\n'))) {
        if (c == '"')
            quoted = !quoted;
        tab = tab || (!quoted && c == '\t');
        semicolon = semicolon || (!quoted && c == ';');
    }
    separator_ = tab ? '\t' : semicolon ? ';' : ',';
}

CsvReader::Outcome CsvReader::next()
{
    do {
        begin_ += length_;
        line_ += linesInRecord_;
        linesInRecord_ = 1;
        fields_.clear();
        length_ = lineEnd();
        if (length_ == 0)
            return Outcome::kEnd;
        if (length_ == kTooLong || (!splitPlain() && !splitQuoted())) {
            fields_.clear();
            linesInRecord_ = 1;
            skipLine();
            return Outcome::kMalformed;
        }
    } while (isBlank());
    return Outcome::kRecord;
}

/// Splits a line without quotes. @return false for one that has any.
bool CsvReader::splitPlain()
{
    std::string_view line(buffer_.data() + begin_, length_);
    if (line.find('"') != line.npos)
        return false;
    if (line.ends_with('\n'))
        line.remove_suffix(1);
    if (line.ends_with('\r'))
        line.remove_suffix(1);
    std::size_t end;
    while ((end = line.find(separator_)) != line.npos) {
        fields_.push_back(line.substr(0, end));
        line.remove_prefix(end + 1);
    }
    fields_.push_back(line);
    return true;
}

/// Splits a record that may have quoted fields, and so line ends within. @return false when it is malformed.
bool CsvReader::splitQuoted()
{
    unquoted_.clear();
    fieldEnds_.clear();
    std::size_t at = 0;
    for (bool more = true; more; ++at) {
        if (peek(at) != '"')
            takeBareField(&at);
        else if (!takeQuotedField(&at))
            return false;
        fieldEnds_.push_back(unquoted_.size());
        if (peek(at) == '\r' && peek(at + 1) == '\n')
            ++at;
        const int behind = peek(at);
        more = behind == separator_;
        if (!more && behind != '\n' && (behind != kEndOfFile || !ended_))
            return false;
    }
    length_ = std::min(at, end_ - begin_); // the end of the file takes no place
    std::size_t start = 0;
    for (const std::size_t end : fieldEnds_) {
        fields_.push_back(std::string_view(unquoted_).substr(start, end - start));
        start = end;
    }
    return true;
}

/// Takes the text between the quotes at `*at`, which goes behind them. @return false without a closing one.
bool CsvReader::takeQuotedField(std::size_t* at)
{
    for (int c = peek(++*at); c != kEndOfFile; c = peek(++*at)) {
        if (c == '"' && peek(++*at) != '"') // two stand for one
            return true;
        if (c == '\n')
            ++linesInRecord_;
        unquoted_ += static_cast<char>(c);
    }
    return false;
}

void CsvReader::takeBareField(std::size_t* at)
{
    for (int c = peek(*at); c != separator_ && c != '\n' && c != kEndOfFile; c = peek(++*at)) {
        if (c != '\r' || peek(*at + 1) != '\n')
            unquoted_ += static_cast<char>(c);
    }
}

/// Leaves out the line at the record's beginning, however long it is.
void CsvReader::skipLine()
{
    while ((length_ = lineEnd()) == kTooLong)
        begin_ = end_;
}

/// Whether no field has a text: spreadsheets write lines of mere separators.
bool CsvReader::isBlank() const
{
    return std::all_of(fields_.begin(), fields_.end(), [](std::string_view field) { return field.empty(); });
}

/// The length of the next line with its line end; 0 at the end of the file, `kTooLong` when it does not fit.
std::size_t CsvReader::lineEnd()
{
    for (std::size_t searched = 0;;) {
        const std::size_t present = end_ - begin_;
        const char* from = buffer_.data() + begin_ + searched;
        if (const void* found = std::memchr(from, '\n', present - searched))
            return searched + static_cast<std::size_t>(static_cast<const char*>(found) - from) + 1;
        searched = present;
        if (!fill())
            return ended_ ? present : kTooLong;
    }
}

/// The byte at `at` of the record; `kEndOfFile` behind the last one and where the record is too long.
int CsvReader::peek(std::size_t at)
{
    while (begin_ + at >= end_)
        if (!fill())
            return kEndOfFile;
    return static_cast<unsigned char>(buffer_[begin_ + at]);
}

/// Reads on behind what is there. @return false when there is no more, or no room.
bool CsvReader::fill()
{
    if (begin_ > 0)
        std::memmove(buffer_.data(), buffer_.data() + begin_, end_ - begin_);
    end_ -= begin_;
    begin_ = 0;
    if (ended_ || end_ == buffer_.size())
        return false;
    const int count = gzread(file_, buffer_.data() + end_, static_cast<unsigned>(buffer_.size() - end_));
    int code = Z_OK;
    const char* reason = gzerror(file_, &code);
    if (count < 0 || (count == 0 && code == Z_BUF_ERROR)) // the latter: compressed data that end too early
        throw std::runtime_error(code == Z_ERRNO ? path_ + ": cannot be read: " + std::strerror(errno) : reason);
    ended_ = count == 0;
    end_ += static_cast<std::size_t>(count);
    return !ended_;
}
