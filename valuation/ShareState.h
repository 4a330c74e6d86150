#pragma once

#include "foundation/Date.h"
#include "foundation/Pooled.h"
#include "foundation/String.h"
#include "portfolio/Share.h"
#include "valuation/SharedHolding.h"
#include "valuation/StateLinks.h"

#include <optional>

class Account;

/// What the quote of a holding rests on, on the day of its state.
struct QuoteBasis {
    bool isKnown = false;    ///< false without any quote: the holding counts as 0 then
    bool hasRate = false;    ///< whether the quote's currency has a rate: without one the holding counts as 0, too
    bool isEstimate = false; ///< outside the series, where the quote is on a straight line
    Date day;                ///< of the quote that counts, or that the estimate starts from
};

/// One holding at the day of a state.
class ShareState final : public Pooled<ShareState, (std::size_t{128} << 20)> {
public:
    /// Replays the holding's operations up to and including `date`, moving cash in the account states of `state`.
    /// `automatic` also searches the automatic sale of what is held, when no operation is dated after `date`.
    ShareState(Share* share, State* state, const Date& date, bool automatic);
    ~ShareState();
    ShareState(const ShareState&) = delete;
    ShareState& operator=(const ShareState&) = delete;

    /// Number of shares held; negative when more were sold than held.
    int getQuantity() const { return holding_->quantity; }
    /// False for what was sold whole; such a holding stays in the portfolio.
    bool isHeld() const { return holding_->quantity != 0; }
    /// Average purchase price, in the currency of the company's market.
    float getBuyQuote() const { return holding_->buyQuote; }
    /// The company's price at the state's day, 0 without a company.
    float getQuote() const { return quote_; }
    /// By the company's quotes as they are now.
    QuoteBasis quoteBasis() const;
    /// Quantity times quote.
    double worth() const { return static_cast<double>(quote_) * holding_->quantity; }
    /// Change from the average purchase price to the quote, a fraction. Nothing where that says nothing: nothing is
    /// held, the company has no quote, or the purchase price is 0.
    std::optional<double> gain() const;
    /// End of the investment horizon, undefined before the first purchase.
    Date getEndDate() const { return holding_->endDate.date(); }
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

    /// With everything known already. The state has just been made and is in no list: both are entered without asking.
    ShareState(Share& share, StateToShareStates& states, const SharedHolding& holding, float quote)
        : quote_(quote), holding_(holding)
    {
        ShareStatesToShare::list(share).addNew(this);
        states.addNew(this);
    }

    bool replay(const Date& date, Account** sellingAccount);

    // Of these there is one for each holding and day of an evolution: what follows a link takes what the link leaves
    // of its last word.
    [[no_unique_address]] ShareStatesToShare share_;
    float quote_ = 0;
    [[no_unique_address]] ShareStatesToState state_;
    SharedHolding holding_;
};
