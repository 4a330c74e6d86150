#pragma once

#include "foundation/Date.h"
#include "foundation/Pooled.h"
#include "foundation/String.h"
#include "portfolio/Account.h"
#include "valuation/StateLinks.h"

/// The cash of one account at the day of a state, in the account's own currency.
class AccountState final : public Pooled<AccountState, (std::size_t{16} << 20)> {
public:
    /// Replays the account's manual deposits and transfers up to and including `date`; purchases and sales reach the
    /// cash through the states of the holdings. The last argument makes no difference.
    AccountState(Account* account, State* state, const Date& date, bool automatic);
    ~AccountState();
    AccountState(const AccountState&) = delete;
    AccountState& operator=(const AccountState&) = delete;

    /// Replays the account's automatic deposits and transfers up to and including `date`.
    void processAutomaticOperations(const Date& date);

    float getCash() const { return cash_; }
    void setCash(float cash) { cash_ = cash; }
    /// The state's day, undefined without a state.
    Date getDate() const;
    const String& getAccountName() const;
    const String& getCurrencyRepresentation() const;

    int getAccount(Account** out) const { return account_.get(out); }
    /// The same; null when there is none.
    Account* account() const { return account_.partner(); }
    int setAccount(Account* account) { return account_.set(this, account); }
    int getState(State** out) const { return state_.get(out); }
    /// The same; null when there is none.
    State* state() const { return state_.partner(); }
    int setState(State* state);

private:
    friend class AccountToAccountStates;
    friend class StateToAccountStates;
    friend class DailyStates;

    /// With its cash known already.
    AccountState(Account* account, State* state, float cash);

    void replay(const Date& date, bool automatic);

    [[no_unique_address]] AccountStatesToAccount account_;
    float cash_ = 0;
    AccountStatesToState state_;
};
