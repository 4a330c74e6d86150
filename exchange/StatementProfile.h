#pragma once

#include "exchange/StatementWords.h"

#include <map>
#include <optional>
#include <string>

/// What a person has to tell about the statements of one bank: columns and words that are not known, the account that
/// the lines do not name, the order of day and month.
///
/// Kept in a small text file, one thing a line, with '#' before what is for people:
///
///     column date=Valuta
///     type Kauf=buy
///     account Depot
///     dates dmy
class StatementProfile {
public:
    /// "date=Valuta"; nothing behind the '=' says that the statement has no such column. Throws std::runtime_error,
    /// with one line for the user, for what is nothing of the kind; so do the next two.
    void addColumn(const std::string& text);
    /// "Kauf=buy"
    void addType(const std::string& text);
    /// "dmy" or "mdy"
    void setDates(const std::string& text);
    /// Back to what the table itself shows.
    void forgetDates() { isMonthFirst_.reset(); }
    void setAccount(const std::string& name) { account_ = name; }

    /// Throws std::runtime_error, naming the file and the line, for what cannot be read or is not understood.
    static StatementProfile fromFile(const std::string& path);
    std::string toText() const;
    /// Takes from `other` what is not told here.
    void fillFrom(const StatementProfile& other);

    /// The heading that was told; empty when there is no such column. Nothing when nothing was told of the column.
    std::optional<std::string> headingOf(StatementColumn column) const;
    /// What the word means, from what was told or else from what is known.
    std::optional<StatementType> typeOf(const std::string& word) const;
    /// Of the lines that name none; empty when it was not told.
    const std::string& account() const { return account_; }
    /// Whether the month comes before the day; nothing when it was not told.
    std::optional<bool> isMonthFirst() const { return isMonthFirst_; }

private:
    struct Word {
        std::string text;
        StatementType type;
    };

    void take(const std::string& line);

    std::map<StatementColumn, std::string> columns_;
    std::map<std::string, Word> types_; // by `wordKey`
    std::string account_;
    std::optional<bool> isMonthFirst_;
};
