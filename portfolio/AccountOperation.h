#pragma once

#include "portfolio/Operation.h"

/// An operation that moves an amount of cash, in the account's currency.
class AccountOperation : public Operation {
public:
    float getAmount() const { return amount_; }
    void setAmount(float amount) { amount_ = amount; }

protected:
    AccountOperation() = default;
    AccountOperation(const Date& date, Account* account, float amount, bool automatic)
        : Operation(date, automatic), amount_(amount)
    {
        setAccount(account);
    }

private:
    float amount_ = 0;
};
