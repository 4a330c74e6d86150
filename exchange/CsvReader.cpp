#include "exchange/CsvReader.h"

#include "storage/InputFile.h"

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <new>
#include <stdexcept>

CsvReader::CsvReader(const std::string& path, char separator)
    : path_(path), file_(gzdopen(openForReading(path), "rb"), gzclose), separator_(separator)
{
    if (file_ == nullptr)
        throw std::bad_alloc();
    constexpr unsigned kBuffer = 1U << 17; // bytes; the library's own 8 KiB make it slower
    gzbuffer(file_.get(), kBuffer);
}

bool CsvReader::next()
{
    while (readLine()) {
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

/// Of a line that is too long, one byte more than may be is kept.
bool CsvReader::readLine()
{
    // Afterwards `text_` is the line without its end, and `line_` its number.
    const gzFile file = file_.get();
    text_.clear();
    int c;
    while ((c = gzgetc(file)) >= 0 && c != '\n')
        if (text_.size() <= kLongestLine)
            text_ += static_cast<char>(c);
    int code = Z_OK;
    const char* reason = gzerror(file, &code);
    if (c < 0 && code != Z_OK && code != Z_STREAM_END)
        throw std::runtime_error(code == Z_ERRNO ? path_ + ": cannot be read: " + std::strerror(errno) : reason);
    // A last line without a line end counts; nothing behind the last line end is no line.
    if (c < 0 && text_.empty())
        return false;
    constexpr const char* kByteOrderMark = "\xEF\xBB\xBF";
    // The mark belongs to the file, not to its first heading.
    if (++line_ == 1 && text_.starts_with(kByteOrderMark))
        text_.erase(0, std::strlen(kByteOrderMark));
    if (text_.ends_with('\r'))
        text_.pop_back();
    // Once, for the whole file: a later line that has another separator is one with a single field.
    if (separator_ == '\0' && !text_.empty())
        guessSeparator();
    return true;
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
    if (text_.size() > kLongestLine)
        return false;
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
    return false;
}
