#include "exchange/BookedOperations.h"

#include "portfolio/Account.h"
#include "portfolio/Share.h"
#include "portfolio/ShareOperation.h"
#include "portfolio/TransferAccountOperation.h"
#include "portfolio/Wallet.h"

#include <bit>

namespace {

/// Equal for equal numbers, and in some order for any, those included that are no numbers.
std::uint32_t bitsOf(float amount)
{
    return std::bit_cast<std::uint32_t>(amount + 0.0F); // 0 has no sign
}

} // namespace

BookedOperations::BookedOperations(const Wallet& wallet)
{
    for (const Account* account : wallet.accounts())
        for (const Operation* operation : account->operations())
            if (!operation->isAutomatic())
                ++left_[keyOf(*operation)];
}

bool BookedOperations::take(const Key& key)
{
    const auto found = left_.find(key);
    if (found == left_.end() || found->second == 0)
        return false;
    --found->second;
    return true;
}

BookedOperations::Key BookedOperations::keyOf(const Operation& operation)
{
    const OperationKind kind = kindOf(operation);
    const Date& date = operation.getDate();
    if (kind == OperationKind::kBuy || kind == OperationKind::kSell) {
        const auto& trade = static_cast<const ShareOperation&>(operation);
        const Company* company = trade.share() != nullptr ? trade.share()->company() : nullptr;
        return {date, trade.account(), nullptr, kind, company, static_cast<std::uint32_t>(trade.getQuantity())};
    }
    const auto& cash = static_cast<const AccountOperation&>(operation);
    if (kind == OperationKind::kDeposit)
        return {date, cash.account(), nullptr, kind, nullptr, bitsOf(cash.getAmount())};
    const auto& transfer = static_cast<const TransferAccountOperation&>(operation);
    const bool isIncome = kind == OperationKind::kIncome;
    return {date,
            transfer.account(),
            kind == OperationKind::kTransfer ? transfer.recipient() : nullptr,
            kind,
            nullptr,
            bitsOf(isIncome ? -transfer.getCost() : transfer.getAmount())};
}

/// Of an account that is still to be made nothing is found: no operation is on none.
BookedOperations::Key BookedOperations::keyOf(const PlannedOperation& operation)
{
    const Account* recipient = operation.recipient != nullptr ? operation.recipient->account : nullptr;
    return {operation.date,
            operation.account->account,
            recipient,
            operation.kind,
            operation.company,
            operation.isTrade() ? static_cast<std::uint32_t>(operation.quantity) : bitsOf(operation.amount)};
}
