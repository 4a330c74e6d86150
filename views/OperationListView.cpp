#include "views/OperationListView.h"

#include "foundation/DateText.h"
#include "foundation/NumberText.h"
#include "platform/View.h"
#include "portfolio/Account.h"
#include "portfolio/Share.h"
#include "portfolio/ShareOperation.h"
#include "portfolio/TransferAccountOperation.h"
#include "views/Look.h"
#include "views/ModelText.h"

namespace {

enum Column { kDate, kAccount, kType, kWhat, kQuantity, kPrice, kCost, kTotal, kAutomatic };

constexpr const char* kTypeNames[] = {"?", "Deposit", "Transfer", "Buy", "Sell"}; // by type code

bool isTrade(const Operation& operation)
{
    return operation.getType() == Operation::kBuy || operation.getType() == Operation::kSell;
}

const ShareOperation& asTrade(const Operation& operation)
{
    return static_cast<const ShareOperation&>(operation);
}

const TransferAccountOperation& asTransfer(const Operation& operation)
{
    return static_cast<const TransferAccountOperation&>(operation);
}

std::string accountName(const Operation& operation)
{
    return operation.account() != nullptr ? textOf(operation.account()->getName()) : std::string();
}

/// Ticker and company, or the account that receives a transfer.
Cell what(const Operation& operation)
{
    if (isTrade(operation)) {
        const Share* share = asTrade(operation).share();
        if (share == nullptr)
            return {"no company", look::kWarning};
        return {textOf(share->getCompanyAbbreviation()) + "  " + textOf(share->getCompanyName())};
    }
    if (operation.getType() != Operation::kTransfer)
        return {};
    const Account* recipient = asTransfer(operation).recipient();
    if (recipient == nullptr)
        return {"to no account", look::kWarning};
    return {"to " + textOf(recipient->getName())};
}

/// The quote of a trade, the amount of anything else.
float price(const Operation& operation)
{
    return isTrade(operation) ? asTrade(operation).getQuote()
                              : static_cast<const AccountOperation&>(operation).getAmount();
}

std::string cost(const Operation& operation)
{
    if (isTrade(operation))
        return amountText(asTrade(operation).getOperationCost());
    return operation.getType() == Operation::kTransfer ? amountText(asTransfer(operation).getTotalCost()) : "";
}

/// What is traded or moved, before costs, in the account's currency.
std::string total(const Operation& operation)
{
    const double quantity = isTrade(operation) ? asTrade(operation).getQuantity() : 1;
    return amountText(quantity * price(operation)) + ' ' + textOf(operation.getCurrencyRepresentation());
}

} // namespace

Cell OperationItem::cell(int column) const
{
    // Released: the row is blank until it is dropped.
    if (operation_ == nullptr)
        return {};
    const Operation& operation = *operation_;
    switch (column) {
    case kDate:
        return {dateText(operation.getDate())};
    case kAccount:
        return {accountName(operation)};
    case kType:
        return {kTypeNames[operation.getType()]};
    case kWhat:
        return what(operation);
    case kQuantity:
        return {isTrade(operation) ? countText(asTrade(operation).getQuantity()) : ""};
    case kPrice:
        return {amountText(price(operation))};
    case kCost:
        return {cost(operation)};
    case kTotal:
        return {total(operation)};
    case kAutomatic:
        return {isAutomatic_ ? "\u2713" : ""};
    default:
        return {};
    }
}

void OperationItem::DrawItem(BView* owner, BRect frame, bool complete)
{
    if (isAutomatic_ && !IsSelected()) {
        const rgb_color text = owner->HighColor();
        owner->SetHighColor(look::kGenerated);
        owner->FillRect(frame);
        owner->SetHighColor(text);
    }
    // The text has the colour again that the list has set.
    ColumnItem::DrawItem(owner, frame, complete);
}

OperationListView::OperationListView(const char* name)
    : ObjectListView({}, name, B_SINGLE_SELECTION_LIST,
                     {{"Date", 78},
                      {"Account", 106},
                      {"Type", 58},
                      {"What", 128},
                      {"Quantity", 64, B_ALIGN_RIGHT},
                      {"Quote/Amount", 98, B_ALIGN_RIGHT},
                      {"Cost", 62, B_ALIGN_RIGHT},
                      {"Total", 118, B_ALIGN_RIGHT},
                      {"Auto", 36, B_ALIGN_CENTER}})
{}
