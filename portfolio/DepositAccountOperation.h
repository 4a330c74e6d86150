#pragma once

#include "portfolio/AccountOperation.h"

/// Money paid into an account from outside the portfolio; paid out when the amount is negative.
class DepositAccountOperation final : public AccountOperation {
public:
    DepositAccountOperation() = default;
    DepositAccountOperation(const Date& date, Account* account, float amount, bool automatic)
        : AccountOperation(date, account, amount, automatic)
    {}

    /// File: amount (f32), date. `rd` returns -1 when the file ends inside the record.
    int wrt(FILE* file) const override;
    int rd(FILE* file) override;
    short getType() const override { return kDeposit; }
};
