#include "tools/JsonReport.h"

#include "market/Currency.h"
#include "portfolio/Account.h"
#include "portfolio/DepositAccountOperation.h"
#include "portfolio/Share.h"
#include "portfolio/ShareOperation.h"
#include "portfolio/TransferAccountOperation.h"
#include "tools/JsonWriter.h"
#include "tools/Valuation.h"
#include "valuation/AccountState.h"
#include "valuation/ShareState.h"
#include "valuation/State.h"

namespace {

const char* nameOfType(short type)
{
    constexpr const char* kNames[] = {"", "deposit", "transfer", "buy", "sell"}; // by type code
    return kNames[type];
}

class Report {
public:
    Report(const Valuation& valuation, FILE* out) : valuation_(valuation), json_(out) {}

    void writeAll()
    {
        json_.beginObject(JsonWriter::Layout::kLinePerItem);
        json_.key("date").date(valuation_.state().getDate());
        writeTotals();
        json_.key("firstOperationDate").date(valuation_.state().getFirstOperationDate());
        writeAccounts();
        writeShares();
        writeOperations();
        if (valuation_.hasEvolution())
            writeEvolution();
        json_.end();
    }

private:
    void write(const char* key, const String& text) { json_.key(key).text(text.bytes()); }
    void write(const char* key, float number) { json_.key(key).number(number); }

    void writeTotals();
    void writeAccounts();
    void writeShares();
    void writeOperations();
    void writeOperation(const Account& account, const Operation& operation);
    void writeTransfer(const TransferAccountOperation& transfer);
    void writeTrade(const ShareOperation& trade);
    void writeEvolution();

    const Valuation& valuation_;
    JsonWriter json_;
};

void Report::writeTotals()
{
    const Totals totals = valuation_.totals();
    if (!totals.isKnown) {
        for (const char* key : {"reference", "totalDeposit", "totalValue", "profit", "annualRevenue"})
            json_.key(key).null();
        return;
    }
    write("reference", valuation_.catalogue().getReferenceCurrency()->getRepresentation());
    write("totalDeposit", totals.totalDeposit);
    write("totalValue", totals.totalValue);
    write("profit", totals.profit);
    write("annualRevenue", totals.annualRevenue);
}

void Report::writeAccounts()
{
    json_.key("accounts").beginArray();
    unsigned n;
    AccountState** states = valuation_.state().getAllAccountStates(&n);
    for (unsigned i = 0; i < n; ++i) {
        const Account* account = states[i]->listed();
        json_.beginObject();
        write("name", states[i]->getAccountName());
        write("currency", states[i]->getCurrencyRepresentation());
        write("cash", states[i]->getCash());
        json_.key("defaultTransfer").boolean(account != nullptr && account->isDefaultTransferAccount());
        json_.end();
    }
    json_.end();
}

void Report::writeShares()
{
    json_.key("shares").beginArray();
    unsigned n;
    ShareState** states = valuation_.state().getAllShareStates(&n);
    for (unsigned i = 0; i < n; ++i) {
        const Share* share = states[i]->listed();
        json_.beginObject();
        write("market", share != nullptr ? share->getMarketName() : String());
        write("ticker", states[i]->getCompanyAbbreviation());
        write("name", states[i]->getCompanyName());
        json_.key("quantity").number(states[i]->getQuantity());
        write("buyQuote", states[i]->getBuyQuote());
        write("quote", states[i]->getQuote());
        json_.key("endDate").date(states[i]->getEndDate());
        write("currency", states[i]->getCurrencyRepresentation());
        json_.end();
    }
    json_.end();
}

void Report::writeOperations()
{
    json_.key("operations").beginArray();
    unsigned nAccounts;
    Account** accounts = valuation_.wallet().getAllAccounts(&nAccounts);
    for (unsigned i = 0; i < nAccounts; ++i) {
        unsigned n;
        Operation** operations = accounts[i]->getAllOperations(&n);
        for (unsigned j = 0; j < n; ++j)
            writeOperation(*accounts[i], *operations[j]);
    }
    json_.end();
}

void Report::writeOperation(const Account& account, const Operation& operation)
{
    json_.beginObject();
    write("account", account.getName());
    json_.key("type").text(nameOfType(operation.getType()));
    json_.key("date").date(operation.getDate());
    json_.key("automatic").boolean(operation.isAutomatic());
    if (const auto* deposit = dynamic_cast<const DepositAccountOperation*>(&operation))
        write("amount", deposit->getAmount());
    else if (const auto* transfer = dynamic_cast<const TransferAccountOperation*>(&operation))
        writeTransfer(*transfer);
    else if (const auto* trade = dynamic_cast<const ShareOperation*>(&operation))
        writeTrade(*trade);
    json_.end();
}

void Report::writeTransfer(const TransferAccountOperation& transfer)
{
    Account* recipient;
    if (transfer.getRecepientAccount(&recipient) == 0)
        write("recipient", recipient->getName());
    else
        json_.key("recipient").null();
    write("amount", transfer.getAmount());
    write("rateCost", transfer.getRateCost());
    write("cost", transfer.getCost());
    write("fromCurrencyQuote", transfer.getFromCurrencyQuote());
    write("toCurrencyQuote", transfer.getToCurrencyQuote());
}

void Report::writeTrade(const ShareOperation& trade)
{
    Share* share;
    const bool isOfShare = trade.getShare(&share) == 0;
    write("market", isOfShare ? share->getMarketName() : String());
    write("ticker", isOfShare ? share->getCompanyAbbreviation() : String());
    json_.key("quantity").number(trade.getQuantity());
    write("quote", trade.getQuote());
    write("operationCost", trade.getOperationCost());
}

void Report::writeEvolution()
{
    json_.key("evolution").beginArray();
    for (const EvolutionPoint& point : valuation_.evolution()) {
        json_.beginObject();
        json_.key("date").date(point.date);
        write("totalValue", point.totalValue);
        json_.end();
    }
    json_.end();
}

} // namespace

void writeJsonReport(const Valuation& valuation, FILE* out)
{
    Report(valuation, out).writeAll();
}
