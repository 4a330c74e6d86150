#pragma once

#include "foundation/Date.h"
#include "foundation/Serializable.h"
#include "foundation/String.h"
#include "market/Company.h"
#include "portfolio/PortfolioLinks.h"
#include "portfolio/ShareOperation.h"

/// The wallet's holding of one company: ties the wallet to the company and lists the buys and sells, manual and
/// automatic. Quantity, average price and value at a day are computed by a `ShareState`.
///
/// Owns its operations and its states.
class Share final : public Serializable {
public:
    Share();
    Share(Wallet* wallet, Company* company);
    virtual ~Share();

    /// A holding has no record of its own: the wallet writes its names. Both do nothing and return 0.
    int wrt(FILE*) const override { return 0; }
    int rd(FILE*) override { return 0; }

    int getWallet(Wallet** out) const { return wallet_.get(out); }
    /// The same; null when there is none.
    Wallet* wallet() const { return wallet_.partner(); }
    int setWallet(Wallet* wallet);
    int getCompany(Company** out) const { return company_.get(out); }
    /// The same; null when there is none.
    Company* company() const { return company_.partner(); }
    int setCompany(Company* company) { return company_.set(this, company); }

    int addShareOperation(ShareOperation* operation) { return operations_.add(operation); }
    int removeShareOperation(ShareOperation* operation) { return operations_.remove(operation); }
    unsigned getNbrShareOperations() const { return operations_.getNbr(); }
    ShareOperation** getAllShareOperations(unsigned* n) const { return operations_.getAll(n); }
    std::span<ShareOperation* const> shareOperations() const { return operations_.all(); }
    ShareOperation* getShareOperation(unsigned i) const { return operations_.at(i); }
    /// To be called when the date of one of the operations has changed.
    void shareOperationChanged() { operations_.changeNotice(); }

    int addShareState(ShareState* state);
    int removeShareState(ShareState* state);
    unsigned getNbrShareStates() const { return states_.getNbr(); }
    ShareState** getAllShareStates(unsigned* n) const { return states_.getAll(n); }
    std::span<ShareState* const> shareStates() const { return states_.all(); }
    ShareState* getShareState(unsigned i) const { return states_.at(i); }
    /// Makes room for as many states; only a saving.
    void reserveShareStates(unsigned n) { states_.reserve(n); }

    /// Names of the company and its market; Strings without text where the link is missing.
    const String& getMarketName() const;
    const String& getCompanyAbbreviation() const
    {
        return company() != nullptr ? company()->getAbbreviation() : String::none();
    }
    const String& getCompanyName() const { return company() != nullptr ? company()->getName() : String::none(); }

    /// The company's price for any day, 0 without a company. @return 0; -1 without a company.
    int getQuote(const Date& date, float* out) const;
    /// The company's trend on that day, 0 without a company.
    float getPrevisionQuote(const Date& date) const
    {
        return company() != nullptr ? company()->getPrevisionQuote(date) : 0;
    }

    /// Destroys the automatic operations of this holding.
    void removeAutomaticShareOperations();

private:
    friend struct ShareOperationsToShare;
    friend struct ShareStatesToShare;
    friend class CompanyToShares;
    friend class WalletToShares;

    SharesToWallet wallet_;
    SharesToCompany company_;
    ShareToShareOperations operations_;
    ShareToShareStates states_;
};
