#include "views/OperationListView.h"

#include "foundation/DateText.h"
#include "foundation/NumberText.h"
#include "platform/View.h"
#include "portfolio/Account.h"
#include "portfolio/OperationKind.h"
#include "portfolio/Share.h"
#include "portfolio/ShareOperation.h"
#include "portfolio/TransferAccountOperation.h"
#include "views/Look.h"
#include "views/ModelText.h"

namespace {

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

Cell accountName(const OperationItem& item)
{
    const Account* account = item.object()->account();
    return {account != nullptr ? textOf(account->getName()) : ""};
}

/// Ticker and company, or the account that receives a transfer.
Cell what(const OperationItem& item)
{
    const Operation& operation = *item.object();
    if (isTrade(operation)) {
        const Share* share = asTrade(operation).share();
        if (share == nullptr)
            return {"no company", look::kWarning};
        return {textOf(share->getCompanyAbbreviation()) + "  " + textOf(share->getCompanyName())};
    }
    if (kindOf(operation) != OperationKind::kTransfer)
        return {}; // what comes in or goes is within the account
    const Account* recipient = asTransfer(operation).recipient();
    if (recipient == nullptr)
        return {"to no account", look::kWarning};
    return {"to " + textOf(recipient->getName())};
}

/// The quote of a trade, the amount of anything else.
float price(const Operation& operation)
{
    if (kindOf(operation) == OperationKind::kIncome)
        return -asTransfer(operation).getCost();
    return isTrade(operation) ? asTrade(operation).getQuote()
                              : static_cast<const AccountOperation&>(operation).getAmount();
}

Cell quantity(const OperationItem& item)
{
    return {isTrade(*item.object()) ? countText(asTrade(*item.object()).getQuantity()) : ""};
}

Cell cost(const OperationItem& item)
{
    const Operation& operation = *item.object();
    if (isTrade(operation))
        return {amountText(asTrade(operation).getOperationCost())};
    return {kindOf(operation) == OperationKind::kTransfer ? amountText(asTransfer(operation).getTotalCost()) : ""};
}

/// What is traded or moved, before costs, in the account's currency.
Cell total(const OperationItem& item)
{
    const Operation& operation = *item.object();
    const double quantity = isTrade(operation) ? asTrade(operation).getQuantity() : 1;
    return {amountText(quantity * price(operation)) + ' ' + textOf(operation.getCurrencyRepresentation())};
}

} // namespace

const std::vector<ColumnOf<OperationItem>> OperationItem::kColumns = {
    {{"Date", 78}, [](const OperationItem& i) { return Cell{dateText(i.object()->getDate())}; }},
    {{"Account", 106}, accountName},
    {{"Type", 58}, [](const OperationItem& i) { return Cell{nameOf(kindOf(*i.object()))}; }},
    {{"What", 128}, what},
    {{"Quantity", 64, B_ALIGN_RIGHT}, quantity},
    {{"Quote/Amount", 98, B_ALIGN_RIGHT}, [](const OperationItem& i) { return Cell{amountText(price(*i.object()))}; }},
    {{"Cost", 62, B_ALIGN_RIGHT}, cost},
    {{"Total", 118, B_ALIGN_RIGHT}, total},
    {{"Auto", 36, B_ALIGN_CENTER}, [](const OperationItem& i) { return Cell{i.isAutomatic() ? "\u2713" : ""}; }},
};

void OperationItem::DrawItem(BView* owner, BRect frame, bool complete)
{
    if (isAutomatic_ && !IsSelected()) {
        // A selected row keeps the ground that the list has painted.
        const rgb_color text = owner->HighColor();
        owner->SetHighColor(look::kGenerated);
        owner->FillRect(frame);
        owner->SetHighColor(text);
    }
    if (light_ > 0) {
        constexpr float kStrongest = 230;
        constexpr float kDarkened = 0.5F; // from here on the text of a selected row can be read on the light only
        const rgb_color text = owner->HighColor();
        rgb_color ground = look::kNew;
        ground.alpha = static_cast<std::uint8_t>(light_ * kStrongest);
        owner->SetHighColor(ground);
        owner->SetDrawingMode(B_OP_ALPHA);
        owner->FillRect(frame);
        owner->SetDrawingMode(B_OP_COPY);
        owner->SetHighColor(light_ > kDarkened ? look::kText : text);
    }
    // The text has the colour again that the list has set.
    ColumnItem::DrawItem(owner, frame, complete);
}
