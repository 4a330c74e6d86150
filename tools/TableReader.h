#pragma once

#include "tools/Columns.h"
#include "tools/CsvReader.h"
#include "tools/DecimalReader.h"

#include <cstddef>
#include <iosfwd>
#include <string>
#include <string_view>

/// The usable rows of a table file. A line that cannot be used is told on the log with its number, and counted; of a
/// file with many of them the first `kLinesTold` are told.
class TableReader {
public:
    /// Throws std::runtime_error for a file that cannot be read, and for a header line that lacks a required column.
    TableReader(const std::string& path, const TableForm& form, std::ostream& log);

    /// Goes to the next row that has fields enough. @return false at the end of the file.
    bool next();
    const Columns& columns() const { return columns_; }
    /// The field of the row under `column` without blanks around it; empty when there is none.
    std::string_view cell(Column column) const { return columns_.cell(reader_.fields(), column); }
    /// For the numbers of this file, in the order of its rows.
    DecimalReader& numbers() { return numbers_; }

    /// Counts the row out as unusable.
    void reject(const std::string& reason);
    std::size_t rejected() const { return rejected_; }

    static constexpr std::size_t kLinesTold = 20;

private:
    Columns readFirst(const TableForm& form);
    bool nextRecord();

    std::string path_;
    std::ostream& log_;
    std::size_t rejected_ = 0;
    bool waiting_ = false; // the first record is a row that `next` has not handed out
    CsvReader reader_;
    Columns columns_;
    DecimalReader numbers_;
};
