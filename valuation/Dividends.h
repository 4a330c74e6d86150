#pragma once

#include "foundation/Date.h"

#include <unordered_map>
#include <vector>

class Catalogue;
class Company;
class Currency;
class Operation;
class Wallet;

/// The income of a wallet by the company that paid it.
///
/// A file has no link between them: the company has a note titled "Dividend" of the day, with the text that tells the
/// amount and the account, as the window leaves it. Where more notes look alike than incomes do, none of these can be
/// told to be of an income, and none counts.
class Dividends {
public:
    static constexpr const char* kTitle = "Dividend"; ///< of the notes

    struct Payment {
        Date date;
        double amount;            ///< what arrived
        const Currency* currency; ///< that of the account; never null
    };

    Dividends(const Wallet& wallet, const Catalogue& catalogue);

    /// Who has paid that income; null where no note tells, or more than one could be meant.
    const Company* payerOf(const Operation& income) const;
    /// Not in the order of the days.
    const std::vector<Payment>& of(const Company& company) const;

private:
    std::unordered_map<const Company*, std::vector<Payment>> payments_;
    std::unordered_map<const Operation*, const Company*> payers_;
};
