#include "tools/TableReader.h"

#include <ostream>
#include <stdexcept>
#include <utility>

TableReader::TableReader(const std::string& path, const TableForm& form, std::ostream& log)
    : path_(path), log_(log), reader_(path), columns_(readFirst(form)), numbers_(reader_.separator() != ',')
{}

Columns TableReader::readFirst(const TableForm& form)
{
    const bool found = nextRecord();
    Columns columns(form, reader_.fields());
    if (columns.missing() != nullptr)
        throw std::runtime_error(path_ + ": the header line names no column for the " + columns.missing());
    waiting_ = found && !columns.hasHeader();
    return columns;
}

bool TableReader::next()
{
    while (std::exchange(waiting_, false) || nextRecord()) {
        const char* misfit = columns_.misfit(reader_.fields());
        if (misfit == nullptr)
            return true;
        reject(misfit);
    }
    if (rejected_ > kLinesTold)
        log_ << path_ << ": ... and " << rejected_ - kLinesTold << " more\n";
    return false;
}

bool TableReader::nextRecord()
{
    CsvReader::Outcome outcome;
    while ((outcome = reader_.next()) == CsvReader::Outcome::kMalformed)
        reject("has a quote that is not closed, or is too long");
    return outcome == CsvReader::Outcome::kRecord;
}

void TableReader::reject(const std::string& reason)
{
    if (++rejected_ <= kLinesTold)
        log_ << path_ << ", line " << reader_.line() << ": " << reason << '\n';
}
