#include "app/OperationOffers.h"

#include "app/OperationMaker.h"
#include "app/PLWindow.h"
#include "portfolio/OperationText.h"
#include "portfolio/Wallet.h"
#include "views/ModelText.h"
#include "views/OperationView.h"

#include <optional>
#include <utility>

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
    return account != nullptr ? account->currency() : nullptr;
}

bool isTrade(const String& type)
{
    return type == "BUY" || type == "SELL";
}

float shareCost(const Wallet& wallet, const String& type)
{
    return type == "BUY" ? wallet.getBuyCost() : wallet.getSellCost();
}

/// The account with the latest operation; null without any.
const Account* lastUsed(const Wallet& wallet)
{
    const Account* last = nullptr;
    for (const Account* account : wallet.accounts()) {
        const auto operations = account->operations();
        if (!operations.empty() &&
            (last == nullptr || operations.back()->getDate() > last->operations().back()->getDate()))
            last = account;
    }
    return last;
}

/// The account of the company's latest trade in the wallet; null without any.
const Account* lastUsedFor(const Wallet& wallet, const Company& company)
{
    for (const Share* share : company.shares())
        if (share->wallet() == &wallet && !share->shareOperations().empty())
            return share->shareOperations().back()->account();
    return nullptr;
}

} // namespace

Wallet& OperationOffers::wallet() const
{
    return *window_.getWallet();
}

void OperationOffers::noteType()
{
    typed_ = {}; // what market and ticker never hold: the account may be that of another type
    if (const String type = page_.getType(); isTrade(type))
        page_.offerShareCost(shareCost(wallet(), type));
}

void OperationOffers::renew()
{
    chooseAccount();
    const String type = page_.getType();
    if (type == "TRANSFER")
        offerTransferQuotes();
    if (isTrade(type))
        page_.renewShareCost(shareCost(wallet(), type));
    if (isTrade(type) || type == "INCOME")
        followCompany();
    showSums();
}

void OperationOffers::noteFigure()
{
    if (isTrade(page_.getType()))
        noteQuote();
    showSums();
}

void OperationOffers::noteShown()
{
    typed_ = typedKey();
    quoteOf_ = companyKey();
    isFirst_ = false;
    quote_ = page_.getQuote();
    showSums();
}

void OperationOffers::noteQuote()
{
    // While there is no company, another figure says nothing of whose quote it is.
    const bool isOther = std::exchange(quote_, page_.getQuote()) != page_.getQuote();
    if (maker_.company() == nullptr && !isOther)
        return;
    quoteOf_ = companyKey();
    isFirst_ = false;
}

void OperationOffers::noteUsed(const Account& account)
{
    used_ = account.getName();
}

Account* OperationOffers::chosenAccount() const
{
    return wallet().getAccountByName(page_.getBaseAccount());
}

void OperationOffers::chooseAccount()
{
    if (!page_.getBaseAccount().isUndefined())
        return;
    const auto accounts = wallet().accounts();
    const Account* next = wallet().getAccountByName(used_);
    if (next == nullptr)
        next = accounts.size() == 1 ? accounts.front() : lastUsed(wallet());
    if (next != nullptr)
        page_.setBaseAccount(next->getName());
}

/// Market and ticker have changed, or what a quote depends on.
void OperationOffers::followCompany()
{
    const Company* company = maker_.company();
    const std::string key = companyKey();
    const std::string typed = typedKey();
    const bool isOther = std::exchange(typed_, typed) != typed;
    // A person may choose another account after this: it is looked at again with the next company only.
    if (company != nullptr && isOther)
        chooseAccountFor(*company);
    if (!isTrade(page_.getType()))
        return;
    // On the way from one ticker to another there is none for a moment: what was typed waits for the other. What was
    // typed before any ticker was waits, too, while the ticker that is being typed goes on from one that came by.
    const auto quote = quoteAt(company, page_.getDate());
    const bool goesOn = isFirst_ && key.starts_with(quoteOf_);
    if (company != nullptr && !quoteOf_.empty() && quoteOf_ != key && !goesOn)
        page_.replaceQuote(quote);
    else
        page_.offerQuote(quote);
    if (company != nullptr) {
        isFirst_ = isOther && !page_.isQuoteOffered() && (quoteOf_.empty() || goesOn);
        quoteOf_ = key;
    }
    quote_ = page_.getQuote();
}

void OperationOffers::chooseAccountFor(const Company& company)
{
    const String& symbol = company.getCurrencyRepresentation();
    const Account* chosen = chosenAccount();
    if (chosen != nullptr && chosen->getCurrencyRepresentation() == symbol)
        return;
    for (const Account* next :
         {static_cast<const Account*>(wallet().getAccountByName(used_)), lastUsedFor(wallet(), company),
          static_cast<const Account*>(wallet().findDefaultTransferAccount(symbol))}) {
        if (next != nullptr && next->getCurrencyRepresentation() == symbol)
            return page_.setBaseAccount(next->getName());
    }
}

void OperationOffers::offerTransferQuotes()
{
    const Date date = page_.getDate();
    const Currency* from = currencyOf(chosenAccount());
    const Currency* to = currencyOf(wallet().getAccountByName(page_.getTransferAccount()));
    // Within a currency there is nothing to exchange, and its rates may not be known.
    if (from != nullptr && from == to)
        page_.offerTransferQuotes(1, 1);
    else
        page_.offerTransferQuotes(quoteAt(from, date), quoteAt(to, date));
}

void OperationOffers::showSums()
{
    page_.setCharged(shortened(chargedText(), kLongestShown));
    if (!isTrade(page_.getType()))
        return;
    // For the eye only: no command reads the total.
    const bool isKnown = page_.getQuantity() != 0 && !page_.hasFault();
    const double quote = page_.getQuote();
    page_.setTotal(isKnown ? std::optional(static_cast<float>(page_.getQuantity() * quote)) : std::nullopt);
}

/// Empty for what would not be booked, or would move nothing.
std::string OperationOffers::chargedText() const
{
    const Account* account = chosenAccount();
    if (account == nullptr || page_.hasFault())
        return {};
    const String type = page_.getType();
    const auto operation = maker_.draft(Date());
    if (isTrade(type)) {
        const Company* company = maker_.company();
        const bool fits =
            company != nullptr && company->getCurrencyRepresentation() == account->getCurrencyRepresentation();
        return fits && page_.getQuantity() > 0 ? moveText(*operation, *account, nullptr, wallet()) : "";
    }
    if (type == "TRANSFER") {
        const Account* to = wallet().getAccountByName(page_.getTransferAccount());
        const bool moves = page_.getAmount() != 0 || page_.getTransferCost() != 0;
        return to != nullptr && moves ? moveText(*operation, *account, to, wallet()) : "";
    }
    const float amount = page_.getAmount();
    if (type == "DEPOSIT")
        return amount != 0 ? moveText(*operation, *account, nullptr, wallet()) : "";
    return amount > 0 ? moveText(*operation, *account, account, wallet()) : "";
}

std::string OperationOffers::companyKey() const
{
    return maker_.company() != nullptr ? typedKey() : "";
}

std::string OperationOffers::typedKey() const
{
    return textOf(page_.getMarketName()) + '\n' + textOf(page_.getCompanyAbbreviation());
}
