// Operations.

#include "app/PLWindow.h"
#include "app/WindowLock.h"
#include "market/Company.h"
#include "market/Market.h"
#include "portfolio/Account.h"
#include "portfolio/DepositAccountOperation.h"
#include "portfolio/Share.h"
#include "portfolio/ShareOperation.h"
#include "portfolio/TransferAccountOperation.h"
#include "portfolio/Wallet.h"
#include "views/OperationView.h"

void PLWindow::UpdateOperationTotal()
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    const double quote = operationView_->getQuote();
    operationView_->setTotal(static_cast<float>(operationView_->getQuantity() * quote));
}

// --- Adding and replacing.

void PLWindow::AddOperation()
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    if (Operation* added = makeOperation())
        showMadeOperation(added, nullptr);
}

void PLWindow::UpdateOperation()
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    Operation* former = selectedOperation();
    if (Operation* added = makeOperation())
        showMadeOperation(added, former);
}

void PLWindow::showMadeOperation(Operation* made, Operation* former)
{
    // The valuation destroys automatic operations, the made one as well as the one in whose place it comes.
    const bool stays = !made->isAutomatic();
    const bool formerStays = former != nullptr && !former->isAutomatic();
    if (former != nullptr && !formerStays)
        destroyOperation(former);
    UpdateState();
    if (former != nullptr) {
        // Intended: the portfolio is valued with both first. Simulated sales may come of that.
        if (formerStays)
            destroyOperation(former);
        UpdateState();
    }
    if (!stays)
        return;
    operationView_->ShowOperation(made);
    UpdateOperationTotal();
}

void PLWindow::destroyOperation(Operation* operation)
{
    operationView_->RemoveOperation(operation);
    delete operation;
}

Operation* PLWindow::makeOperation()
{
    const Date date = operationView_->getDate();
    if (date.isUndefined())
        return nullptr; // Intended: without a message, the field shows by its colour what is wrong.
    const String name = operationView_->getBaseAccount();
    if (name.isUndefined()) {
        SetMessage("Undefined account.");
        return nullptr;
    }
    Account* account = wallet_->getAccountByName(name);
    if (account == nullptr) {
        SetMessage("Unknown account.");
        return nullptr;
    }
    const String type = operationView_->getType();
    if (type == "DEPOSIT")
        return new DepositAccountOperation(date, account, operationView_->getAmount(), operationView_->getAutomatic());
    if (type == "TRANSFER")
        return makeTransfer(date, account);
    return makeTrade(date, account, type == "BUY");
}

Operation* PLWindow::makeTransfer(const Date& date, Account* from)
{
    const String name = operationView_->getTransferAccount();
    Account* to = name.isUndefined() ? nullptr : wallet_->getAccountByName(name);
    if (to == nullptr)
        return nullptr; // without a message: the menu shows that nothing is chosen
    auto* transfer =
        new TransferAccountOperation(date, from, to, operationView_->getAmount(), operationView_->getAutomatic());
    transfer->setCost(operationView_->getTransferCost());
    transfer->setRateCost(operationView_->getTransferRateCost());
    transfer->setFromCurrencyQuote(operationView_->getTransferFromQuote());
    transfer->setToCurrencyQuote(operationView_->getTransferToQuote());
    return transfer;
}

Operation* PLWindow::makeTrade(const Date& date, Account* account, bool isBuy)
{
    const String marketName = operationView_->getMarketName();
    const String ticker = operationView_->getCompanyAbbreviation();
    Company* company = findCompany(marketName, ticker);
    if (company == nullptr) {
        SetMessage("Unknown company.");
        return nullptr;
    }
    if (account->getCurrencyRepresentation() != company->getCurrencyRepresentation()) {
        SetMessage("Not the same currencies.");
        return nullptr;
    }
    Share* share;
    if (wallet_->getShare(marketName, ticker, &share) != 0)
        share = new Share(wallet_.get(), company); // the wallet owns it
    const int quantity = operationView_->getQuantity();
    if (quantity <= 0) {
        SetMessage("Quantity must be higher than 0."); // The new holding stays; it is empty and is found again when the
                                                       // quantity is mended.
        return nullptr;
    }
    auto* trade = new ShareOperation(date, share, isBuy, quantity, operationView_->getQuote(),
                                     operationView_->getAutomatic(), operationView_->getShareCost());
    trade->setAccount(account);
    return trade;
}

/// The first company of that ticker in the markets of that name; null when there is none.
Company* PLWindow::findCompany(const String& marketName, const String& ticker) const
{
    for (const Market* market : catalogue_.getMarkets()) {
        Company* company;
        if (market->getName() == marketName && market->getCompany(ticker, &company) == 0)
            return company;
    }
    return nullptr;
}

// --- Removing and showing.

Operation* PLWindow::selectedOperation() const
{
    if (operationView_->IsSelectedAccountOperation())
        return operationView_->GetSelectedAccountOperation();
    return operationView_->GetSelectedShareOperation();
}

void PLWindow::RemoveOperation()
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    if (Operation* operation = selectedOperation())
        destroyOperation(operation);
    UpdateState();
}

void PLWindow::SelectOperation()
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    if (const AccountOperation* operation = operationView_->GetSelectedAccountOperation())
        showAccountOperation(*operation);
    else if (const ShareOperation* trade = operationView_->GetSelectedShareOperation())
        showTrade(*trade);
}

void PLWindow::showAccountOperation(const AccountOperation& operation)
{
    const bool isTransfer = operation.getType() == Operation::kTransfer;
    operationView_->SetType(isTransfer ? "TRANSFER" : "DEPOSIT");
    if (isTransfer) {
        const auto& transfer = static_cast<const TransferAccountOperation&>(operation);
        Account* to;
        operationView_->setTransferAccount(transfer.getRecepientAccount(&to) == 0 ? to->getName() : String());
        operationView_->setTransferCost(transfer.getCost());
        operationView_->setTransferRateCost(transfer.getRateCost());
        operationView_->setTransferFromQuote(transfer.getFromCurrencyQuote());
        operationView_->setTransferToQuote(transfer.getToCurrencyQuote());
    }
    operationView_->setAmount(operation.getAmount());
    showCommonFields(operation);
}

void PLWindow::showTrade(const ShareOperation& trade)
{
    operationView_->SetType(trade.isBuy() ? "BUY" : "SELL");
    operationView_->setQuantity(trade.getQuantity());
    operationView_->setQuote(trade.getQuote());
    operationView_->setTotal(static_cast<float>(trade.getQuantity() * static_cast<double>(trade.getQuote())));
    operationView_->setShareCost(trade.getOperationCost());
    Share* share;
    const bool hasShare = trade.getShare(&share) == 0;
    operationView_->setMarketName(hasShare ? share->getMarketName() : "ERROR");
    operationView_->setCompanyAbbreviation(hasShare ? share->getCompanyAbbreviation() : "ERROR");
    showCommonFields(trade);
}

void PLWindow::showCommonFields(const Operation& operation)
{
    operationView_->setDate(operation.getDate());
    operationView_->setAutomatic(operation.isAutomatic());
    Account* account;
    operationView_->setBaseAccount(operation.getAccount(&account) == 0 ? account->getName() : String());
}
