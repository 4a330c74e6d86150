#pragma once

#include "foundation/Date.h"
#include "foundation/String.h"

#include <string>

class Account;
class Company;
class OperationMaker;
class OperationView;
class Wallet;
class PLWindow;

/// What the operation page offers while a person types: quotes, costs and accounts that fit the rest, and what the
/// account will be charged. The page puts a number in only where nobody has typed another one, unless that was of
/// another company.
class OperationOffers {
public:
    /// All outlive this.
    OperationOffers(PLWindow& window, OperationView& page, const OperationMaker& maker)
        : window_(window), page_(page), maker_(maker)
    {}

    /// Another type was chosen: each kind of trade has a fixed cost of its own to offer, and the
    /// company chooses the account again.
    void noteType();
    /// Brings everything up to date with the fields, the quotes and the parameters.
    void renew();
    /// A figure was typed that no offer depends on.
    void noteFigure();
    /// The fields show an operation now.
    void noteShown();
    /// An operation was booked on that account: the next one starts there.
    void noteUsed(const Account& account);

private:
    Wallet& wallet() const;
    Account* chosenAccount() const;
    void chooseAccount();
    void followCompany();
    void chooseAccountFor(const Company& company);
    void offerTransferQuotes();
    /// What is made of the figures, for the eye.
    void showSums();
    /// A figure of a trade was typed, which may be the quote.
    void noteQuote();
    std::string chargedText() const;
    /// The company that the fields name, in words that stay true when it is destroyed; empty when there is none.
    std::string companyKey() const;
    std::string typedKey() const;

    PLWindow& window_;
    OperationView& page_;
    const OperationMaker& maker_;
    String used_;          // the account that was booked on last; undefined before
    std::string typed_;    // what market and ticker held when they were looked at last
    std::string quoteOf_;  // the company that the quote in its field is of; empty when it is of none
    bool isFirst_ = false; // the quote was typed before any ticker, and that company was the first to come by
    float quote_ = 0;      // what the field held when it was looked at last
};
