#include "views/OperationListView.h"

#include "foundation/DateText.h"
#include "foundation/NumberText.h"
#include "platform/View.h"
#include "portfolio/Account.h"
#include "portfolio/CashMove.h"
#include "portfolio/OperationKind.h"
#include "portfolio/Share.h"
#include "portfolio/ShareOperation.h"
#include "portfolio/TransferAccountOperation.h"
#include "views/Look.h"
#include "views/ModelText.h"

#include <algorithm>
#include <functional>
#include <set>

namespace {

constexpr std::size_t kAccountColumn = 1;
constexpr std::size_t kBalanceColumn = 9;

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

bool isTransfer(OperationKind kind)
{
    return kind == OperationKind::kTransfer;
}

const Account* recipientOf(const Operation& operation)
{
    return operation.getType() == Operation::kTransfer ? asTransfer(operation).recipient() : nullptr;
}

/// Ticker and company, or the account at the other end of a transfer.
Cell what(const OperationItem& item)
{
    const Operation& operation = *item.object();
    if (isTrade(operation)) {
        const Share* share = asTrade(operation).share();
        if (share == nullptr)
            return {"no company", look::kWarning};
        return {textOf(share->getCompanyAbbreviation()) + "  " + textOf(share->getCompanyName())};
    }
    if (!isTransfer(kindOf(operation)))
        return {};
    const Account* recipient = recipientOf(operation);
    if (recipient == nullptr)
        return {"to no account", look::kWarning};
    const Account* sender = operation.account();
    if (item.account() == recipient && sender != recipient && sender != nullptr)
        return {"from " + textOf(sender->getName())};
    return {"to " + textOf(recipient->getName())};
}

/// The quote of a trade, the amount of anything else.
float price(const Operation& operation)
{
    if (isTrade(operation))
        return asTrade(operation).getQuote();
    // What comes in stands as a negative cost.
    return kindOf(operation) == OperationKind::kIncome ? -asTransfer(operation).getCost()
                                                       : static_cast<const AccountOperation&>(operation).getAmount();
}

Cell numbered(const std::string& text, double number)
{
    return {text, look::kText, number};
}

Cell quantity(const OperationItem& item)
{
    if (!isTrade(*item.object()))
        return {};
    const int quantity = asTrade(*item.object()).getQuantity();
    return numbered(countText(quantity), quantity);
}

Cell cost(const OperationItem& item)
{
    const Operation& operation = *item.object();
    if (isTrade(operation))
        return numbered(amountText(asTrade(operation).getOperationCost()), asTrade(operation).getOperationCost());
    if (!isTransfer(kindOf(operation)))
        return {};
    return numbered(amountText(asTransfer(operation).getTotalCost()), asTransfer(operation).getTotalCost());
}

/// What is traded or moved, before costs, in the account's currency.
Cell total(const OperationItem& item)
{
    const Operation& operation = *item.object();
    const double quantity = isTrade(operation) ? asTrade(operation).getQuantity() : 1;
    const double total = quantity * price(operation);
    return {amountText(total), look::kText, total, textOf(operation.getCurrencyRepresentation())};
}

Cell amountOf(double amount, const Account& account)
{
    return {amountText(amount), amount < 0 ? look::kLoss : look::kText, amount,
            textOf(account.getCurrencyRepresentation())};
}

/// What the account really gets or gives, with all costs.
Cell effect(const OperationItem& item)
{
    const Account* account = item.account();
    return account != nullptr ? amountOf(cashMove(*item.object(), *account), *account) : Cell();
}

Cell balanceBehind(const OperationItem& item)
{
    return item.balance() ? amountOf(*item.balance(), *item.account()) : Cell();
}

Cell date(const OperationItem& item)
{
    const Date& day = item.object()->getDate();
    return {dateText(day), look::kText, dayOrder(day)};
}

} // namespace

