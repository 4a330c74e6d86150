#pragma once

#include "exchange/CsvReader.h"
#include "foundation/Date.h"

#include <array>
#include <cstddef>
#include <functional>
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
    /// Whether it may be wide: a date, and then a column a ticker or currency, headed by its name, with the values.
    bool mayBeWide = false;
};

/// Why a row cannot be used, in words that go on from "line 7: ".
struct UnusableRow : std::runtime_error {
    using std::runtime_error::runtime_error;
};

/// Who follows the reading of tables: is told, perhaps, of each row that cannot be used, and now and then how much of
/// the file has been read, from 0 to 1.
struct TableWatch {
    std::function<void(const std::string& path, unsigned long line, const std::string& reason)> refused;
    std::function<void(const std::string& path, double part)> progress;
};

/// The rows of a table file, each column where the header line says, or where it is in the table's plain form.
class Table {
public:
    /// Throws std::runtime_error for a file that cannot be read, and for a header line that lacks a required column.
    Table(const std::string& path, const TableForm& form);

    /// Calls `take` for every row. One for which it throws UnusableRow is refused, and the next one taken.
    /// @return how many were refused.
    std::size_t forEach(const std::function<void()>& take, const TableWatch& watch);

    /// A column of a wide table: the ticker or currency of its values, as the heading has it.
    struct WideColumn {
        std::size_t index;
        std::string name;
    };
    /// Empty unless the table is wide.
    const std::vector<WideColumn>& wideColumns() const { return wide_; }

    bool has(Column column) const { return place(column) != kNowhere; }
    /// The fields of the header line as they stand; none without one. And the one that a column stands under.
    const std::vector<std::string>& headings() const { return headings_; }
    std::string heading(Column column) const;
    /// The place of a column in the rows, counted from 0; of one that is there.
    std::size_t index(Column column) const { return place(column); }
    char separator() const { return reader_.separator(); }
    /// '.' or ','; '\0' as long as no number that was read has settled it.
    char decimalMark() const { return decimalMark_; }
    /// The heading of the value column; empty without a header line.
    const std::string& valueHeading() const { return valueHeading_; }
    /// Lower case, without blanks, '_', '-' and '.'.
    static std::string headingOf(std::string_view text);

    // Of the row, for `take`:

    /// The field without blanks around it; empty when there is none.
    std::string_view cell(Column column) const { return field(place(column)); }
    /// The same of a column of a wide table; empty also for what stands for no value there: "N/A", "NA" and "-".
    std::string_view cell(const WideColumn& column) const;
    /// Of 3/4/2026 the day is 3. A table that has the month first ends the import at the first date that shows it.
    Date date();
    /// The positive finite number that `cell` is, or its inverse, as a float.
    ///
    /// Where commas do not separate the fields, the file's first number with a decimal mark settles whether that is '.'
    /// or ','. From then on the other one makes a number unusable, since it may as well separate thousands: "1.234"
    /// would be wrong by a factor of 1000.
    float value(std::string_view cell, bool inverted);
    float value(bool inverted) { return value(cell(Column::kValue), inverted); }

private:
    static constexpr std::size_t kNowhere = ~std::size_t{0};
    static constexpr std::size_t kColumns = 6;

    std::size_t& place(Column column) { return places_[static_cast<std::size_t>(column)]; }
    std::size_t place(Column column) const { return places_[static_cast<std::size_t>(column)]; }
    bool next();
    bool takeHeader(const TableForm& form);
    void takeWideColumns(const TableForm& form);
    std::string_view field(std::size_t i) const;
    void checkFit() const;

    std::string path_;
    CsvReader reader_;
    bool more_; // there is a row
    std::array<std::size_t, kColumns> places_;
    std::size_t mostFields_ = kNowhere;
    std::string valueHeading_;
    std::vector<std::string> headings_;
    std::vector<WideColumn> wide_;
    char decimalMark_ = '\0';  // not settled yet
    bool hasDayFirst_ = false; // some date shows it
};

/// A piece of the input for a message.
std::string shown(std::string_view text);
