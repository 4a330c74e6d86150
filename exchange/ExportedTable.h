#pragma once

#include "exchange/CsvReader.h"
#include "exchange/ExportTables.h"
#include "foundation/Date.h"

#include <cstddef>
#include <string>
#include <vector>

/// The rows of a table of an export, read strictly: the columns may stand in any order, and others beside them, but
/// each of the table's headings has to be there, and each line has to be one that an export writes.
///
/// Anything else throws std::runtime_error with one line for the user that names file, line and reason.
class ExportedTable {
public:
    ExportedTable(const std::string& folder, const ExportTable& table);

    /// Goes to the next row. @return false at the end.
    bool next();

    // Of the row; `column` counts the table's headings from 0. Empty where the line ends before the column.

    const std::string& cell(std::size_t column) const;
    Date date(std::size_t column) const;
    float number(std::size_t column) const;
    int count(std::size_t column) const;
    short smallCount(std::size_t column) const;

    /// Throws for this row.
    [[noreturn]] void refuse(const std::string& reason) const;
    /// Throws for this row, since no table has what stands in the column.
    [[noreturn]] void refuseUnknown(std::size_t column) const;

private:
    /// What `reader` makes of the cell; `what` says for a refusal what it should be.
    template <class Read>
    auto read(std::size_t column, const Read& reader, const char* what) const;

    std::string path_;
    const ExportTable& table_;
    CsvReader reader_;
    std::vector<std::size_t> places_; // of the headings
    std::string none_;
};
