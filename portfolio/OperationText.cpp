#include "portfolio/OperationText.h"

#include "foundation/NumberText.h"
#include "portfolio/Account.h"
#include "portfolio/CashMove.h"
#include "portfolio/OperationKind.h"
#include "portfolio/Share.h"
#include "portfolio/ShareOperation.h"
#include "portfolio/TransferAccountOperation.h"

#include <cmath>

namespace {

std::string textOf(const String& text)
{
    return std::string(text.bytes());
}

/// The move on the account that lists the operation, or will.
double ownMove(const Operation& operation, const Wallet& wallet)
{
    if (operation.getType() != Operation::kBuy && operation.getType() != Operation::kSell)
        return ownCashMove(operation);
    const auto& trade = static_cast<const ShareOperation&>(operation);
    return trade.isBuy() ? -purchaseCost(trade, wallet) : saleProceeds(trade, wallet);
}

std::string endText(double move, bool isOut, const Account& account)
{
    const std::string symbol = textOf(account.getCurrencyRepresentation());
    return amountText(std::abs(move)) + (symbol.empty() ? "" : ' ' + symbol) + (isOut ? " from " : " to ") +
           textOf(account.getName());
}

const Account* recipientOf(const Operation& operation)
{
    const auto* transfer = dynamic_cast<const TransferAccountOperation*>(&operation);
    return transfer != nullptr ? transfer->recipient() : nullptr;
}

std::string sharesText(const ShareOperation& trade)
{
    const Share* share = trade.share();
    return countText(trade.getQuantity()) + (share != nullptr ? ' ' + textOf(share->getCompanyAbbreviation()) : "");
}

} // namespace

std::string moveText(const Operation& operation, const Account& account, const Account* recipient, const Wallet& wallet)
{
    double move = ownMove(operation, wallet);
    if (recipient == nullptr)
        return endText(move, move < 0 || (move == 0 && operation.getType() == Operation::kBuy), account);
    const double received = receivedCash(static_cast<const TransferAccountOperation&>(operation));
    if (recipient == &account) {
        move += received;
        return endText(move, move < 0, account);
    }
    return endText(move, move <= 0, account) + ", " + endText(received, received < 0, *recipient);
}

std::string moveText(const Operation& operation)
{
    const Account* account = operation.account();
    if (account == nullptr || account->wallet() == nullptr)
        return {};
    return moveText(operation, *account, recipientOf(operation), *account->wallet());
}

std::string deedText(const Operation& operation)
{
    const std::string move = moveText(operation);
    switch (kindOf(operation)) {
    case OperationKind::kDeposit:
        return (ownCashMove(operation) < 0 ? "Withdrew " : "Deposited ") + move;
    case OperationKind::kTransfer:
        return "Transferred " + move;
    case OperationKind::kBuy:
        return "Bought " + sharesText(static_cast<const ShareOperation&>(operation)) + ", " + move;
    case OperationKind::kSell:
        return "Sold " + sharesText(static_cast<const ShareOperation&>(operation)) + ", " + move;
    case OperationKind::kIncome:
        return "Income of " + move;
    case OperationKind::kCharge:
        return "Charge of " + move;
    }
    return move;
}
