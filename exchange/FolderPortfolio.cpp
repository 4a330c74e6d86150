// The tables of a portfolio, read back.

#include "exchange/FolderImport.h"
#include "exchange/Table.h"
#include "exchange/TableNames.h"
#include "exchange/TableText.h"
#include "market/Catalogue.h"
#include "market/Currency.h"
#include "market/Market.h"
#include "portfolio/DepositAccountOperation.h"
#include "portfolio/OperationKind.h"
#include "portfolio/ShareOperation.h"
#include "portfolio/TransferAccountOperation.h"
#include "portfolio/Wallet.h"

#include <algorithm>
#include <stdexcept>

using namespace export_tables;

namespace {

namespace operation_columns {
enum {
    kDate,
    kType,
    kAccount,
    kToAccount,
    kMarket,
    kTicker,
    kQuantity,
    kQuote,
    kAmount,
    kCost,
    kRateCost,
    kFromQuote,
    kToQuote
};
}

} // namespace

void FolderImport::readPortfolio(Wallet& wallet, const Catalogue& catalogue)
{
    const bool isNew = wallet.getNbrAccounts() == 0 && wallet.getNbrShares() == 0;
    BookedOperations before(wallet);
    readAccounts(wallet);
    readHoldings(wallet);
    for (ExportedTable row(folder_, kOperations); row.next();)
        readOperation(row, before);
    // Those of a portfolio that is there are its owner's.
    if (isNew)
        readParameters(wallet);
    wallet.setCatalogue(catalogue);
    checkNames(wallet);
}

/// Throws where a reader of the portfolio's file, which has nothing but names, would find something else by them than
/// is meant: what the tables have brought may be called like what is there.
void FolderImport::checkNames(const Wallet& wallet)
{
    const auto refuse = [](const std::string& what, const String& name) {
        throw std::runtime_error("a portfolio cannot refer to " + what + " by the name " + shown(name.bytes()) +
                                 ", since another one has it, or it is none: rename one of them");
    };
    for (const Account* account : wallet.accounts()) {
        Currency* named;
        const Currency* currency = account->currency();
        if (currency->getName().isUndefined() || wallet.getCurrency(currency->getName(), &named) != 0 ||
            named != currency)
            refuse("the currency " + shown(currency->getRepresentation().bytes()), currency->getName());
    }
    for (const Share* share : wallet.shares()) {
        Company* named;
        if (wallet.getCompany(share->getMarketName(), share->getCompanyAbbreviation(), &named) != 0 ||
            named != share->company())
            refuse("the market of the company " + shown(share->getCompanyAbbreviation().bytes()),
                   share->getMarketName());
    }
}

void FolderImport::readAccounts(Wallet& wallet)
{
    enum { kAccount, kCurrency, kDefault, kCash, kValue, kOriginal };
    Before<Account> before;
    for (Account* account : wallet.accounts())
        before.emplace(Key{nullptr, account->getName().comparedBytes()}, account);
    for (ExportedTable row(folder_, kAccounts); row.next();) {
        Currency* currency = currencyOf(row, kCurrency);
        const std::string name = TableNames::originalOf(row.cell(kOriginal), row.cell(kAccount));
        Account* account = take(before, {nullptr, name});
        if (account == nullptr) {
            account = new Account(String(name.c_str()));
            account->setWallet(&wallet);
            account->setCurrency(currency);
            account->setDefaultTransferAccount(row.cell(kDefault) == kYes);
        } else if (account->currency() != currency) {
            row.refuse("has the account " + shown(name) + " in " + shown(row.cell(kCurrency)) +
                       ", and that of the portfolio is in " + shown(account->getCurrencyRepresentation().bytes()));
        }
        if (!accounts_.try_emplace(row.cell(kAccount), account).second)
            row.refuse("names the account " + shown(row.cell(kAccount)) + " once more");
    }
}

