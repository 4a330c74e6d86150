#pragma once

#include <string>
#include <utility>
#include <vector>

/// A table in columns as wide as their widest cell, for a terminal.
class TextTable {
public:
    enum class Align { kLeft, kRight };
    struct Column {
        std::string heading;
        Align align = Align::kLeft;
    };

    explicit TextTable(std::vector<Column> columns);
    /// One cell for each column, printable.
    void addRow(std::vector<std::string> cells) { rows_.push_back(std::move(cells)); }
    bool isEmpty() const { return rows_.size() == 1; }
    /// The headings and the rows, a line each, without blanks at their ends.
    std::string toString() const;

private:
    std::string lineOf(const std::vector<std::string>& cells, const std::vector<int>& widths) const;

    std::vector<Align> aligns_;
    std::vector<std::vector<std::string>> rows_; // the headings first
};
