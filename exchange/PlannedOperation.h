#pragma once

#include "foundation/Date.h"
#include "portfolio/OperationKind.h"

#include <string>

class Account;
class Company;
class Currency;

/// An account that planned operations are on: one that is there, or one that is made when they are booked.
struct PlannedAccount {
    std::string name;
    Account* account; // null for one that is not there yet
    Currency* currency;
};

/// What a line of a table becomes: all values of an operation that does not exist yet.
struct PlannedOperation {
    unsigned long line = 0; // of the table, counted from 1
    OperationKind kind = OperationKind::kDeposit;
    Date date;
    const PlannedAccount* account = nullptr;
    /// What a deposit brings, negative for a withdrawal; the size of a transfer, of income or of a charge.
    float amount = 0;
    float cost = 0; // of a trade or a transfer

    // Of a trade only:
    Company* company = nullptr;
    int quantity = 0;
    float quote = 0;
    /// The amount of the line, without its sign, when that is not what quantity, quote and cost make: a column may have
    /// been taken for another one. Otherwise 0.
    double otherAmount = 0;

    // Of a transfer only:
    const PlannedAccount* recipient = nullptr;
    float rateCost = 0; // a fraction
    float fromQuote = 1;
    float toQuote = 1;

    bool isTrade() const { return kind == OperationKind::kBuy || kind == OperationKind::kSell; }
};