void FolderImport::readHoldings(Wallet& wallet)
{
    enum { kDate, kMarket, kTicker, kCurrency };
    std::unordered_map<const Company*, Share*> before;
    for (Share* share : wallet.shares())
        before.try_emplace(share->company(), share);
    for (ExportedTable row(folder_, kHoldings); row.next();) {
        Company* company = companyOf(row, kTicker, kMarket, kCurrency);
        const auto known = before.find(company);
        Share* share = known != before.end() ? known->second : new Share(&wallet, company);
        // Of several the first has the operations, as in the file.
        shares_.try_emplace({row.cell(kMarket), row.cell(kTicker)}, share);
    }
}

void FolderImport::readOperation(const ExportedTable& row, BookedOperations& before)
{
    using namespace operation_columns;
    const std::string& type = row.cell(kType);
    const auto is = [&type](OperationKind kind) { return type == nameOf(kind); };
    Account* account = accountOf(row, kAccount);
    Operation* operation; // owned by its account
    if (is(OperationKind::kDeposit) || type == kWithdrawal)
        operation = new DepositAccountOperation(row.date(kDate), account, row.number(kAmount), false);
    else if (is(OperationKind::kBuy) || is(OperationKind::kSell))
        operation = makeTrade(row, account, is(OperationKind::kBuy));
    else if (is(OperationKind::kTransfer) || is(OperationKind::kIncome) || is(OperationKind::kCharge))
        operation = makeTransfer(row, account);
    else
        row.refuse(shown(type) + " is no type of operation");

    // One that was booked before stands for one row: equal rows beyond it are operations of their own.
    const bool isBooked = before.take(*operation);
    ++(isBooked ? operations_.equal : operations_.added);
    if (isBooked)
        delete operation;
}

Operation* FolderImport::makeTrade(const ExportedTable& row, Account* account, bool isBuy) const
{
    using namespace operation_columns;
    const auto share = shares_.find({row.cell(kMarket), row.cell(kTicker)});
    if (share == shares_.end())
        row.refuseUnknown(kTicker);
    auto* trade = new ShareOperation(row.date(kDate), share->second, isBuy, row.count(kQuantity), row.number(kQuote),
                                     false, row.number(kCost));
    trade->setAccount(account);
    return trade;
}

Operation* FolderImport::makeTransfer(const ExportedTable& row, Account* account) const
{
    using namespace operation_columns;
    const float amount = row.number(kAmount);
    const Date date = row.date(kDate);
    const bool isIncome = row.cell(kType) == nameOf(OperationKind::kIncome);
    if (isIncome || row.cell(kType) == nameOf(OperationKind::kCharge)) {
        auto* own = new TransferAccountOperation(date, account, account, isIncome ? 0 : amount, false);
        own->setCost(isIncome ? -amount : 0);
        own->setRateCost(isIncome ? 0 : 1);
        return own;
    }
    auto* transfer = new TransferAccountOperation(date, account, accountOf(row, kToAccount), amount, false);
    transfer->setCost(row.number(kCost));
    transfer->setRateCost(row.number(kRateCost));
    transfer->setFromCurrencyQuote(row.number(kFromQuote));
    transfer->setToCurrencyQuote(row.number(kToQuote));
    return transfer;
}

void FolderImport::readParameters(Wallet& wallet)
{
    enum { kParameter, kValue };
    for (ExportedTable row(folder_, kParameters); row.next();) {
        const auto* name = std::ranges::find(kParameterNames, row.cell(kParameter));
        if (name == std::end(kParameterNames))
            row.refuse(shown(row.cell(kParameter)) + " is no parameter");
        const auto parameter = static_cast<Wallet::Parameter>(name - kParameterNames);
        const bool isPeriod = parameter == Wallet::kInvestementPeriod;
        wallet.setParameter(parameter, isPeriod ? row.smallCount(kValue) : row.number(kValue));
    }
}

Account* FolderImport::accountOf(const ExportedTable& row, std::size_t column) const
{
    const auto account = accounts_.find(row.cell(column));
    if (account == accounts_.end())
        row.refuseUnknown(column);
    return account->second;
}
