#include "tools/TextTable.h"

#include "foundation/PrintableText.h"

#include <algorithm>

namespace {

constexpr int kGap = 2; // between columns

} // namespace

TextTable::TextTable(std::vector<Column> columns)
{
    std::vector<std::string> headings;
    for (Column& column : columns) {
        aligns_.push_back(column.align);
        headings.push_back(std::move(column.heading));
    }
    // The headings are the first row: `isEmpty` counts on it.
    rows_.push_back(std::move(headings));
}

std::string TextTable::toString() const
{
    // Two passes, since the widest cell may be in the last row.
    std::vector<int> widths(aligns_.size(), 0);
    for (const auto& row : rows_)
        for (std::size_t i = 0; i < row.size(); ++i)
            widths[i] = std::max(widths[i], displayWidth(row[i]));
    std::string text;
    for (const auto& row : rows_)
        text += lineOf(row, widths) + '\n';
    return text;
}

std::string TextTable::lineOf(const std::vector<std::string>& cells, const std::vector<int>& widths) const
{
    std::string line;
    for (std::size_t i = 0; i < cells.size(); ++i) {
        const std::string blanks(static_cast<std::size_t>(widths[i] - displayWidth(cells[i])), ' ');
        line += aligns_[i] == Align::kRight ? blanks + cells[i] : cells[i] + blanks;
        line.append(kGap, ' ');
    }
    return line.erase(line.find_last_not_of(' ') + 1);
}
