#include "app/OperationEditor.h"

#include "app/Holds.h"
#include "portfolio/DepositAccountOperation.h"
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
    return account != nullptr ? account->currency() : nullptr;
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

OperationEditor::OperationEditor(PLWindow& window, OperationView& page) : window_(window), page_(page)
{
    // Typing comes from the kits, not by way of a command, so the lock is taken here.
    page_.SetTypingHook([this] {
        const WindowLock lock(window_);
        if (lock.isHeld())
            renewOffers();
    });
}

OperationEditor::~OperationEditor()
{
    page_.SetTypingHook({}); // the page outlives this
}

Wallet& OperationEditor::wallet() const
{
    return *window_.getWallet();
}

void OperationEditor::updateTotal()
{
    // For the eye only: no command reads the total.
    const double quote = page_.getQuote();
    page_.setTotal(static_cast<float>(page_.getQuantity() * quote));
}

void OperationEditor::add()
{
    if (Operation* added = make())
        showMade(added, nullptr);
}

void OperationEditor::update()
{
    Operation* former = selected();
    if (Operation* added = make())
        showMade(added, former);
}

void OperationEditor::remove()
{
    if (Operation* operation = selected())
        destroy(operation);
    window_.UpdateState();
}

void OperationEditor::showMade(Operation* made, Operation* former)
{
    // The valuation destroys automatic operations, the made one as well as the one in whose place it comes: after the
    // first `UpdateState` neither is touched unless it stays.
    const bool stays = !made->isAutomatic();
    const bool formerStays = former != nullptr && !former->isAutomatic();
    if (former != nullptr && !formerStays)
        destroy(former);
    window_.UpdateState();
    if (former != nullptr) {
        // Intended: the portfolio is valued with both first. Simulated sales may come of that.
        if (formerStays)
            destroy(former);
        window_.UpdateState();
    }
    if (!stays)
        return;
    page_.ShowOperation(made);
    updateTotal();
}

void OperationEditor::destroy(Operation* operation)
{
    page_.RemoveOperation(operation); // the row draws from the operation
    delete operation;
}

std::nullptr_t OperationEditor::refuse(const char* reason) const
{
    window_.SetMessage(reason);
    return nullptr;
}

Operation* OperationEditor::make()
{
    const Date date = page_.getDate();
    if (date.isUndefined())
        return nullptr; // Intended: without a message, the field shows by its colour what is wrong.
    const String name = page_.getBaseAccount();
    if (name.isUndefined())
        return refuse("Undefined account.");
    Account* account = wallet().getAccountByName(name);
    if (account == nullptr)
        return refuse("Unknown account.");
    const String type = page_.getType();
    if (type == "DEPOSIT")
        return new DepositAccountOperation(date, account, page_.getAmount(), page_.getAutomatic());
    if (type == "TRANSFER")
        return makeTransfer(date, account);
    return makeTrade(date, account, type == "BUY");
}

Operation* OperationEditor::makeTransfer(const Date& date, Account* from)
{
    const String name = page_.getTransferAccount();
    Account* to = name.isUndefined() ? nullptr : wallet().getAccountByName(name);
    if (to == nullptr)
        return nullptr; // without a message: the menu shows that nothing is chosen
    auto* transfer = new TransferAccountOperation(date, from, to, page_.getAmount(), page_.getAutomatic());
    transfer->setCost(page_.getTransferCost());
    transfer->setRateCost(page_.getTransferRateCost());
    transfer->setFromCurrencyQuote(page_.getTransferFromQuote());
    transfer->setToCurrencyQuote(page_.getTransferToQuote());
    return transfer;
}

