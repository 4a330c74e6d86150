#include "portfolio/CashMove.h"

#include "portfolio/Account.h"
#include "portfolio/DepositAccountOperation.h"
#include "portfolio/Share.h"
#include "portfolio/ShareOperation.h"
#include "portfolio/Wallet.h"

double ownCashMove(const Operation& operation)
{
    if (operation.getType() == Operation::kDeposit)
        return static_cast<const DepositAccountOperation&>(operation).getAmount();
    if (operation.getType() != Operation::kTransfer)
        return 0;
    const auto& transfer = static_cast<const TransferAccountOperation&>(operation);
    return transfer.getAmount() < transfer.getCost() ? -transfer.getCost() : -transfer.getAmount();
}

double receivedCash(const TransferAccountOperation& transfer)
{
    const double amount = transfer.getAmount();
    const double exchange = static_cast<double>(transfer.getFromCurrencyQuote()) / transfer.getToCurrencyQuote();
    return exchange * (amount * (1.0 - transfer.getRateCost()) - transfer.getCost());
}

float purchaseCost(const ShareOperation& purchase, const Wallet& wallet)
{
    const double c = purchase.getQuote();
    const double q = purchase.getQuantity();
    return static_cast<float>(c * q + wallet.getBuyRateCost() * c * q + purchase.getOperationCost());
}

float saleProceeds(const ShareOperation& sale, const Wallet& wallet)
{
    const double c = sale.getQuote();
    const double q = sale.getQuantity();
    return static_cast<float>(c * q * (1.0 - wallet.getSellRateCost()) - sale.getOperationCost());
}

double cashMove(const Operation& operation, const Account& account)
{
    const short type = operation.getType();
    if (type == Operation::kBuy || type == Operation::kSell) {
        const auto& trade = static_cast<const ShareOperation&>(operation);
        // A trade of no holding is in no holding's replay.
        const Wallet* wallet = trade.share() != nullptr ? trade.share()->wallet() : nullptr;
        if (wallet == nullptr || trade.account() != &account)
            return 0;
        return trade.isBuy() ? -purchaseCost(trade, *wallet) : saleProceeds(trade, *wallet);
    }
    if (account.currency() == nullptr)
        return 0; // such an account is not replayed
    double move = operation.account() == &account ? ownCashMove(operation) : 0;
    if (type != Operation::kTransfer)
        return move;
    const auto& transfer = static_cast<const TransferAccountOperation&>(operation);
    if (transfer.recipient() == &account)
        move += receivedCash(transfer);
    return move;
}
