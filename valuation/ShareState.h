#pragma once

#include "foundation/Date.h"
#include "foundation/Pooled.h"
#include "foundation/String.h"
#include "portfolio/Share.h"
#include "valuation/Holding.h"
#include "valuation/StateToShareStates.h"

class Account;

/// One holding at the day of a state.
class ShareState final : public Pooled<ShareState, (std::size_t{192} << 20)> {
public:
    /// Replays the holding's operations up to and including `date`, moving cash in the account states of `state`.
    /// `automatic` also searches the automatic sale of what is held, when no operation is dated after `date`.
    ShareState(Share* share, State* state, const Date& date, bool automatic);
    ~ShareState();
    ShareState(const ShareState&) = delete;
    ShareState& operator=(const ShareState&) = delete;

    /// Number of shares held; negative when more were sold than held.
    int getQuantity() const { return holding_.quantity; }
    /// Average purchase price, in the currency of the company's market.
    float getBuyQuote() const { return holding_.buyQuote; }
    /// The company's price at the state's day, 0 without a company.
    float getQuote() const { return quote_; }
    /// End of the investment horizon, undefined before the first purchase.
    Date getEndDate() const { return holding_.endDate.date(); }
    /// The state's day, undefined without a state.
    Date getDate() const;
    const String& getCompanyAbbreviation() const;
    const String& getCompanyName() const;
    const String& getCurrencyRepresentation() const;

    int getShare(Share** out) const { return share_.get(out); }
    /// The same; null when there is none.
    Share* share() const { return share_.partner(); }
    int setShare(Share* share) { return share_.set(this, share); }
    int getState(State** out) const { return state_.get(out); }
    /// The same; null when there is none.
    State* state() const { return state_.partner(); }
    int setState(State* state);

private:
    friend class ShareToShareStates;
    friend class StateToShareStates;
    friend class DailyStates;

    /// With everything known already.
    ShareState(Share& share, State& state, const Holding& holding, float quote);

    bool replay(const Date& date, Account** sellingAccount);

    // Of these there is one for each holding and day of an evolution: what follows a link takes what the link leaves
    // of its last word.
    [[no_unique_address]] ShareStatesToShare share_;
    float quote_ = 0;
    ShareStatesToState state_;
    Holding holding_;
};