Operation* OperationEditor::makeTrade(const Date& date, Account* account, bool isBuy)
{
    const String marketName = page_.getMarketName();
    const String ticker = page_.getCompanyAbbreviation();
    Company* company;
    if (wallet().getCompany(marketName, ticker, &company) != 0)
        return refuse("Unknown company.");
    if (account->getCurrencyRepresentation() != company->getCurrencyRepresentation())
        return refuse("Not the same currencies.");
    Share* share;
    if (wallet().getShare(marketName, ticker, &share) != 0)
        share = new Share(&wallet(), company); // the wallet owns it, and so does the company
    // A new holding stays even when its operation is refused: it is empty, and is found again the next time.
    const int quantity = page_.getQuantity();
    if (quantity <= 0)
        return refuse("Quantity must be higher than 0.");
    auto* trade =
        new ShareOperation(date, share, isBuy, quantity, page_.getQuote(), page_.getAutomatic(), page_.getShareCost());
    trade->setAccount(account); // from here on the account and the holding list it
    return trade;
}

Operation* OperationEditor::selected() const
{
    if (page_.IsSelectedAccountOperation())
        return page_.GetSelectedAccountOperation();
    return page_.GetSelectedShareOperation();
}

void OperationEditor::showSelected()
{
    if (const AccountOperation* operation = page_.GetSelectedAccountOperation())
        showCash(*operation);
    else if (const ShareOperation* trade = page_.GetSelectedShareOperation())
        showTrade(*trade);
}

void OperationEditor::showCash(const AccountOperation& operation)
{
    const bool isTransfer = operation.getType() == Operation::kTransfer;
    page_.SetType(isTransfer ? "TRANSFER" : "DEPOSIT");
    if (isTransfer) {
        const auto& transfer = static_cast<const TransferAccountOperation&>(operation);
        const Account* to = transfer.recipient();
        page_.setTransferAccount(to != nullptr ? to->getName() : String());
        page_.setTransferCost(transfer.getCost());
        page_.setTransferRateCost(transfer.getRateCost());
        page_.setTransferFromQuote(transfer.getFromCurrencyQuote());
        page_.setTransferToQuote(transfer.getToCurrencyQuote());
    }
    page_.setAmount(operation.getAmount());
    showCommonFields(operation);
}

void OperationEditor::showTrade(const ShareOperation& trade)
{
    page_.SetType(trade.isBuy() ? "BUY" : "SELL");
    page_.setQuantity(trade.getQuantity());
    page_.setQuote(trade.getQuote());
    page_.setTotal(static_cast<float>(trade.getQuantity() * static_cast<double>(trade.getQuote())));
    page_.setShareCost(trade.getOperationCost());
    const Share* share = trade.share();
    page_.setMarketName(share != nullptr ? share->getMarketName() : "ERROR");
    page_.setCompanyAbbreviation(share != nullptr ? share->getCompanyAbbreviation() : "ERROR");
    showCommonFields(trade);
}

void OperationEditor::showCommonFields(const Operation& operation)
{
    page_.setDate(operation.getDate());
    page_.setAutomatic(operation.isAutomatic());
    const Account* account = operation.account();
    page_.setBaseAccount(account != nullptr ? account->getName() : String());
}

void OperationEditor::changeType(const String& type)
{
    // The fields of that type show with what they held; each kind of trade has a fixed cost of its own to offer.
    page_.SetType(type);
    if (const auto cost = shareCost(wallet(), type))
        page_.offerShareCost(*cost);
    renewOffers();
}

void OperationEditor::renewOffers()
{
    // Offers follow what they depend on until a person types over them: the page then leaves the field alone.
    const Date date = page_.getDate();
    const String type = page_.getType();
    if (type == "TRANSFER")
        offerTransferQuotes(date);
    if (const auto cost = shareCost(wallet(), type)) {
        page_.renewShareCost(*cost);
        Company* company; // null when there is none
        wallet().getCompany(page_.getMarketName(), page_.getCompanyAbbreviation(), &company);
        page_.offerQuote(quoteAt(company, date));
    }
}

void OperationEditor::offerTransferQuotes(const Date& date)
{
    const Currency* from = currencyOf(wallet().getAccountByName(page_.getBaseAccount()));
    const Currency* to = currencyOf(wallet().getAccountByName(page_.getTransferAccount()));
    // Within a currency there is nothing to exchange, and its rates may not be known.
    if (from != nullptr && from == to)
        page_.offerTransferQuotes(1, 1);
    else
        page_.offerTransferQuotes(quoteAt(from, date), quoteAt(to, date));
}
