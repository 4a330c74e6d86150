// What is offered while a person types an operation. The page puts an offer in only where nothing was typed.

#include "app/PLWindow.h"
#include "app/WindowLock.h"
#include "market/Company.h"
#include "market/Currency.h"
#include "portfolio/Account.h"
#include "portfolio/Wallet.h"
#include "views/OperationView.h"

#include <optional>

namespace {

/// What a series says for a day; nothing when it is empty, or the day no day.
template <class Series>
std::optional<float> quoteAt(const Series* series, const Date& date)
{
    if (series == nullptr || series->getNbrQuotes() == 0 || date.isUndefined())
        return std::nullopt;
    return series->getRealQuote(date);
}

const Currency* currencyOf(const Account* account)
{
    Currency* currency = nullptr;
    if (account != nullptr)
        account->getCurrency(&currency);
    return currency;
}

/// The fixed cost of a new operation of that type; nothing for one that is no trade.
std::optional<float> shareCost(const Wallet& wallet, const String& type)
{
    if (type == "BUY")
        return wallet.getBuyCost();
    if (type == "SELL")
        return wallet.getSellCost();
    return std::nullopt;
}

} // namespace

void PLWindow::ChangeOperationType(const String& type)
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    operationView_->SetType(type);
    if (const auto cost = shareCost(*wallet_, type))
        operationView_->offerShareCost(*cost);
    renewOffers();
}

void PLWindow::renewOffers()
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    const Date date = operationView_->getDate();
    const String type = operationView_->getType();
    if (type == "TRANSFER")
        offerTransferQuotes(date);
    if (const auto cost = shareCost(*wallet_, type)) {
        operationView_->renewShareCost(*cost);
        operationView_->offerQuote(
            quoteAt(findCompany(operationView_->getMarketName(), operationView_->getCompanyAbbreviation()), date));
    }
}

void PLWindow::offerTransferQuotes(const Date& date)
{
    const Currency* from = currencyOf(wallet_->getAccountByName(operationView_->getBaseAccount()));
    const Currency* to = currencyOf(wallet_->getAccountByName(operationView_->getTransferAccount()));
    // Within a currency there is nothing to exchange, and its rates may not be known.
    if (from != nullptr && from == to)
        operationView_->offerTransferQuotes(1, 1);
    else
        operationView_->offerTransferQuotes(quoteAt(from, date), quoteAt(to, date));
}
