#pragma once

#include "portfolio/AccountOperation.h"
#include "portfolio/PortfolioLinks.h"

/// Money moved from one account to another, listed by both: by the sender among its operations, by the recipient among
/// its transfers. The sender owns it.
///
/// The sender pays the larger of the amount and the fixed cost; the recipient gets
///     (from quote / to quote) * (amount * (1 - rate cost) - cost).
class TransferAccountOperation final : public AccountOperation {
public:
    TransferAccountOperation() = default;
    TransferAccountOperation(const Date& date, Account* from, Account* to, float amount, bool automatic);
    ~TransferAccountOperation() override;

    /// File: recipient's name, amount, rate cost, cost, the two quotes, date.
    int wrt(FILE* file) const override;
    /// @return 0; -1 when the file ends inside the record, and when the sender's wallet has no account of the
    /// recipient's name: then the rest of the record is left unread and the transfer as it was.
    int rd(FILE* file) override;
    short getType() const override { return kTransfer; }

    /// Proportional cost, a fraction of the amount.
    float getRateCost() const { return rateCost_; }
    void setRateCost(float rateCost) { rateCost_ = rateCost; }
    /// Fixed cost, in the sender's currency.
    float getCost() const { return cost_; }
    void setCost(float cost) { cost_ = cost; }
    /// Rates of the sender's and of the recipient's currency.
    float getFromCurrencyQuote() const { return fromCurrencyQuote_; }
    void setFromCurrencyQuote(float quote) { fromCurrencyQuote_ = quote; }
    float getToCurrencyQuote() const { return toCurrencyQuote_; }
    void setToCurrencyQuote(float quote) { toCurrencyQuote_ = quote; }

    int getRecepientAccount(Account** out) const { return recipient_.get(out); }
    /// The same; null when there is none.
    Account* recipient() const { return recipient_.partner(); }
    int setRecepientAccount(Account* account);

    /// amount * rate cost + cost: what is shown as the transfer's cost. No valuation uses it.
    float getTotalCost() const;

protected:
    void notifyChange() override;

private:
    friend class AccountToTransferOperations;

    float rateCost_ = 0;
    float cost_ = 0;
    float fromCurrencyQuote_ = 1;
    float toCurrencyQuote_ = 1;
    TransferOperationsToAccount recipient_;
};
