#include "portfolio/OperationKind.h"

#include "portfolio/TransferAccountOperation.h"

namespace {

OperationKind kindOfTransfer(const TransferAccountOperation& transfer)
{
    const bool isWithin = transfer.account() != nullptr && transfer.account() == transfer.recipient();
    if (!isWithin || transfer.getFromCurrencyQuote() != 1 || transfer.getToCurrencyQuote() != 1)
        return OperationKind::kTransfer;
    if (transfer.getAmount() == 0 && transfer.getRateCost() == 0 && transfer.getCost() < 0)
        return OperationKind::kIncome;
    if (transfer.getAmount() > 0 && transfer.getRateCost() == 1 && transfer.getCost() == 0)
        return OperationKind::kCharge;
    return OperationKind::kTransfer;
}

} // namespace

OperationKind kindOf(const Operation& operation)
{
    switch (operation.getType()) {
    case Operation::kTransfer:
        return kindOfTransfer(static_cast<const TransferAccountOperation&>(operation));
    case Operation::kBuy:
        return OperationKind::kBuy;
    case Operation::kSell:
        return OperationKind::kSell;
    default:
        return OperationKind::kDeposit;
    }
}

const char* nameOf(OperationKind kind)
{
    constexpr const char* kNames[] = {"Deposit", "Transfer", "Buy", "Sell", "Income", "Charge"};
    return kNames[static_cast<short>(kind)];
}
