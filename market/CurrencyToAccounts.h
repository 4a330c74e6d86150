#pragma once

#include "foundation/OneToManyAssociation.h"

class Currency;
class Account;

/// The cash accounts held in a currency. Accounts live a floor higher: the members are defined beside `Account`.
class CurrencyToAccounts final : public OneToManyAssociation<CurrencyToAccounts, Currency, Account> {
public:
    using OneToManyAssociation::OneToManyAssociation;
    /// Leaves every account without a currency.
    void unlinkAll();
    static auto& link(auto& account) { return account.currency_; }
};

/// The account's link to its currency.
class AccountsToCurrency final : public ManyToOneAssociation<AccountsToCurrency, Account, Currency> {
public:
    static auto& list(auto& currency) { return currency.accounts_; }
};
