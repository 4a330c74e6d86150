#pragma once

#include "foundation/OneToManyAssociation.h"

class Currency;
class Account;

/// The cash accounts held in a currency. Accounts live a floor higher: the members are defined beside `Account`.
class CurrencyToAccounts final : public OneToManyAssociation<Currency, Account> {
public:
    explicit CurrencyToAccounts(Currency* owner) : OneToManyAssociation(owner) {}

private:
    ManyToOneAssociation<Account, Currency>& backLink(Account& e) const override;
};

/// The account's link to its currency.
class AccountsToCurrency final : public ManyToOneAssociation<Account, Currency> {
public:
    using ManyToOneAssociation::ManyToOneAssociation;

private:
    int xAdd(Currency* partner) override;
    int xRemove(Currency* partner) override;
};
