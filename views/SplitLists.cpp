#include "views/SplitLists.h"

#include "foundation/DateText.h"
#include "foundation/NumberText.h"
#include "portfolio/Account.h"
#include "portfolio/Share.h"
#include "portfolio/ShareOperation.h"
#include "valuation/SplitPlan.h"
#include "views/Look.h"
#include "views/ModelText.h"

#include <cmath>
#include <numeric>

namespace {

// What is old stands in grey beside the new.

Cell was(const std::string& text, double number)
{
    return {text, look::kFaint, number};
}

Cell becomes(const std::string& text, double number)
{
    return {text, look::kSeries, number};
}

Cell wasPrice(float price)
{
    return was(priceText(price), price);
}

Cell becomesPrice(float price)
{
    return becomes(priceText(price), price);
}

Cell amountOf(double amount)
{
    return {amountText(amount), look::kText, amount};
}

std::string sharesText(std::int64_t shares)
{
    return countText(static_cast<int>(shares)); // a plan without problem has 32 bits of them
}

Cell wasShares(std::int64_t shares)
{
    return was(sharesText(shares), static_cast<double>(shares));
}

Cell becomesShares(std::int64_t shares)
{
    return becomes(sharesText(shares), static_cast<double>(shares));
}

std::string accountText(const Account* account)
{
    return account != nullptr ? textOf(account->getName()) : "";
}

PlainRow* rowOf(const SplitPlan::Trade& trade)
{
    const ShareOperation& operation = *trade.operation;
    return new PlainRow({{dateText(operation.getDate())},
                         {accountText(operation.account())},
                         {operation.isBuy() ? "Buy" : "Sell"},
                         wasShares(operation.getQuantity()),
                         becomesShares(trade.quantity),
                         wasPrice(operation.getQuote()),
                         becomesPrice(trade.quote),
                         wasShares(trade.formerHolding),
                         becomesShares(trade.holding)});
}

PlainRow* settlementOf(const SplitPlan::Holding& holding, const Date& day)
{
    return new PlainRow({{dateText(day)},
                         {accountText(holding.account)},
                         {"Sell"},
                         {},
                         becomesShares(1),
                         {},
                         becomesPrice(holding.saleQuote),
                         {},
                         becomesShares(holding.whole)},
                        true);
}

} // namespace

void PlainRow::DrawItem(BView* owner, BRect frame, bool complete)
{
    if (isMadeUp_ && !IsSelected()) {
        const rgb_color text = owner->HighColor();
        owner->SetHighColor(look::kGenerated);
        owner->FillRect(frame);
        owner->SetHighColor(text);
    }
    ColumnItem::DrawItem(owner, frame, complete);
}

SplitTradeListView::SplitTradeListView(const char* name)
    : PlainListView(name,
                    {{"Date", 78},
                     {"Account", kRemainingWidth},
                     {"Type", 42},
                     {"Quantity", 66, B_ALIGN_RIGHT},
                     {"becomes", 66, B_ALIGN_RIGHT},
                     {"Quote", 78, B_ALIGN_RIGHT},
                     {"becomes", 78, B_ALIGN_RIGHT},
                     {"Holding", 66, B_ALIGN_RIGHT},
                     {"becomes", 66, B_ALIGN_RIGHT}},
                    false)
{}

void SplitTradeListView::show(const SplitPlan& plan)
{
    std::vector<ColumnItem*> rows; // the list owns them
    for (const SplitPlan::Holding& holding : plan.holdings()) {
        for (const SplitPlan::Trade& trade : holding.trades)
            rows.push_back(rowOf(trade));
        if (holding.fraction != 0)
            rows.push_back(settlementOf(holding, plan.day()));
    }
    showRows(rows);
}

SplitHoldingListView::SplitHoldingListView(const char* name)
    : PlainListView(name,
                    {{"", kRemainingWidth},
                     {"Shares", 86, B_ALIGN_RIGHT},
                     {"Price", 92, B_ALIGN_RIGHT},
                     {"Fraction", 72, B_ALIGN_RIGHT},
                     {"Paid Out", 100, B_ALIGN_RIGHT},
                     {"Total Value", 120, B_ALIGN_RIGHT}},
                    false)
{}

void SplitHoldingListView::show(const SplitPlan& plan)
{
    std::vector<ColumnItem*> rows; // the list owns them
    for (const SplitPlan::Holding& holding : plan.holdings()) {
        const bool isSettled = holding.fraction != 0;
        rows.push_back(new PlainRow({{"Before"},
                                     wasShares(holding.former),
                                     wasPrice(plan.priceBefore()),
                                     {},
                                     {},
                                     amountOf(holding.valueBefore)}));
        rows.push_back(new PlainRow(
            {{"After"},
             becomesShares(holding.whole),
             becomesPrice(plan.priceAfter()),
             isSettled ? Cell{fractionText(static_cast<int>(holding.fraction), plan.from()), look::kSeries} : Cell{},
             isSettled ? becomes(amountText(holding.paidOut), holding.paidOut) : Cell{},
             amountOf(holding.valueAfter)}));
    }
    showRows(rows);
}

std::string priceText(float price)
{
    constexpr float kSmall = 0.01F;
    constexpr float kScale = 1e4F;
    if (std::abs(price) < kSmall || std::abs(price) > kScale)
        return exactText(price);
    return exactText(std::round(price * kScale) / kScale);
}

std::string fractionText(int numerator, int denominator)
{
    const int divisor = std::gcd(numerator, denominator);
    return std::to_string(numerator / divisor) + '/' + std::to_string(denominator / divisor);
}