// Account and balance take turns. The last column shows while there is an automatic operation.
const std::vector<ColumnOf<OperationItem>> OperationItem::kColumns = {
    {{"Date", 78}, date},
    {{"Account", 90}, accountName},
    {{"Type", 58}, [](const OperationItem& i) { return Cell{nameOf(kindOf(*i.object()))}; }},
    {{"What", 108}, what},
    {{"Quantity", 64, B_ALIGN_RIGHT}, quantity},
    {{"Quote/Amount", 98, B_ALIGN_RIGHT},
     [](const OperationItem& i) { return numbered(amountText(price(*i.object())), price(*i.object())); }},
    {{"Cost", 58, B_ALIGN_RIGHT}, cost},
    {{"Total", 108, B_ALIGN_RIGHT, UnitPlace::kShown}, total},
    {{"Effect", 86, B_ALIGN_RIGHT, UnitPlace::kCopied}, effect},
    {{"Balance", 90, B_ALIGN_RIGHT, UnitPlace::kCopied, true}, balanceBehind},
    {{"Auto", 36, B_ALIGN_CENTER, UnitPlace::kNone, true},
     [](const OperationItem& i) { return Cell{i.isAutomatic() ? "\u2713" : ""}; }},
};

const Account* OperationItem::account() const
{
    return shown_ != nullptr ? shown_ : operation_->account();
}

void OperationItem::showEffectOn(const Account* account, std::optional<double> balance)
{
    shown_ = account;
    balance_ = balance;
}

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

void OperationListView::setAccount(const Account* account)
{
    if (account == account_)
        return;
    account_ = account;
    // Of one account the column would say the same in each row.
    showColumn(kAccountColumn, account == nullptr);
    showColumn(kBalanceColumn, account != nullptr);
    forgetTexts();
    chooseAgain();
}

void OperationListView::setYear(std::optional<int> year)
{
    if (year == year_)
        return;
    year_ = year;
    chooseAgain();
}

std::vector<int> OperationListView::years() const
{
    std::set<int, std::greater<>> years;
    for (int32 i = 0; i < CountRows(); ++i) {
        const auto* row = static_cast<const OperationItem*>(rowAt(i));
        if (row->object() != nullptr && !row->object()->getDate().isUndefined())
            years.insert(row->object()->getDate().getYear());
    }
    return {years.begin(), years.end()};
}

bool OperationListView::isArranged() const
{
    return account_ != nullptr || year_.has_value() || ObjectListView::isArranged();
}

void OperationListView::choose(std::vector<ColumnItem*>& rows)
{
    const auto operationOf = [](const ColumnItem* row) { return static_cast<const OperationItem*>(row)->object(); };
    std::erase_if(rows, [&](const ColumnItem* row) { return operationOf(row) == nullptr; });
    if (account_ != nullptr) {
        chooseOfAccount(rows);
    } else {
        for (ColumnItem* row : rows)
            static_cast<OperationItem*>(row)->showEffectOn(nullptr, std::nullopt);
    }
    // The balances rest on all years.
    if (year_)
        std::erase_if(rows, [&](const ColumnItem* row) {
            const Date& day = operationOf(row)->getDate();
            return day.isUndefined() || day.getYear() != *year_;
        });
}

void OperationListView::chooseOfAccount(std::vector<ColumnItem*>& rows)
{
    const auto operationOf = [](const ColumnItem* row) -> const Operation& {
        return *static_cast<const OperationItem*>(row)->object();
    };
    std::erase_if(rows, [&](const ColumnItem* row) {
        return operationOf(row).account() != account_ && recipientOf(operationOf(row)) != account_;
    });
    std::ranges::stable_sort(rows, {},
                             [&](const ColumnItem* row) -> const Date& { return operationOf(row).getDate(); });
    double balance = 0;
    for (ColumnItem* row : rows) {
        balance += cashMove(operationOf(row), *account_);
        static_cast<OperationItem*>(row)->showEffectOn(account_, balance);
    }
}
