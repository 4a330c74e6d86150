#pragma once

#include "chart/GraphLine.h"
#include "foundation/Date.h"
#include "foundation/String.h"
#include "views/PageView.h"

class AccountState;
class BStringView;
class AccountStateListView;
class Catalogue;
class DateControl;
class GraphView;
class ShareStateListView;
class State;
class Wallet;
enum class EvolutionOutcome;
struct Totals;

/// The page of the portfolio as it stands on a day: totals, accounts, holdings, and how its value came about.
class WalletView final : public PageView {
public:
    WalletView(BRect frame, const char* name, BWindow* window);
    ~WalletView() override;

    void setDate(const Date& date);
    /// The day that is valued; undefined while the field holds no date.
    Date getDate() const;
    bool isComputeEvolution() const;

    /// Shows `state` by the rates of `catalogue`; null empties the page. What was selected before `ClearState` is
    /// selected again, where it still is.
    void SetState(const State* state, const Catalogue& catalogue);
    /// Empties the page before its state is destroyed, keeping in mind what was selected.
    void ClearState();
    /// What was selected belongs to a portfolio that is gone.
    void ForgetSelection();
    /// Fills the chart with the wallet's states, or says why there are none.
    void UpdateEvolution(const Wallet& wallet, const Catalogue& catalogue, EvolutionOutcome outcome);
    void ClearEvolution();

    String getAccountName() const;
    void setAccountName(const String& name);
    /// The symbol as it was typed.
    String getAccountCurrency() const;
    void setAccountCurrency(const String& representation);
    bool isDefaultTransferAccount() const;
    void setDefaultTransferAccount(bool isDefault);
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
    void showTotals(const Totals& totals, const std::string& symbol, bool hasRate);
    void showNoTotals();

    DateControl* date_ = nullptr;
    BCheckBox* computeEvolution_ = nullptr;
    BBox* totalsBox_ = nullptr;
    BTextControl* totalDeposit_ = nullptr;
    BTextControl* totalValue_ = nullptr;
    BTextControl* profit_ = nullptr;
    BTextControl* annualRevenu_ = nullptr;
    AccountStateListView* accounts_ = nullptr;
    BTextControl* accountName_ = nullptr;
    BTextControl* accountCurrency_ = nullptr;
    BCheckBox* defaultTransferAccount_ = nullptr;
    ShareStateListView* shares_ = nullptr;
    GraphView* evolution_ = nullptr;
    BStringView* noEvolution_ = nullptr; // why there is none, in the chart
    GraphLine line_;                     // in the chart
};
