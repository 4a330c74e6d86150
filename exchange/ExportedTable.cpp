#include "exchange/ExportedTable.h"

#include "exchange/Table.h"
#include "exchange/TableText.h"

#include <algorithm>
#include <limits>
#include <stdexcept>

ExportedTable::ExportedTable(const std::string& folder, const ExportTable& table)
    : path_(folder + '/' + table.file), table_(table), reader_(path_)
{
    reader_.next();
    // The first line is read, and no row is.
    std::vector<std::string> present;
    for (const std::string& field : reader_.fields())
        present.push_back(Table::headingOf(field));
    for (const std::string& heading : table.headings) {
        const auto place = std::ranges::find(present, Table::headingOf(heading));
        if (place == present.end())
            throw std::runtime_error(path_ + ": has no column " + shown(heading) + ", as an export writes it");
        places_.push_back(static_cast<std::size_t>(place - present.begin()));
    }
}

bool ExportedTable::next()
{
    if (!reader_.next())
        return false;
    if (reader_.fields().empty())
        refuse("has text behind a closing quote");
    return true;
}

const std::string& ExportedTable::cell(std::size_t column) const
{
    const std::size_t place = places_[column];
    return place < reader_.fields().size() ? reader_.fields()[place] : none_;
}

template <class Read>
auto ExportedTable::read(std::size_t column, const Read& reader, const char* what) const
{
    const auto value = reader(cell(column));
    if (!value)
        refuse(shown(cell(column)) + " is no " + what);
    return *value;
}

Date ExportedTable::date(std::size_t column) const
{
    return read(column, readTableDate, "date as YYYY-MM-DD");
}

float ExportedTable::number(std::size_t column) const
{
    return read(column, readNumberText, "number with a decimal point");
}

int ExportedTable::count(std::size_t column) const
{
    return read(column, readCountText, "whole number");
}

short ExportedTable::smallCount(std::size_t column) const
{
    const int number = count(column);
    if (number < std::numeric_limits<short>::min() || number > std::numeric_limits<short>::max())
        refuse(shown(cell(column)) + " is too large");
    return static_cast<short>(number);
}

void ExportedTable::refuse(const std::string& reason) const
{
    throw std::runtime_error(path_ + ", line " + std::to_string(reader_.line()) + ": " + reason);
}

void ExportedTable::refuseUnknown(std::size_t column) const
{
    refuse(shown(cell(column)) + " under " + table_.headings[column] + " is in no other table");
}
