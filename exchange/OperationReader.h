#pragma once

#include "exchange/CompanyFinder.h"
#include "exchange/PlannedOperation.h"
#include "exchange/StatementTable.h"
#include "exchange/Table.h"

#include <functional>
#include <map>
#include <optional>
#include <string>
#include <string_view>

class Catalogue;

/// A line that could be booked if a person told what it leaves open.
struct UntoldRow : UnusableRow {
    enum class About { kType, kAccount, kNewAccount }; // what a word means; whose line it is; an account to be made

    UntoldRow(const std::string& reason, About open) : UnusableRow(reason), about(open) {}
    About about;
};

/// Makes operations of the lines of a statement: finds accounts and companies, settles signs, and takes the quote out
/// of a total where the line has no quote.
class OperationReader {
public:
    using Accounts = std::map<std::string, PlannedAccount, std::less<>>; // by name

    /// All outlive this.
    OperationReader(const StatementTable& table, const StatementProfile& profile, const Accounts& accounts,
                    const Catalogue& catalogue);

    /// Throws UnusableRow with the reason when the line cannot be booked.
    PlannedOperation read(const StatementTable::Row& row) const;

private:
    using Row = StatementTable::Row;

    StatementType typeOf(const Row& row) const;
    const PlannedAccount& accountNamed(std::string_view name) const;
    void readCash(const Row& row, StatementType type, PlannedOperation* operation) const;
    void readTransfer(const Row& row, PlannedOperation* operation) const;
    void readTrade(const Row& row, PlannedOperation* operation) const;
    int quantityOf(const Row& row) const;
    /// What moved, with its sign; nothing when the line does not say.
    std::optional<double> amountOf(const Row& row, const PlannedAccount& account) const;
    double neededAmount(const Row& row, const PlannedAccount& account) const;
    std::optional<double> money(const Row& row, StatementColumn column, const PlannedAccount& account) const;
    /// A number without its sign; 0 when there is none.
    double sizeOf(const Row& row, StatementColumn column) const;
    float exchangeQuote(const Row& row, StatementColumn column, const PlannedAccount& account, bool isExchanged) const;
    void checkCurrency(std::string_view text, const PlannedAccount& account) const;

    const StatementTable& table_;
    const StatementProfile& profile_;
    const Accounts& accounts_;
    CompanyFinder companies_;
    std::map<std::string, const Currency*, std::less<>> currencies_; // by folded symbol and name
};
