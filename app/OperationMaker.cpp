#include "app/OperationMaker.h"

#include "app/PLWindow.h"
#include "portfolio/DepositAccountOperation.h"
#include "portfolio/Wallet.h"
#include "views/OperationView.h"

Wallet& OperationMaker::wallet() const
{
    return *window_.getWallet();
}

std::nullptr_t OperationMaker::refuse(const char* reason) const
{
    window_.SetMessage(reason);
    return nullptr;
}

std::nullptr_t OperationMaker::explain(const char* reason) const
{
    window_.showNotice({"operation", reason, {}, true});
    return nullptr;
}

/// Whether the page says that money came in, or went, by nothing but the account.
bool OperationMaker::isMove() const
{
    const String type = page_.getType();
    return type == "INCOME" || type == "CHARGE";
}

std::unique_ptr<Operation> OperationMaker::draft(const Date& date) const
{
    const String type = page_.getType();
    const bool automatic = page_.getAutomatic();
    const float amount = page_.getAmount();
    if (type == "DEPOSIT")
        return std::make_unique<DepositAccountOperation>(date, nullptr, amount, automatic);
    if (type == "BUY" || type == "SELL")
        return std::make_unique<ShareOperation>(date, nullptr, type == "BUY", page_.getQuantity(), page_.getQuote(),
                                                automatic, page_.getShareCost());
    const bool isIncome = type == "INCOME";
    auto transfer =
        std::make_unique<TransferAccountOperation>(date, nullptr, nullptr, isIncome ? 0 : amount, automatic);
    if (isIncome) {
        // See `OperationKind`: the values make every replay move exactly the amount.
        transfer->setCost(-amount);
    } else if (type == "CHARGE") {
        transfer->setRateCost(1);
    } else {
        transfer->setCost(page_.getTransferCost());
        transfer->setRateCost(page_.getTransferRateCost());
        transfer->setFromCurrencyQuote(page_.getTransferFromQuote());
        transfer->setToCurrencyQuote(page_.getTransferToQuote());
    }
    return transfer;
}

Operation* OperationMaker::make() const
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
    auto made = draft(date);
    if (type == "TRANSFER")
        return linkTransfer(std::move(made), account);
    if (type == "BUY" || type == "SELL")
        return linkTrade(std::move(made), account);
    return isMove() ? linkMove(std::move(made), account) : link(std::move(made), account);
}

Operation* OperationMaker::link(std::unique_ptr<Operation> draft, Account* account) const
{
    draft->setAccount(account); // which owns it from here on
    return draft.release();
}

Operation* OperationMaker::linkTransfer(std::unique_ptr<Operation> draft, Account* from) const
{
    const String name = page_.getTransferAccount();
    Account* to = name.isUndefined() ? nullptr : wallet().getAccountByName(name);
    if (to == nullptr)
        return nullptr; // without a message: the menu shows that nothing is chosen
    auto* transfer = static_cast<TransferAccountOperation*>(link(std::move(draft), from));
    transfer->setRecepientAccount(to);
    return transfer;
}

Operation* OperationMaker::linkMove(std::unique_ptr<Operation> draft, Account* account) const
{
    if (!(page_.getAmount() > 0))
        return explain("Please specify an amount above 0.");
    if (page_.getType() == "INCOME" && !page_.getCompanyAbbreviation().isUndefined() && company() == nullptr)
        return refuse("Unknown company.");
    auto* move = static_cast<TransferAccountOperation*>(link(std::move(draft), account));
    move->setRecepientAccount(account);
    return move;
}

Operation* OperationMaker::linkTrade(std::unique_ptr<Operation> draft, Account* account) const
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
    if (page_.getQuantity() <= 0)
        return refuse("Quantity must be higher than 0.");
    static_cast<ShareOperation&>(*draft).setShare(share);
    return link(std::move(draft), account); // from here on the account and the holding list it
}

Company* OperationMaker::company() const
{
    const String market = page_.getMarketName();
    const String ticker = page_.getCompanyAbbreviation();
    Company* found = nullptr;
    if (page_.getType() != "INCOME" || !market.isUndefined() || ticker.isUndefined()) {
        wallet().getCompany(market, ticker, &found);
        return found;
    }
    for (const Market* listed : window_.catalogue().getMarkets()) {
        Company* company = nullptr;
        if (listed->getCompany(ticker, &company) != 0)
            continue;
        if (found != nullptr)
            return nullptr; // either could be meant
        found = company;
    }
    return found;
}
