#pragma once

#include "foundation/Date.h"
#include "foundation/Serializable.h"
#include "foundation/String.h"
#include "portfolio/Account.h"
#include "portfolio/Share.h"
#include "portfolio/WalletToStates.h"

#include <vector>

class Catalogue;
class Company;
class Currency;
class Market;
class WalletNames;

/// The portfolio: cash accounts, holdings, the states computed for it, and the ten trading parameters.
///
/// Owns accounts, holdings and states. Markets and currencies belong to the catalogue; the wallet keeps its own lists
/// of them, to find what its file names.
class Wallet final : public Serializable {
public:
    Wallet();
    virtual ~Wallet();

    /// Wallets have dated records only; these two do nothing and return -1.
    int wrt(FILE* file) const override;
    int rd(FILE* file) override;
    /// @return 0; -1, with the file incomplete, when an account has no currency name or a write failed.
    int wrt(FILE* file, const Date& stamp) const;
    /// Replaces the content by the file's. Markets and currencies have been set before. `*stamp` becomes the date at
    /// the head of the file; `stamp` may be null.
    /// @return 0; -1 at a company, currency or holding that is not known, and at the end of the file: what was read
    /// whole before that stays. The unknown company is reported on standard output.
    int rd(FILE* file, Date* stamp);
    /// The ticker or currency name for which the last `rd` failed; undefined when that was not the reason.
    const String& getUnknownName() const { return unknownName_; }

    int addAccount(Account* account) { return accounts_.add(account); }
    int removeAccount(Account* account) { return accounts_.remove(account); }
    unsigned getNbrAccounts() const { return accounts_.getNbr(); }
    Account** getAllAccounts(unsigned* n) const { return accounts_.getAll(n); }
    std::span<Account* const> accounts() const { return accounts_.all(); }
    Account* getAccount(unsigned i) const { return accounts_.at(i); }
    /// `*place` becomes the account's index in the list. @return 0; -1 when it is not in it, or null.
    int getAccountPlace(Account* account, unsigned* place) const { return accounts_.getElement(account, place); }

    int addShare(Share* share) { return shares_.add(share); }
    int removeShare(Share* share) { return shares_.remove(share); }
    unsigned getNbrShares() const { return shares_.getNbr(); }
    Share** getAllShares(unsigned* n) const { return shares_.getAll(n); }
    std::span<Share* const> shares() const { return shares_.all(); }

    int addState(State* state);
    int removeState(State* state);
    unsigned getNbrStates() const { return states_.getNbr(); }
    State** getAllStates(unsigned* n) const { return states_.getAll(n); }
    std::span<State* const> states() const { return states_.all(); }
    /// Destroys all states.
    void removeAllStates() { states_.deleteAll(); }

    /// Keep copies of the pointers; what they point to is never freed here.
    void setCurrencies(int count, Currency** currencies);
    void setMarkets(int count, Market** markets);
    /// Both of them at once, as they are in the catalogue now.
    void setCatalogue(const Catalogue& catalogue);

    /// The look-ups below give the first match. @return 0; -1 and a null `*out` when there is none.
    int getCurrency(const String& name, Currency** out) const;
    int getCompany(const String& market, const String& abbreviation, Company** out) const;
    int getShare(const String& market, const String& abbreviation, Share** out) const;
    /// Null when there is none.
    Account* getAccountByName(const String& name) const;
    /// The account that automatic profits in this currency go to: the first one flagged for it, otherwise the first
    /// one in the currency, null when there is none.
    Account* findDefaultTransferAccount(const String& currencyRepresentation) const;

    /// Destroys the automatic operations that accounts list. Intended: automatic sales are in no account's list and
    /// stay until the wallet is loaded again.
    void removeAutomaticOperations();

    /// Fixed cost of one purchase or sale, in the account's currency: what a new operation starts with.
    float getBuyCost() const { return buyCost_; }
    void setBuyCost(float cost) { buyCost_ = cost; }
    float getSellCost() const { return sellCost_; }
    void setSellCost(float cost) { sellCost_ = cost; }
    /// Proportional cost, a fraction of the traded value.
    float getBuyRateCost() const { return buyRateCost_; }
    void setBuyRateCost(float rate) { buyRateCost_ = rate; }
    float getSellRateCost() const { return sellRateCost_; }
    void setSellRateCost(float rate) { sellRateCost_ = rate; }
    /// Length of the investment horizon, in days.
    short getInvestementPeriod() const { return investementPeriod_; }
    void setInvestementPeriod(short days) { investementPeriod_ = days; }
    /// Ratios to the average buy quote, at the begin and the end of the horizon: above the profit rate a holding is
    /// sold with profit, below the lose rate at a loss.
    float getBeginProfitSellRate() const { return beginProfitSellRate_; }
    void setBeginProfitSellRate(float rate) { beginProfitSellRate_ = rate; }
    float getEndProfitSellRate() const { return endProfitSellRate_; }
    void setEndProfitSellRate(float rate) { endProfitSellRate_ = rate; }
    float getBeginLoseSellRate() const { return beginLoseSellRate_; }
    void setBeginLoseSellRate(float rate) { beginLoseSellRate_ = rate; }
    float getEndLoseSellRate() const { return endLoseSellRate_; }
    void setEndLoseSellRate(float rate) { endLoseSellRate_ = rate; }
    /// The part of an automatic sale's net profit that stays in the selling account.
    float getReinvestRate() const { return reinvestRate_; }
    void setReinvestRate(float rate) { reinvestRate_ = rate; }

private:
    friend class AccountsToWallet;
    friend class SharesToWallet;
    friend class StatesToWallet;
    int readShares(FILE* file);
    int readAccounts(FILE* file);
    void readParameters(FILE* file);
    void writeParameters(FILE* file) const;

    WalletToShares shares_;
    WalletToAccounts accounts_;
    WalletToStates states_;
    std::vector<Market*> markets_;      // not owned
    std::vector<Currency*> currencies_; // not owned
    WalletNames* names_ = nullptr;      // only while a file is read
    String unknownName_;

    float buyCost_ = 29.95F;
    float sellCost_ = 29.95F;
    float buyRateCost_ = 0.0017F;
    float sellRateCost_ = 0.0017F;
    short investementPeriod_ = 90;
    float beginProfitSellRate_ = 2.0F;
    float endProfitSellRate_ = 1.1F;
    float beginLoseSellRate_ = 0.8F; // equal to the end rate: by default the loss limit stands still
    float endLoseSellRate_ = 0.8F;
    float reinvestRate_ = 0.9F;
};
