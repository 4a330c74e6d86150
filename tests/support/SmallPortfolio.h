#pragma once

#include "market/Catalogue.h"
#include "market/Company.h"
#include "market/Currency.h"
#include "market/Market.h"
#include "portfolio/Account.h"
#include "portfolio/DepositAccountOperation.h"
#include "portfolio/Share.h"
#include "portfolio/ShareOperation.h"
#include "portfolio/TransferAccountOperation.h"
#include "portfolio/Wallet.h"

#include <ostream>
#include <random>
#include <vector>

inline void PrintTo(const Date& date, std::ostream* out)
{
    *out << date.toString().getCharacterArray();
}

inline const Date kStart(1, 1, 1999);

inline Date daysAfterStart(std::int64_t days)
{
    return Date(kStart).moveBy(days);
}

/// A number from 0 up to, but not including, `n`.
inline unsigned below(std::mt19937& random, std::size_t n)
{
    return static_cast<unsigned>(random() % n);
}

/// The elements of an association, as a range.
template <class Owner, class Declarer, class Element>
std::vector<Element*> all(const Owner& owner, Element** (Declarer::*getAll)(unsigned*) const)
{
    unsigned n;
    Element** elements = (owner.*getAll)(&n);
    return {elements, elements + n};
}

/// The values of a series, in date order.
std::vector<float> valuesOf(const auto& series)
{
    std::vector<float> values;
    for (const auto* quote : series.quotes())
        values.push_back(quote->getValue());
    return values;
}

// Each of these is owned by the objects it is linked to.

inline Account* addAccount(Wallet& wallet, const char* name, Currency* currency)
{
    auto* account = new Account(name);
    account->setWallet(&wallet);
    account->setCurrency(currency);
    return account;
}

inline void deposit(Account* account, int day, float amount, bool automatic = false)
{
    new DepositAccountOperation(daysAfterStart(day), account, amount, automatic);
}

inline TransferAccountOperation* transfer(Account* from, Account* to, int day, float amount, bool automatic = false)
{
    return new TransferAccountOperation(daysAfterStart(day), from, to, amount, automatic);
}

/// The same transfer, with its costs and rates.
inline TransferAccountOperation* withTerms(TransferAccountOperation* sent, float rateCost, float cost,
                                           float fromQuote = 1, float toQuote = 1)
{
    sent->setRateCost(rateCost);
    sent->setCost(cost);
    sent->setFromCurrencyQuote(fromQuote);
    sent->setToCurrencyQuote(toQuote);
    return sent;
}

/// A purchase of `quantity` shares, or a sale of -`quantity`.
inline ShareOperation* trade(Share* share, Account* account, int day, int quantity, float quote, float cost = 0)
{
    const bool buy = quantity > 0;
    auto* operation =
        new ShareOperation(daysAfterStart(day), share, buy, buy ? quantity : -quantity, quote, false, cost);
    operation->setAccount(account);
    return operation;
}

/// Gives the company a trend line of `slope` per day that stands at `value` on the start.
inline void setTrend(Company* company, float value, float slope = 0)
{
    constexpr int kSpan = 64;
    new CompanyQuote(company, kStart, value);
    new CompanyQuote(company, daysAfterStart(kSpan), value + kSpan * slope);
}

/// A catalogue with the euro as reference, and the dollar at a rate of 2; each has a market, and both markets list a
/// company with the ticker AC. The wallet knows them.
struct SmallPortfolio {
    SmallPortfolio()
    {
        for (Currency* currency : {euro, dollar})
            catalogue.addCurrency(currency);
        catalogue.setReferenceCurrency(euro);
        new CurrencyQuote(euro, kStart, 1);
        new CurrencyQuote(dollar, kStart, 2);
        paris->setCurrency(euro);
        york->setCurrency(dollar);
        wallet.setCatalogue(catalogue);
    }

    Catalogue catalogue;
    Currency* euro = new Currency("Euro", "EUR", nullptr);
    Currency* dollar = new Currency("Dollar", "USD", euro);
    Market* paris = new Market("Paris");
    Market* york = new Market("York");
    Company* alpha = new Company(paris, "Alpha", "AC");
    Company* beta = new Company(york, "Beta", "AC");
    Wallet wallet;
};
