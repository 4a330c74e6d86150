#include "views/AccountStateListView.h"

#include "foundation/NumberText.h"
#include "market/Currency.h"
#include "portfolio/Account.h"
#include "views/Look.h"
#include "views/ModelText.h"

namespace {

enum Column { kName, kBalance, kCurrency, kDefault };

} // namespace

AccountStateItem::AccountStateItem(AccountState* state) : state_(state), account_(state->account()) {}

Cell AccountStateItem::cell(int column) const
{
    const Currency* currency = account_ != nullptr ? account_->currency() : nullptr;
    // Name and currency are the account's as they are now, the balance is that of the valuation.
    switch (column) {
    case kName:
        return {textOf(state_->getAccountName())};
    case kBalance:
        return {amountText(state_->getCash()), state_->getCash() < 0 ? look::kLoss : look::kText};
    case kCurrency:
        // Such a balance counts as 0 in the totals.
        if (currency == nullptr)
            return {"no currency", look::kWarning};
        if (currency->getNbrQuotes() == 0)
            return {textOf(currency->getRepresentation()) + " (no rate)", look::kWarning};
        return {textOf(currency->getRepresentation())};
    case kDefault:
        return {account_ != nullptr && account_->isDefaultTransferAccount() ? "\u2713" : ""};
    default:
        return {};
    }
}

AccountStateListView::AccountStateListView(const char* name)
    : ObjectListView(
          {}, name, B_SINGLE_SELECTION_LIST,
          {{"Account", 172}, {"Balance", 100, B_ALIGN_RIGHT}, {"Currency", 96}, {"Default", 56, B_ALIGN_CENTER}})
{}
