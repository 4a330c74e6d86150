#pragma once

#include "foundation/Date.h"
#include "platform/PaperDocument.h"
#include "valuation/Dividends.h"

#include <optional>
#include <string>
#include <vector>

class Account;
class Operation;
class WalletFigures;

/// The tables of a year's operations, up to the day of a report; of all operations where no year is named.
class YearTables {
public:
    /// `figures` outlives this.
    YearTables(const WalletFigures& figures, std::optional<int> year);

    /// The years of the operations up to the day of the report, the latest first.
    static std::vector<int> years(const WalletFigures& figures);

    bool isEmpty() const { return operations_.empty(); }
    /// The last day before the range; undefined for all.
    const Date& before() const { return before_; }
    const Date& last() const { return last_; }

    /// What went into the accounts and out of them.
    PaperTable sums() const;
    PaperTable operations() const;

private:
    void addOperation(const Operation& operation, PaperTable* table) const;

    const WalletFigures& figures_;
    std::optional<int> year_;
    Date before_;
    Date last_;
    Dividends dividends_;
    std::vector<const Operation*> operations_;
};
