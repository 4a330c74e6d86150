#pragma once

#include "portfolio/Operation.h"
#include "portfolio/PortfolioLinks.h"

/// A purchase or sale of a number of shares at a price, paid from or to a cash account; listed by both the account and
/// the holding. An automatic sale has no account.
///
/// With q shares at quote c and fixed cost k, a purchase takes c * q * (1 + buy rate cost) + k from the account, a
/// sale gives it c * q * (1 - sell rate cost) - k.
class ShareOperation final : public Operation {
public:
    ShareOperation() = default;
    /// Links the holding only; the account is linked by `setAccount`.
    ShareOperation(const Date& date, Share* share, bool buy, int quantity, float quote, bool automatic,
                   float operationCost);
    ~ShareOperation() override;

    /// File: "Y" or "N" for a purchase, market name, ticker, quantity (i32), quote (f32), date, cost (f32).
    /// `wrt` returns -1 without a holding.
    int wrt(FILE* file) const override;
    /// @return 0; -1 when the file ends inside the record, and when the account's wallet has no such holding.
    int rd(FILE* file) override;
    short getType() const override { return buy_ ? kBuy : kSell; }

    bool isBuy() const { return buy_; }
    void setBuy(bool buy) { buy_ = buy; }
    int getQuantity() const { return quantity_; }
    void setQuantity(int quantity) { quantity_ = quantity; }
    /// Price of one share, in the currency of its market.
    float getQuote() const { return quote_; }
    void setQuote(float quote) { quote_ = quote; }
    /// Fixed cost of this one operation.
    float getOperationCost() const { return operationCost_; }
    void setOperationCost(float cost) { operationCost_ = cost; }

    int getShare(Share** out) const { return share_.get(out); }
    /// The same; null when there is none.
    Share* share() const { return share_.partner(); }
    int setShare(Share* share);

    /// The wallet's present buy or sell rate cost, 0 without a wallet. Intended: only the fixed cost is recorded with
    /// the operation, so a changed rate counts for past operations too.
    float getOperationRateCost() const;

protected:
    void notifyChange() override;

private:
    friend class ShareToShareOperations;

    ShareOperationsToShare share_;
    bool buy_ = false;
    int quantity_ = 0;
    float quote_ = 0;
    float operationCost_ = 0;
};
