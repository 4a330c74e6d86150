#include "exchange/CsvReader.h"

#include "exchange/TextForms.h"
#include "storage/InputFile.h"

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <filesystem>
#include <new>
#include <stdexcept>

CsvReader::CsvReader(const std::string& path, char separator)
    : path_(path), file_(gzdopen(openForReading(path), "rb"), gzclose), separator_(separator)
{
    if (file_ == nullptr)
        throw std::bad_alloc();
    constexpr unsigned kBuffer = 1U << 17; // bytes; the library's own 8 KiB make it slower
    gzbuffer(file_.get(), kBuffer);
    block_.resize(kBuffer);
    std::error_code error; // the size is for the progress only
    const auto size = std::filesystem::file_size(path, error);
    size_ = error || size == 0 ? 1 : static_cast<double>(size);
}

double CsvReader::progress() const
{
    return std::min(static_cast<double>(gzoffset(file_.get())) / size_, 1.0);
}

bool CsvReader::next()
{
    for (std::size_t blank = 0; readLine(); ++blank) {
        // A small zipped file may have gigabytes of them, which would keep the reader for minutes.
        if (blank == kMostBlank)
            fail("stands behind " + std::to_string(kMostBlank) + " empty lines: this is no table");
        // A malformed line is left without fields: the table tells it by its number and goes on.
        if (!split())
            fields_.clear();
        // Spreadsheets write lines of mere separators.
        const auto hasText = [](const std::string& field) { return !field.empty(); };
        if (fields_.empty() || std::ranges::any_of(fields_, hasText))
            return true;
    }
    return false;
}

void CsvReader::decode()
{
    const auto isAscii = [](char c) { return static_cast<unsigned char>(c) < 0x80; };
    if (std::ranges::all_of(text_, isAscii) || isUtf8(text_))
        return;
    for (std::string& field : fields_)
        field = fromWindows1252(field);
}

/// Afterwards `text_` is the line without its end, and `line_` its number.
bool CsvReader::readLine()
{
    text_.clear();
    ++line_;
    bool isEnded = false;
    while (!isEnded && (at_ < end_ || refill())) {
        const char* begin = block_.data() + at_;
        const void* found = std::memchr(begin, '\n', end_ - at_);
        isEnded = found != nullptr;
        const char* end = isEnded ? static_cast<const char*>(found) : block_.data() + end_;
        text_.append(begin, end);
        at_ += static_cast<std::size_t>(end - begin) + isEnded;
        // Now, and not at the line's end, which may be gigabytes away.
        checkText();
    }
    // A last line without a line end counts; nothing behind the last line end is no line.
    if (!isEnded && text_.empty())
        return false;
    constexpr const char* kByteOrderMark = "\xEF\xBB\xBF";
    // The mark belongs to the file, not to its first heading.
    if (line_ == 1 && text_.starts_with(kByteOrderMark))
        text_.erase(0, std::strlen(kByteOrderMark));
    if (text_.ends_with('\r'))
        text_.pop_back();
    // Once, for the whole file: a later line that has another separator is one with a single field.
    if (separator_ == '\0' && !text_.empty())
        guessSeparator();
    return true;
}

/// Reads the next bytes of the file. @return false at its end.
bool CsvReader::refill()
{
    const int got = gzread(file_.get(), block_.data(), static_cast<unsigned>(block_.size()));
    int code = Z_OK;
    const std::string_view reason = gzerror(file_.get(), &code);
    // Data that break off are given first, as far as they go; the error comes with them.
    if (code == Z_ERRNO)
        throw std::runtime_error(path_ + ": cannot be read: " + std::strerror(errno));
    if (code != Z_OK && code != Z_STREAM_END)
        throw std::runtime_error(path_ + ": is damaged or cut short" +
                                 std::string(reason.substr(std::min(reason.find(": "), reason.size()))));
    at_ = 0;
    end_ = got > 0 ? static_cast<std::size_t>(got) : 0;
    return end_ > 0;
}

/// Throws when what has come of the line so far is that of no table.
void CsvReader::checkText() const
{
    if (line_ == 1 && (text_.starts_with("\xFF\xFE") || text_.starts_with("\xFE\xFF")))
        fail("is UTF-16, and not UTF-8: save the table as UTF-8");
    if (text_.find('\0') != text_.npos)
        fail("has a zero byte: this is no table, or not in UTF-8");
    if (text_.size() > kLongestLine)
        fail("is longer than " + std::to_string(kLongestLine) + " bytes: this is no table");
}

void CsvReader::fail(const std::string& reason) const
{
    throw std::runtime_error(path_ + ", line " + std::to_string(line_) + ": " + reason);
}

/// Commas also stand within numbers, and semicolons within names: the rarest separator on the line wins.
void CsvReader::guessSeparator()
{
    // What stands in quotes is text, and no sign of a separator.
    std::string bare;
    bool quoted = false;
    for (const char c : text_) {
        quoted = quoted != (c == '"');
        if (!quoted)
            bare += c;
    }
    const std::size_t rarest = bare.find('\t') != bare.npos ? bare.find('\t') : bare.find(';');
    separator_ = rarest != bare.npos ? bare[rarest] : ',';
}

/// @return false for a malformed line.
bool CsvReader::split()
{
    fields_.clear();
    std::size_t at = 0;
    // At the beginning of each round `at` stands where a field begins, after it at a separator or the end.
    do {
        std::string& field = fields_.emplace_back();
        if (text_[at] == '"') {
            if (!takeQuoted(&at, &field))
                return false;
        } else {
            const std::size_t end = std::min(text_.find(separator_, at), text_.size());
            field.assign(text_, at, end - at);
            at = end;
        }
    } while (at++ < text_.size());
    return true;
}

/// Takes the text between the quotes at `*at`, which goes behind them. @return false when the field does not end there.
bool CsvReader::takeQuoted(std::size_t* at, std::string* field) const
{
    // `*at` stands on the opening quote. A quote within the text is written twice, which the inner step passes over.
    for (++*at; *at < text_.size(); ++*at) {
        if (text_[*at] == '"' && text_[++*at] != '"') // two stand for one
            return *at == text_.size() || text_[*at] == separator_;
        *field += text_[*at];
    }
    // Text that goes on over the line's end is nothing that a table of days has. More likely a quote stands by itself,
    // and it would take all that follows with it.
    fail("has a quote that is not closed");
}
