#include "valuation/CashMoves.h"

#include "market/Currency.h"
#include "portfolio/DepositAccountOperation.h"
#include "portfolio/ShareOperation.h"
#include "portfolio/TransferAccountOperation.h"
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

double depositInReference(const Operation& deposit, const Currency& currency)
{
    const double amount = static_cast<const DepositAccountOperation&>(deposit).getAmount();
    return amount * currency.getRealQuote(deposit.getDate());
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
