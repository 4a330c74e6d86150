#pragma once

#include "foundation/Date.h"
#include "market/Company.h"
#include "valuation/Ledger.h"
#include "valuation/SharedHolding.h"

#include <optional>
#include <unordered_map>
#include <utility>
#include <vector>

class Account;
class Operation;
class Share;
class ShareOperation;
class State;
class Wallet;

/// Builds a wallet's state of every day of an evolution in one sweep, each bit for bit what `State(wallet, day, false)`
/// gives.
///
/// From one day to the next a holding only takes in the operations of that day. A balance is the sum, rounded after
/// each move, of the account's own moves, then the transfers it received, then the purchases and sales of one holding
/// after the other. A day's operation therefore stands in the middle of the sum; only what follows it is summed again,
/// and on a day without operations nothing.
class DailyStates {
public:
    /// For the days from `first` up to, but not including, `end`; both are valid dates. As for every state, automatic
    /// operations that accounts list are destroyed first.
    DailyStates(Wallet& wallet, const Date& first, const Date& end);

    /// The states are added to the wallet's list, day by day, and owned by it.
    void build();

private:
    /// The states of that many days are filled together, one holding after the other: its operations, its quotes and
    /// its list stay at hand for all of them.
    static constexpr std::size_t kDaysAtOnce = 60;
    static constexpr std::size_t kNever = ~std::size_t{0};

    /// A move that happens on a day.
    struct Event {
        Ledger* ledger;
        Ledger::Rank rank;
    };
    /// A holding on its way through the days.
    struct Line {
        Share* share;
        std::size_t nextDay = 0; // the day of the next operation
        SharedHolding holding;
        std::vector<std::pair<std::size_t, const ShareOperation*>> operations; // with the day each counts from
        std::size_t replayed = 0;
        std::optional<Company::Walk> walk; // none without a company
    };

    void takeOwnMoves(std::size_t account);
    void takeReceivedTransfers(std::size_t account, bool automatic);
    void takeShare(Share& share);
    void takeMove(const Operation& operation, Ledger& ledger, double amount);
    std::size_t dayOf(const Date& date) const;
    void buildDays(std::size_t begin, std::size_t end);
    State* newState(std::size_t day);
    void replay(Line& line, std::size_t day);

    Wallet& wallet_;
    std::vector<PackedDate> days_;
    Date firstOperationDate_;
    std::vector<Account*> accounts_;
    std::unordered_map<const Account*, std::size_t> accountIndex_;
    std::vector<Ledger> cash_;               // of each account
    Ledger deposits_;                        // in the reference currency
    std::vector<std::vector<Event>> events_; // of each day
    std::vector<Line> lines_;                // of each holding
};
