#pragma once

#include "foundation/Date.h"

#include <cstdint>
#include <string>
#include <vector>

class Account;
class Company;
class NoteCompanyEvent;
class Share;
class ShareOperation;
class SplitCompanyEvent;

/// What a split does to the quotes of its company before its day, and to the purchases and sales before it. Changes
/// nothing until `apply`.
///
/// `from` old shares become `to` new ones: a quote is multiplied by from / to, a number of shares by to / from. Trades
/// and quotes of the day itself are in new shares already. A plan is of the model as it was when the plan was made; two
/// plans are equal when they would do the same to the same objects.
class SplitPlan {
public:
    /// What becomes of a purchase or sale.
    ///
    /// Its quantity is what the holding, rounded up to whole shares, changes by, so that after each one the holding is
    /// right. Quantity times quote stays what it was. Where that leaves no share, the money stands in the fixed cost,
    /// with today's rate cost: the balance is right, and a holding of whole shares cannot say more.
    struct Trade {
        ShareOperation* operation;
        int quantity;
        float quote;
        float cost;
        std::int64_t formerHolding; ///< in old shares, behind this trade
        std::int64_t holding;       ///< in new ones

        bool operator==(const Trade&) const = default;
    };

    /// What becomes of a holding of the company. A fraction of a share is settled on the day of the split by the sale
    /// of one share. The rate cost of sales is in its quote, so that just the fraction's value arrives.
    struct Holding {
        Share* share;
        std::vector<Trade> trades = {}; ///< by date
        std::int64_t former = 0;        ///< in old shares
        std::int64_t whole = 0;         ///< in new ones, without the fraction
        std::int64_t fraction = 0;      ///< of a new share, times `from`; 0 when nothing is to be settled
        Account* account = nullptr;     ///< of the last trade; it receives the fraction's value
        float saleQuote = 0;            ///< of the share that settles the fraction
        float paidOut = 0;              ///< what arrives
        double valueBefore = 0;         ///< former * `priceBefore`
        double valueAfter = 0;          ///< whole * `priceAfter` + `paidOut`; the same but for rounding to float

        bool operator==(const Holding&) const = default;
    };

    /// `splitsQuotes` is false for quotes that have come split, as some servers send them: these stay.
    SplitPlan(const SplitCompanyEvent& event, bool splitsQuotes);

    bool operator==(const SplitPlan&) const = default;

    Company* company() const { return company_; }
    const Date& day() const { return day_; }
    short from() const { return from_; }
    short to() const { return to_; }
    /// "1 to 2"
    std::string ratio() const { return std::to_string(from_) + " to " + std::to_string(to_); }
    /// Why it cannot be carried out, as a sentence; empty when it can.
    const std::string& problem() const { return problem_; }
    /// Neither quotes nor trades would change.
    bool isEmpty() const { return (quotes_ == 0 || !splitsQuotes_) && holdings_.empty(); }

    bool splitsQuotes() const { return splitsQuotes_; }
    /// The quotes before the day: how many, on which days, and the last one.
    unsigned quotes() const { return quotes_; }
    const Date& firstQuoteDay() const { return firstQuoteDay_; }
    const Date& lastQuoteDay() const { return lastQuoteDay_; }
    float lastQuote() const { return lastQuote_; }
    /// The first quote from the day on; the undefined date without one.
    const Date& nextQuoteDay() const { return nextQuoteDay_; }
    float nextQuote() const { return nextQuote_; }
    /// The two quotes are nearer to each other than the split would have them.
    bool looksSplit() const;

    /// Those that have trades before the day.
    const std::vector<Holding>& holdings() const { return holdings_; }
    unsigned trades() const;
    /// The price of an old and of a new share, and the day that it is of: that of the last quote before the split.
    /// Without one it is the first quote from then on, and without that the price of the last trade.
    float priceBefore() const { return priceBefore_; }
    float priceAfter() const { return priceAfter_; }
    const Date& priceDay() const { return priceDay_; }
    /// Simulations have left sales in a holding. They are in old shares and go.
    bool hasSimulatedSales() const { return hasSimulatedSales_; }

    /// The note that `apply` has left on that day; null when it has left none. Files have no other place for it.
    const NoteCompanyEvent* appliedNote() const { return appliedNote_; }
    static constexpr const char* kAppliedTitle = "Split applied";

    /// Carries it out, where there is no problem, while the model is still as it was.
    /// @return the note that says so, which the company owns; null when it has that one already.
    NoteCompanyEvent* apply() const;

private:
    double factor() const { return static_cast<double>(from_) / to_; } // of quotes
    void plan();
    void planQuotes();
    void planHolding(Share* share);
    bool planTrade(Holding& holding, ShareOperation* operation);
    void findPrice();
    void settle(Holding& holding);
    void refuse(const std::string& problem);

    Company* company_;
    Date day_;
    short from_;
    short to_;
    std::string problem_ = {};
    bool splitsQuotes_;
    std::uint64_t revision_ = 0; // of the company's quotes
    unsigned quotes_ = 0;
    Date firstQuoteDay_ = {};
    Date lastQuoteDay_ = {};
    float lastQuote_ = 0;
    Date nextQuoteDay_ = {};
    float nextQuote_ = 0;
    std::vector<Holding> holdings_ = {};
    float priceBefore_ = 0;
    float priceAfter_ = 0;
    Date priceDay_ = {};
    bool hasSimulatedSales_ = false;
    const NoteCompanyEvent* appliedNote_ = nullptr;
};
