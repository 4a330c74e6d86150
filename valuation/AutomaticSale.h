#pragma once

#include "foundation/Date.h"
#include "valuation/Holding.h"

class Account;
class Share;
class Wallet;

/// Day of the earliest simulated sale that valuations have left in the holdings; undefined without any.
Date firstSimulatedSale(const Wallet& wallet);
/// Destroys these sales. No row refers to one.
void removeSimulatedSales(Wallet& wallet);

/// The simulated sale of a holding by the wallet's investment rule, on the company's trend line.
///
/// From the state's day to the end date E of the holding, with n days left of a period of P days, the limits are
///     loss   = (end lose   - (end lose   - begin lose)   * n / P) * average buy quote
///     profit = (end profit - (end profit - begin profit) * n / P) * average buy quote
/// The holding is sold on the first day whose trend lies below the loss or above the profit limit, otherwise on E.
class AutomaticSale {
public:
    AutomaticSale(Share& share, Wallet& wallet, const Holding& holding);

    /// Adds the sale to the holding's operations. It has no account and moves no cash. A profitable one also makes an
    /// automatic transfer of the part of the gain that is not reinvested, from `sellingAccount` to the default transfer
    /// account of the holding's currency, when these are two different accounts.
    void make(const Date& stateDate, Account* sellingAccount);

private:
    enum class Outcome { kHold, kLoss, kProfit };

    /// A day of the search, by its number from the state's day.
    struct Day {
        int number;
        bool isReal; // false for a date that no calendar has: trend and limits are the same on all of these
        float prevision;
        double lossLimit;
        double profitLimit;
    };

    Day dayAt(const Date& stateDate, int number) const;
    static Outcome judge(const Day& day);
    Day firstSale(const Date& stateDate, const Day& first, const Day& last) const;
    void transferGain(const Date& date, float quote, Account* sellingAccount);

    Share& share_;
    Wallet& wallet_;
    Holding holding_;
};
