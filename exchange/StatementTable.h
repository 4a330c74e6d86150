#pragma once

#include "exchange/StatementProfile.h"
#include "exchange/StatementText.h"

#include <array>
#include <optional>
#include <stdexcept>
#include <string>
#include <string_view>
#include <vector>

/// A statement of which a person has to tell more before its lines mean anything: which column is which, or the order
/// of day and month.
struct UnfitStatement : std::runtime_error {
    using std::runtime_error::runtime_error; // all of it, for the command line
    std::string reason;                      // by itself
    /// Of the line that may be the headings, in UTF-8; none when there is no such line.
    std::vector<std::string> headings;
    std::array<std::string, kStatementColumns> columns; // the heading of each that was found
};

/// The lines of a statement: a table that a bank has written, with headings somewhere at its beginning.
///
/// The whole file is looked at before any line is understood: its encoding, what its decimal mark is, and whether its
/// dates have the day or the month first, show in some lines and count for all. Throws UnfitStatement for a file
/// without headings, dates or an order of them, and std::runtime_error, with one line for the user, for one that cannot
/// be read.
class StatementTable {
public:
    // Where headings are looked for:
    static constexpr std::size_t kLongestPreamble = 200; // lines
    static constexpr char kSeparators[] = {'\t', ';', '|', ','};

    StatementTable(const std::string& path, const StatementProfile& profile);

    /// A line behind the headings, in UTF-8.
    struct Row {
        unsigned long line;              // counted from 1
        std::vector<std::string> fields; // none when the line could not be cut into fields
    };
    /// A line that is no row, with what it begins with and why it is none.
    struct PassedOver {
        unsigned long line;
        std::string text;
        const char* reason;
    };

    const std::vector<std::string>& headings() const { return headings_; }
    /// In the order of the file. A row without a date stands between others that have one.
    const std::vector<Row>& rows() const { return rows_; }
    const std::vector<PassedOver>& passedOver() const { return passedOver_; }
    /// Whether the last row is of an earlier day than the first one.
    bool isNewestFirst() const;

    bool has(StatementColumn column) const { return place(column) != kNowhere; }
    /// The heading that the column stands under; empty when there is none.
    std::string headingOf(StatementColumn column) const;

    // Of a row; UnusableRow says what is wrong with a cell:

    /// Without blanks around it; empty when there is none.
    std::string_view cell(const Row& row, StatementColumn column) const;
    Date date(const Row& row) const;
    struct Figure {
        double value;
        std::string unit; // the letters beside it
    };
    /// Nothing for a cell without a number.
    std::optional<Figure> figure(const Row& row, StatementColumn column) const;

private:
    static constexpr std::size_t kNowhere = ~std::size_t{0};
    using Places = std::array<std::size_t, kStatementColumns>;

    std::size_t place(StatementColumn column) const { return places_[static_cast<std::size_t>(column)]; }
    static Places placesIn(const std::vector<std::string>& fields, const StatementProfile& profile);
    static bool isHeader(const Places& places, const StatementProfile& profile);
    char findSeparator(const std::string& path, const StatementProfile& profile);
    [[noreturn]] void failWithout(const std::string& path, const StatementProfile& profile) const;
    [[noreturn]] void fail(const std::string& path, const std::string& reason, const std::string& remedy) const;
    void readAll(const std::string& path, char separator);
    void decode();
    void passOverEnd(const std::string& path, const StatementProfile& profile);
    void settleDates(const std::string& path, const StatementProfile& profile);
    void settleDecimalMarks(char separator);

    Places places_{};
    std::vector<std::string> headings_;
    unsigned long headerLine_ = 0;
    std::vector<Row> rows_;
    std::vector<PassedOver> passedOver_;
    bool isMonthFirst_ = false;
    std::array<char, kStatementColumns> decimalMarks_{}; // 0 where none shows
};
