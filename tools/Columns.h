#pragma once

#include <array>
#include <string>
#include <string_view>
#include <vector>

enum class Column { kDate, kTicker, kValue, kMarket, kCurrency, kName };

/// The headings under which a column is known, the preferred one first: lower case, without spaces, '_', '-' and '.'.
/// One with '*' at its end stands for all that begin so.
struct ColumnNames {
    Column column;
    std::vector<std::string_view> names;
};

/// How a kind of table is laid out.
struct TableForm {
    std::vector<ColumnNames> known;
    std::vector<Column> plain; // the columns of a table without a header line
    std::vector<Column> required;
};

/// Where in the records of a table each column stands: as the header line says, or as in the table's plain form.
class Columns {
public:
    using Record = std::vector<std::string_view>;

    /// Looks at a table's first record. It is a header line when it has no date in it and names a column of dates,
    /// or any two columns.
    Columns(const TableForm& form, const Record& first);

    bool hasHeader() const { return header_; }
    /// What the header line should name and does not, in words; null when nothing is missing.
    const char* missing() const { return missing_; }
    /// The heading of the value column, as in `ColumnNames`; empty without a header line.
    const std::string& valueHeading() const { return valueHeading_; }
    bool has(Column column) const { return place(column) != kNowhere; }
    /// Why `record` does not belong into this table, in words: it does not reach to the last required column, or
    /// without a header line goes beyond the plain form. Null when it does belong.
    const char* misfit(const Record& record) const;
    /// The field under `column` without blanks around it; empty when the column or the field is missing.
    std::string_view cell(const Record& record, Column column) const;

    /// A heading as in `ColumnNames`.
    static std::string headingOf(std::string_view text);

private:
    static constexpr std::size_t kNowhere = ~std::size_t{0};
    static constexpr std::size_t kColumns = 6;

    std::size_t& place(Column column) { return places_[static_cast<std::size_t>(column)]; }
    std::size_t place(Column column) const { return places_[static_cast<std::size_t>(column)]; }
    std::size_t recognize(const TableForm& form, const Record& record);

    std::array<std::size_t, kColumns> places_;
    std::size_t fewestFields_ = 0;
    std::size_t mostFields_ = kNowhere;
    bool header_ = false;
    const char* missing_ = nullptr;
    std::string valueHeading_;
};
