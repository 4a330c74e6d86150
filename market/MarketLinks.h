#pragma once

#include "foundation/OneToManyAssociation.h"
#include "market/Quote.h"

// The relations of the catalogue: both ends of each.

class Account;
class Company;
class CompanyEvent;
class CompanyQuote;
class Currency;
class CurrencyQuote;
class Market;
class Share;

/// The companies that a market lists.
class MarketToCompanies final : public OneToManyAssociation<MarketToCompanies, Market, Company> {
public:
    using OneToManyAssociation::OneToManyAssociation;
    static auto& link(auto& company) { return company.market_; }
};

/// The company's link to its market.
struct CompaniesToMarket final : ManyToOneAssociation<CompaniesToMarket, Company, Market> {
    static auto& list(auto& market) { return market.companies_; }
};

/// A company's notes and splits.
class CompanyToEvents final : public OneToManyAssociation<CompanyToEvents, Company, CompanyEvent> {
public:
    using OneToManyAssociation::OneToManyAssociation;
    static auto& link(auto& event) { return event.company_; }
};

/// The event's link to its company.
struct CompanyEventsToCompany final : ManyToOneAssociation<CompanyEventsToCompany, CompanyEvent, Company> {
    static auto& list(auto& company) { return company.events_; }
};

/// A company's quotes, by date.
class CompanyToQuotes final : public OneToManyAssociation<CompanyToQuotes, Company, CompanyQuote, true> {
public:
    using OneToManyAssociation::OneToManyAssociation;
    static auto& link(auto& quote) { return quote.company_; }
    static int compare(const void* a, const void* b) { return sortQuotesByDate(a, b); }
};

/// The quote's link to its company.
struct QuotesToCompany final : ManyToOneAssociation<QuotesToCompany, CompanyQuote, Company, true> {
    // By way of the series, where a quote of the same day is replaced and the trend follows.
    static int enter(auto& company, CompanyQuote* quote) { return company.addQuote(quote); }
    static int leave(auto& company, CompanyQuote* quote) { return company.removeQuote(quote); }
};

/// The portfolio's holdings of a company. Holdings live a floor higher: the members are defined beside `Share`.
class CompanyToShares final : public OneToManyAssociation<CompanyToShares, Company, Share> {
public:
    using OneToManyAssociation::OneToManyAssociation;
    /// Destroys every holding.
    void deleteAll();
    static auto& link(auto& share) { return share.company_; }
};

/// The holding's link to its company.
struct SharesToCompany final : ManyToOneAssociation<SharesToCompany, Share, Company> {
    static auto& list(auto& company) { return company.shares_; }
};

/// The cash accounts held in a currency. Accounts live a floor higher: the members are defined beside `Account`.
class CurrencyToAccounts final : public OneToManyAssociation<CurrencyToAccounts, Currency, Account> {
public:
    using OneToManyAssociation::OneToManyAssociation;
    /// Leaves every account without a currency.
    void unlinkAll();
    static auto& link(auto& account) { return account.currency_; }
};

/// The account's link to its currency.
struct AccountsToCurrency final : ManyToOneAssociation<AccountsToCurrency, Account, Currency> {
    static auto& list(auto& currency) { return currency.accounts_; }
};

/// The markets that trade in a currency.
class CurrencyToMarkets final : public OneToManyAssociation<CurrencyToMarkets, Currency, Market> {
public:
    using OneToManyAssociation::OneToManyAssociation;
    static auto& link(auto& market) { return market.currency_; }
};

/// The market's link to its currency.
struct MarketsToCurrency final : ManyToOneAssociation<MarketsToCurrency, Market, Currency> {
    static auto& list(auto& currency) { return currency.markets_; }
};

/// A currency's rates, by date.
class CurrencyToQuotes final : public OneToManyAssociation<CurrencyToQuotes, Currency, CurrencyQuote, true> {
public:
    using OneToManyAssociation::OneToManyAssociation;
    static auto& link(auto& quote) { return quote.currency_; }
    static int compare(const void* a, const void* b) { return sortQuotesByDate(a, b); }
};

/// The rate's link to its currency.
struct QuotesToCurrency final : ManyToOneAssociation<QuotesToCurrency, CurrencyQuote, Currency, true> {
    // By way of the series, where a quote of the same day is replaced and the trend follows.
    static int enter(auto& currency, CurrencyQuote* quote) { return currency.addQuote(quote); }
    static int leave(auto& currency, CurrencyQuote* quote) { return currency.removeQuote(quote); }
};
