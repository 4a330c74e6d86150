#include "exchange/CsvWriter.h"

#include "exchange/CsvReader.h"
#include "storage/InputFile.h"
#include "storage/Writing.h"

#include <filesystem>
#include <stdexcept>

namespace {

void putCell(std::string* line, const std::string& cell)
{
    if (cell.find_first_of(",;\t\"\r\n") == cell.npos) {
        *line += cell;
        return;
    }
    *line += '"';
    for (const char c : cell) {
        *line += c;
        if (c == '"')
            *line += c;
    }
    *line += '"';
}

void putRow(std::string* line, const std::vector<std::string>& cells)
{
    line->clear();
    for (const std::string& cell : cells) {
        if (&cell != &cells.front())
            *line += ',';
        putCell(line, cell);
    }
    *line += '\n';
}

/// `path`, when a table with these headings may stand there.
const std::string& checked(const std::string& path, const std::vector<std::string>& headings)
{
    std::string line;
    putRow(&line, headings);
    line.pop_back();
    checkReplaceable(path, line);
    return path;
}

} // namespace

void checkReplaceable(const std::string& path, std::string_view firstLine)
{
    std::error_code error; // of a folder that cannot be searched; making the file tells it
    if (!std::filesystem::exists(std::filesystem::symlink_status(path, error)))
        return;
    const InputFile file(path);
    std::string line(firstLine.size() + 1, '\0');
    line.resize(std::fread(line.data(), 1, line.size(), file.stream()));
    const bool isSuch = line.starts_with(firstLine) && (line.size() == firstLine.size() || line.back() == '\n');
    if (!line.empty() && !isSuch)
        throw std::runtime_error(path + ": is there already, was not made by an export, and is left as it is");
}

CsvWriter::CsvWriter(const std::string& path, const std::vector<std::string>& headings, Foreign foreign)
    : path_(foreign == Foreign::kKeep ? checked(path, headings) : path), file_(path, AtomicFile::Existing::kReplace)
{
    putRow(&line_, headings);
    write();
}

bool CsvWriter::add(const std::vector<std::string>& cells)
{
    putRow(&line_, cells);
    if (line_.size() > CsvReader::kLongestLine)
        return false;
    ++rows_;
    write();
    return true;
}

void CsvWriter::write()
{
    // Told here, where the reason is known still.
    if (std::fwrite(line_.data(), 1, line_.size(), file_.stream()) != line_.size())
        failWriting(path_);
}
