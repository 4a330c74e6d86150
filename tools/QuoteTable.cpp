#include "tools/QuoteTable.h"

#include "exchange/MarketImport.h"
#include "exchange/Table.h"
#include "storage/AtomicFile.h"
#include "storage/FileStamp.h"
#include "storage/InputFile.h"
#include "storage/Writing.h"

#include <algorithm>
#include <cstdio>
#include <stdexcept>
#include <vector>

namespace {

std::string bytesOf(const std::filesystem::path& path)
{
    const InputFile file(path);
    std::string bytes;
    char block[1 << 14];
    while (const std::size_t count = std::fread(block, 1, sizeof block, file.stream()))
        bytes.append(block, count);
    if (std::ferror(file.stream()) != 0)
        throw std::runtime_error(path.string() + ": cannot be read");
    return bytes;
}

std::string isoText(const Date& day)
{
    char text[32];
    std::snprintf(text, sizeof text, "%04d-%02d-%02d", day.getYear(), day.getMonth(), day.getDay());
    return text;
}

/// How the lines of a table are laid out, and what they say.
class Layout {
public:
    /// That of a table that is new.
    Layout() = default;
    /// That of a table that is there.
    Layout(const std::filesystem::path& file, const std::string& bytes)
    {
        // The reader takes it as it is, but a line that is added would not be compressed.
        if (bytes.starts_with("\x1F\x8B"))
            throw std::runtime_error(file.string() + ": is compressed, and nothing can be added to it");
        Table table(file, kQuotesOfOneTicker);
        table.forEach([&] { closes_.insert_or_assign(table.date(), table.value(false)); }, {});
        if (table.separator() != '\0')
            separator_ = table.separator();
        if (table.decimalMark() != '\0')
            decimalMark_ = table.decimalMark();
        columns_ = std::max(table.headings().size(), columns_);
        date_ = table.index(Column::kDate);
        close_ = table.index(Column::kValue);
        hasTicker_ = table.has(Column::kTicker);
        ticker_ = hasTicker_ ? table.index(Column::kTicker) : 0;
        lineEnd_ = bytes.find("\r\n") != bytes.npos ? "\r\n" : "\n";
    }

    bool has(const Date& day, float close) const
    {
        const auto there = closes_.find(day);
        return there != closes_.end() && there->second == close;
    }

    std::string line(const std::string& ticker, const Date& day, float close) const
    {
        std::vector<std::string> cells(columns_);
        if (hasTicker_)
            cells[ticker_] = ticker;
        cells[date_] = isoText(day);
        cells[close_] = shortestText(close, std::chars_format::fixed);
        std::ranges::replace(cells[close_], '.', decimalMark_);
        std::string text = cells.front();
        for (std::size_t i = 1; i < cells.size(); ++i)
            (text += separator_) += cells[i];
        return text + lineEnd_;
    }

    const char* lineEnd() const { return lineEnd_; }

private:
    Closes closes_;
    char separator_ = ',';
    char decimalMark_ = '.';
    std::size_t columns_ = 2;
    std::size_t date_ = 0;
    std::size_t close_ = 1;
    std::size_t ticker_ = 0;
    bool hasTicker_ = false;
    const char* lineEnd_ = "\n";
};

} // namespace

void addToQuoteTable(const std::filesystem::path& file, const std::string& ticker, const Closes& closes)
{
    const auto stamp = FileStamp::of(file.string());
    std::error_code error; // of what cannot be looked at; opening it tells
    const bool isThere = std::filesystem::exists(file, error) || error;
    std::string bytes = isThere ? bytesOf(file) : std::string();
    const bool isNew = bytes.find_first_not_of(" \t\r\n") == bytes.npos;
    const Layout layout = isNew ? Layout() : Layout(file, bytes);
    if (isNew)
        bytes = "Date,Close\n";
    if (!bytes.ends_with('\n'))
        bytes += layout.lineEnd();
    // From here on every line of `bytes` has its end.
    const std::size_t whole = bytes.size();
    for (const auto& [day, close] : closes)
        if (!layout.has(day, close))
            bytes += layout.line(ticker, day, close);
    if (bytes.size() == whole)
        return;
    AtomicFile table(file, AtomicFile::Existing::kReplace);
    if (std::fwrite(bytes.data(), 1, bytes.size(), table.stream()) != bytes.size())
        failWriting(file);
    // To the disk, which takes its time, and only then the look whether somebody else has written meanwhile.
    table.flush();
    if (FileStamp::of(file.string()) != stamp)
        throw std::runtime_error(file.string() + ": another program has changed it meanwhile, so it is left as it is");
    table.commit();
}
