#pragma once

#include "exchange/JournalForm.h"
#include "exchange/JournalNames.h"
#include "foundation/Date.h"

#include <cstddef>
#include <cstdio>
#include <map>
#include <string>
#include <unordered_map>
#include <vector>

class Catalogue;
class Currency;
class Operation;
class ShareOperation;
class State;
class String;
class TransferAccountOperation;
class Wallet;

/// A portfolio up to a day as a journal for plain-text accounting: its operations as transactions, and the prices of
/// its companies and currencies.
///
/// What is held on the day, and its prices of that day, are those of the state, so that a program that reads the
/// journal comes to the state's total. The moves of cash are in ten-thousandths; what the replay's rounding of sums has
/// made of them, and of the total, is a transaction of the last day. A trade in its account's currency names its quote;
/// one in another, and a transfer between currencies, goes by way of Equity:Exchange, where no price is made up.
class Journal {
public:
    /// `state` is of `wallet`, without simulated sales. A wallet without holdings and accounts gives a journal of the
    /// prices of all companies. Throws std::runtime_error with one line for the user for what no journal can hold.
    Journal(const Catalogue& catalogue, const Wallet& wallet, const State& state, const JournalForm& form);

    void write(FILE* file) const;
    std::size_t transactions() const { return transactions_.size(); }
    std::size_t prices() const { return prices_; }
    /// A line for each thing that is left out.
    const std::vector<std::string>& remarks() const { return remarks_; }

private:
    struct Transaction {
        Date date;
        std::string text;
        std::string postings; // a line each
    };
    using Units = long long; // ten-thousandths of a currency

    void addOperation(const Operation& operation);
    void addTrade(const ShareOperation& trade, Transaction* transaction);
    void addTransfer(const TransferAccountOperation& transfer, Transaction* transaction);
    void addRoundings();
    void addRounding(const std::string& account, double difference, const String& symbol, Transaction* transaction);
    void addPrices();
    void addPricesOf(const Company& company);
    /// Of one that nothing is in that of the day alone.
    void addPricesOf(const Currency& currency, bool isUsed);
    /// In the reference currency; where they change on days of the company's quotes or the currency's rates.
    void addDirectPricesOf(const Company& company, const Currency& currency);
    template <class Series, class ValueOf>
    void addSeries(const Series& series, const std::string& commodity, const std::string& in, const ValueOf& valueOf);
    void putPrice(const Date& day, const std::string& commodity, double price, const std::string& in);

    Units unitsOf(double amount, const Operation& operation) const;
    /// Moves cash of the account; `account` is one of the wallet's.
    void move(const Account& account, Units amount, Transaction* transaction);
    void post(Transaction* transaction, const std::string& account, const std::string& amount);
    std::string amount(Units amount, const std::string& commodity) const;
    bool isWithin(const Date& date) const;

    const Catalogue& catalogue_;
    const Wallet& wallet_;
    const State& state_;
    const JournalForm& form_;
    const Date day_; // of the state
    std::vector<const Company*> companies_;
    JournalNames names_;

    std::vector<const Currency*> currencies_; // the first of each symbol
    std::vector<Transaction> transactions_;
    std::map<std::string, Date> opened_; // accounts, with the day of their first posting
    std::unordered_map<const Account*, Units> cash_;
    std::string priceText_;
    std::size_t prices_ = 0;
    std::vector<std::string> remarks_;
};
