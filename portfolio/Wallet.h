#pragma once

#include "foundation/Date.h"
#include "foundation/Serializable.h"
#include "foundation/String.h"
#include "portfolio/Account.h"
#include "portfolio/PortfolioLinks.h"
#include "portfolio/Share.h"

#include <array>
#include <vector>

class Catalogue;
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
    int wrt(FILE*) const override { return -1; }
    int rd(FILE*) override { return -1; }
    /// @return 0; -1, with the file incomplete, when an account has no currency name or a write failed.
    int wrt(FILE* file, const Date& stamp) const;
    /// Replaces the content by the file's. Markets and currencies have been set before. `*stamp` becomes the date at
    /// the head of the file; `stamp` may be null.
    /// @return 0; -1 at a company, currency or holding that is not known, and at the end of the file: what was read
    /// whole before that stays. The unknown company is reported on standard output. A transfer that has lost its
    /// recipient is no failure, even when what is read out of place behind it meets the end.
    int rd(FILE* file, Date* stamp);
    /// Whether the last `rd` met a transfer to an account that the file does not have; `WalletDiagnosis` tells which.
    bool hasLostRecipient() const { return hasLostRecipient_; }

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
    void removeAllStates();

    /// Keep copies of the pointers; what they point to is never freed here.
    void setCurrencies(int count, Currency** currencies) { currencies_.assign(currencies, currencies + count); }
    void setMarkets(int count, Market** markets) { markets_.assign(markets, markets + count); }
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

    /// The ten trading parameters, in the order of the file and of their page.
    enum Parameter {
        kBuyCost,
        kSellCost,
        kBuyRateCost,
        kSellRateCost,
        kInvestementPeriod,
        kBeginProfitSellRate,
        kEndProfitSellRate,
        kBeginLoseSellRate,
        kEndLoseSellRate,
        kReinvestRate,
        kParameterCount
    };
    /// Each by its number, as below by its name. The period is given as a whole number of 16 bits.
    float getParameter(Parameter parameter) const { return parameters_[parameter]; }
    void setParameter(Parameter parameter, float value) { parameters_[parameter] = value; }

    /// Fixed cost of one purchase or sale, in the account's currency: what a new operation starts with.
    float getBuyCost() const { return parameters_[kBuyCost]; }
    void setBuyCost(float cost) { parameters_[kBuyCost] = cost; }
    float getSellCost() const { return parameters_[kSellCost]; }
    void setSellCost(float cost) { parameters_[kSellCost] = cost; }
    /// Proportional cost, a fraction of the traded value.
    float getBuyRateCost() const { return parameters_[kBuyRateCost]; }
    void setBuyRateCost(float rate) { parameters_[kBuyRateCost] = rate; }
    float getSellRateCost() const { return parameters_[kSellRateCost]; }
    void setSellRateCost(float rate) { parameters_[kSellRateCost] = rate; }
    /// Length of the investment horizon, in days.
    short getInvestementPeriod() const { return static_cast<short>(parameters_[kInvestementPeriod]); }
    void setInvestementPeriod(short days) { parameters_[kInvestementPeriod] = days; }
    /// Ratios to the average buy quote, at the begin and the end of the horizon: above the profit rate a holding is
    /// sold with profit, below the lose rate at a loss.
    float getBeginProfitSellRate() const { return parameters_[kBeginProfitSellRate]; }
    void setBeginProfitSellRate(float rate) { parameters_[kBeginProfitSellRate] = rate; }
    float getEndProfitSellRate() const { return parameters_[kEndProfitSellRate]; }
    void setEndProfitSellRate(float rate) { parameters_[kEndProfitSellRate] = rate; }
    float getBeginLoseSellRate() const { return parameters_[kBeginLoseSellRate]; }
    void setBeginLoseSellRate(float rate) { parameters_[kBeginLoseSellRate] = rate; }
    float getEndLoseSellRate() const { return parameters_[kEndLoseSellRate]; }
    void setEndLoseSellRate(float rate) { parameters_[kEndLoseSellRate] = rate; }
    /// The part of an automatic sale's net profit that stays in the selling account.
    float getReinvestRate() const { return parameters_[kReinvestRate]; }
    void setReinvestRate(float rate) { parameters_[kReinvestRate] = rate; }

private:
    friend struct AccountsToWallet;
    friend struct SharesToWallet;
    friend struct StatesToWallet;
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
    bool hasLostRecipient_ = false;

    // By number. The period is a whole number of 16 bits, which a float holds exactly; the two lose rates are equal, so
    // that by default the loss limit stands still.
    std::array<float, kParameterCount> parameters_{29.95F, 29.95F, 0.0017F, 0.0017F, 90, 2.0F, 1.1F, 0.8F, 0.8F, 0.9F};
};

/// The operations of all accounts, automatic ones too, by date. Those of one day stand in the order of the accounts
/// and, of each, in that of its list.
std::vector<const Operation*> operationsByDate(const Wallet& wallet);
