#pragma once

#include "foundation/Date.h"
#include "foundation/String.h"
#include "platform/CheckBox.h"
#include "views/DateControl.h"
#include "views/ListPlaces.h"
#include "views/PageView.h"
#include "views/StateLists.h"

#include <functional>
#include <utility>
#include <vector>

class BButton;
class BSearchControl;
class BStringView;
class Currency;
class EvolutionChart;
class State;
enum class EvolutionOutcome;
struct EvolutionPoint;
struct HoldingFigures;
struct QuoteCoverage;
struct Returns;
struct Totals;

/// The page of the portfolio as it stands on a day: totals, accounts, holdings, and how its value came about.
class WalletView final : public PageView {
public:
    WalletView(BRect frame, const char* name, BWindow* window);
    ~WalletView() override;

    void setDate(const Date& date) { date_->setDate(date); }
    /// The day that is valued; undefined while the field holds no date.
    Date getDate() const { return date_->getDate(); }
    bool isComputeEvolution() const { return computeEvolution_->Value() == B_CONTROL_ON; }

    /// Shows `state`, its totals and the figures of its holdings; null empties the page. What was selected before
    /// `ClearState` is selected again, where it still is.
    void SetState(const State* state, const Totals& totals, const std::vector<HoldingFigures>& figures);
    /// Says beside the totals how many of the quotes that they rest on are not of `day`, or else of the rates.
    void showCoverage(const Date& day, const QuoteCoverage& quotes, const QuoteCoverage& rates);
    /// The last day with all quotes, where the page speaks of one; otherwise undefined.
    Date lastQuotedDay() const { return lastQuotedDay_; }
    /// Shows the returns from `first` to `last`. The time-weighted one needs daily values, without which the page says
    /// how to get them.
    void showReturns(const Returns& returns, const Date& first, const Date& last, bool hasDays);
    /// The first and the last day that the chart shows; undefined without one.
    std::pair<Date, Date> daysInView() const;
    /// `hook` is called when a person has changed which.
    void setRangeHook(const std::function<void()>& hook);
    /// Empties the page before its state is destroyed, keeping in mind what was selected.
    void ClearState();
    /// What was selected belongs to a portfolio that is gone.
    void ForgetSelection();
    /// Fills the chart with values, by date, in the reference currency, null without one, or says why there are none.
    void UpdateEvolution(const std::vector<EvolutionPoint>& points, const Currency* reference,
                         EvolutionOutcome outcome);
    /// Without the tick there is no chart, and the list of holdings has its room.
    void ClearEvolution();

    /// The holdings that the filter lets through, in the order in which they show.
    std::vector<const ShareState*> shownHoldings() const { return shares_->allShown(); }

    void AboutToShrink() override { showChart(true); }
    void Shrunk() override;

    String getAccountName() const { return accountName_->Text(); }
    void setAccountName(const String& name) { showText(*accountName_, name); }
    /// The symbol as it was typed.
    String getAccountCurrency() const { return accountCurrency_->Text(); }
    void setAccountCurrency(const String& representation) { showText(*accountCurrency_, representation); }
    bool isDefaultTransferAccount() const { return defaultTransferAccount_->Value() == B_CONTROL_ON; }
    void setDefaultTransferAccount(bool isDefault) { defaultTransferAccount_->SetValue(isDefault); }
    /// What is selected and in view in the lists of accounts and of holdings.
    std::pair<ListPlaces, ListPlaces> selections() const;
    /// Sends no message.
    void restoreSelections(const std::pair<ListPlaces, ListPlaces>& selections);
    /// Null when no account is selected.
    AccountState* GetSelectedAccountState() const;
    /// Fills the account list; null empties it.
    void SetAccountStateList(const State* state);

private:
    void makeTop();
    void makeTotals();
    void makeAccounts();
    void makeHoldings();
    void makeChart();
    void makeCoverage();
    void makeReturns();
    void hideReturns();
    void hideCoverage();
    void showChart(bool isShown);
    void tellFiltered();
    void showTotals(const Totals& totals);

    DateControl* date_ = nullptr;
    BCheckBox* computeEvolution_ = nullptr;
    BBox* totalsBox_ = nullptr;
    BTextControl* totalDeposit_ = nullptr;
    BTextControl* totalValue_ = nullptr;
    BTextControl* profit_ = nullptr;
    BTextControl* annualRevenue_ = nullptr;
    BStringView* coverage_ = nullptr;
    BButton* goToLastQuotes_ = nullptr;
    Date lastQuotedDay_;
    BStringView* returnRange_ = nullptr;
    BStringView* moneyWeighted_ = nullptr;
    BStringView* timeWeighted_ = nullptr;
    AccountStateListView* accounts_ = nullptr;
    BTextControl* accountName_ = nullptr;
    BTextControl* accountCurrency_ = nullptr;
    BCheckBox* defaultTransferAccount_ = nullptr;
    BBox* holdingsBox_ = nullptr;
    float holdingsHeight_ = 0; // of the box above a chart
    ShareStateListView* shares_ = nullptr;
    BSearchControl* filter_ = nullptr; // of the holdings
    EvolutionChart* evolution_ = nullptr;
    BStringView* noEvolution_ = nullptr; // why there is none, in the chart
};
