#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

/// What a program for plain-text accounting takes, and how its journals are written.
class JournalForm {
public:
    virtual ~JournalForm() = default;

    /// The first line of a journal, by which a later export knows it again.
    virtual std::string head() const = 0;

    // Names. What a program does not take is left out or replaced, so that two may become one.

    /// A commodity's symbol of at most `kLongestSymbol` bytes: of a currency, or a company's ticker.
    virtual std::string symbol(std::string_view name) const = 0;
    /// One part of an account's name, without the colons between the parts.
    virtual std::string accountPart(std::string_view name) const = 0;
    /// Symbols that mean something else.
    virtual std::vector<std::string> reserved() const = 0;
    static constexpr std::size_t kLongestSymbol = 24;

    /// Dates from the first of these years to the end of the second.
    virtual int firstYear() const = 0;
    virtual int lastYear() const = 0;
    /// Whether a price in a currency that has a price itself does not count.
    virtual bool needsDirectPrices() const = 0;

    /// What follows the first line: of a journal in that currency, of which there may be none.
    virtual std::string preamble(const std::string& reference) const = 0;

    // Text. A symbol or an account is one that the functions above gave; what is told is one line of UTF-8.

    /// The currency or company of that symbol; `name` is told beside it.
    virtual std::string commodity(const std::string& symbol, bool isCurrency, const std::string& name) const = 0;
    virtual std::string openAccount(const std::string& day, const std::string& account) const = 0;
    virtual std::string price(const std::string& day, const std::string& symbol, const std::string& number,
                              const std::string& in) const = 0;
    virtual std::string transaction(const std::string& day, const std::string& text) const = 0;
    /// A symbol as it stands behind a number.
    virtual std::string inAmount(const std::string& symbol) const = 0;
};

/// What `ledger` and `hledger` both read.
const JournalForm& ledgerForm();
const JournalForm& beancountForm();
