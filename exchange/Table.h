#pragma once

#include "exchange/CsvReader.h"
#include "foundation/Date.h"

#include <array>
#include <cstddef>
#include <functional>
#include <iosfwd>
#include <stdexcept>
#include <string>
#include <string_view>
#include <vector>

enum class Column { kDate, kTicker, kValue, kMarket, kCurrency, kName };

/// How a kind of table is laid out.
struct TableForm {
    struct Headings {
        Column column;
        /// The preferred one first, as `Table::headingOf` gives them; one with '*' at its end stands for all that begin
        /// so.
        std::vector<std::string_view> names;
    };

    std::vector<Headings> headings;
    std::vector<Column> plain; // the columns of a table without a header line
    std::size_t required;      // so many of the plain ones, the first, must be there
};

/// Why a row cannot be used, in words that go on from "line 7: ".
struct UnusableRow : std::runtime_error {
    using std::runtime_error::runtime_error;
};

/// The rows of a table file, each column where the header line says, or where it is in the table's plain form.
class Table {
public:
    /// Throws std::runtime_error for a file that cannot be read, and for a header line that lacks a required column.
    Table(const std::string& path, const TableForm& form);

    /// Calls `take` for every row. A row for which it throws UnusableRow is told on the log with its line number; of
    /// more than `kLinesTold` only the first. @return how many of them.
    std::size_t forEach(const std::function<void()>& take, std::ostream& log);
    static constexpr std::size_t kLinesTold = 20;

    bool has(Column column) const { return place(column) != kNowhere; }
    /// The heading of the value column; empty without a header line.
    const std::string& valueHeading() const { return valueHeading_; }
    /// Lower case, without blanks, '_', '-' and '.'.
    static std::string headingOf(std::string_view text);

    // Of the row, for `take`:

    /// The field without blanks around it; empty when there is none.
    std::string_view cell(Column column) const;
    Date date() const;
    /// The positive finite number under `Column::kValue`, or its inverse, as a float.
    ///
    /// Where commas do not separate the fields, the file's first number with a decimal mark settles whether that is '.'
    /// or ','. From then on the other one makes a number unusable, since it may as well separate thousands: "1.234"
    /// would be wrong by a factor of 1000.
    float value(bool inverted);

private:
    static constexpr std::size_t kNowhere = ~std::size_t{0};
    static constexpr std::size_t kColumns = 6;

    std::size_t& place(Column column) { return places_[static_cast<std::size_t>(column)]; }
    std::size_t place(Column column) const { return places_[static_cast<std::size_t>(column)]; }
    bool takeHeader(const TableForm& form);
    void checkFit() const;

    std::string path_;
    CsvReader reader_;
    bool more_; // there is a row
    std::array<std::size_t, kColumns> places_;
    std::size_t mostFields_ = kNowhere;
    std::string valueHeading_;
    char decimalMark_ = '\0'; // not settled yet
};

/// A piece of the input for a message.
std::string shown(std::string_view text);
