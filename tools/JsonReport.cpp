#include "tools/JsonReport.h"

#include "market/Currency.h"
#include "portfolio/Account.h"
#include "portfolio/DepositAccountOperation.h"
#include "portfolio/Share.h"
#include "portfolio/ShareOperation.h"
#include "portfolio/TransferAccountOperation.h"
#include "tools/Valuation.h"
#include "valuation/AccountState.h"
#include "valuation/ShareState.h"
#include "valuation/State.h"

#include <nlohmann/json.hpp>

namespace {

/// Keeps the order of the keys. Its floats take 9 significant digits at most, which read back to the same float; one
/// that is not finite becomes null.
using Json =
    nlohmann::basic_json<nlohmann::ordered_map, std::vector, std::string, bool, std::int64_t, std::uint64_t, float>;

std::string text(const String& text)
{
    return std::string(text.bytes());
}

Json day(const Date& date)
{
    return date.isUndefined() ? Json() : Json(text(date.toString()));
}

void addTotals(const Valuation& valuation, Json* report)
{
    const Totals totals = valuation.totals();
    const Currency* reference = valuation.catalogue().getReferenceCurrency();
    const auto known = [&totals](float total) { return totals.isKnown ? Json(total) : Json(); };
    (*report)["reference"] = totals.isKnown ? Json(text(reference->getRepresentation())) : Json();
    (*report)["totalDeposit"] = known(totals.totalDeposit);
    (*report)["totalValue"] = known(totals.totalValue);
    (*report)["profit"] = known(totals.profit);
    (*report)["annualRevenue"] = known(totals.annualRevenue);
}

Json accounts(const State& state)
{
    Json list = Json::array();
    unsigned n;
    AccountState** states = state.getAllAccountStates(&n);
    for (unsigned i = 0; i < n; ++i) {
        const Account* account = states[i]->listed();
        list.push_back({{"name", text(states[i]->getAccountName())},
                        {"currency", text(states[i]->getCurrencyRepresentation())},
                        {"cash", states[i]->getCash()},
                        {"defaultTransfer", account != nullptr && account->isDefaultTransferAccount()}});
    }
    return list;
}

Json shares(const State& state)
{
    Json list = Json::array();
    unsigned n;
    ShareState** states = state.getAllShareStates(&n);
    for (unsigned i = 0; i < n; ++i) {
        const Share* share = states[i]->listed();
        list.push_back({{"market", share != nullptr ? text(share->getMarketName()) : ""},
                        {"ticker", text(states[i]->getCompanyAbbreviation())},
                        {"name", text(states[i]->getCompanyName())},
                        {"quantity", states[i]->getQuantity()},
                        {"buyQuote", states[i]->getBuyQuote()},
                        {"quote", states[i]->getQuote()},
                        {"endDate", day(states[i]->getEndDate())},
                        {"currency", text(states[i]->getCurrencyRepresentation())}});
    }
    return list;
}

Json describe(const TransferAccountOperation& transfer)
{
    Account* recipient;
    const bool isReceived = transfer.getRecepientAccount(&recipient) == 0;
    return {{"recipient", isReceived ? Json(text(recipient->getName())) : Json()},
            {"amount", transfer.getAmount()},
            {"rateCost", transfer.getRateCost()},
            {"cost", transfer.getCost()},
            {"fromCurrencyQuote", transfer.getFromCurrencyQuote()},
            {"toCurrencyQuote", transfer.getToCurrencyQuote()}};
}

Json describe(const ShareOperation& trade)
{
    Share* share;
    const bool isOfShare = trade.getShare(&share) == 0;
    return {{"market", isOfShare ? text(share->getMarketName()) : ""},
            {"ticker", isOfShare ? text(share->getCompanyAbbreviation()) : ""},
            {"quantity", trade.getQuantity()},
            {"quote", trade.getQuote()},
            {"operationCost", trade.getOperationCost()}};
}

Json describe(const Account& account, const Operation& operation)
{
    constexpr const char* kTypes[] = {"", "deposit", "transfer", "buy", "sell"}; // by type code
    Json json = {{"account", text(account.getName())},
                 {"type", kTypes[operation.getType()]},
                 {"date", day(operation.getDate())},
                 {"automatic", operation.isAutomatic()}};
    if (const auto* deposit = dynamic_cast<const DepositAccountOperation*>(&operation))
        json["amount"] = deposit->getAmount();
    else if (const auto* transfer = dynamic_cast<const TransferAccountOperation*>(&operation))
        json.update(describe(*transfer));
    else if (const auto* trade = dynamic_cast<const ShareOperation*>(&operation))
        json.update(describe(*trade));
    return json;
}

Json operations(const Wallet& wallet)
{
    Json list = Json::array();
    unsigned nAccounts;
    Account** accounts = wallet.getAllAccounts(&nAccounts);
    for (unsigned i = 0; i < nAccounts; ++i) {
        unsigned n;
        Operation** operations = accounts[i]->getAllOperations(&n);
        for (unsigned j = 0; j < n; ++j)
            list.push_back(describe(*accounts[i], *operations[j]));
    }
    return list;
}

} // namespace

void writeJsonReport(const Valuation& valuation, FILE* out)
{
    const State& state = valuation.state();
    Json report = {{"date", day(state.getDate())}};
    addTotals(valuation, &report);
    report["firstOperationDate"] = day(state.getFirstOperationDate());
    report["accounts"] = accounts(state);
    report["shares"] = shares(state);
    report["operations"] = operations(valuation.wallet());
    if (valuation.hasEvolution()) {
        Json& points = report["evolution"] = Json::array();
        for (const EvolutionPoint& point : valuation.evolution())
            points.push_back({{"date", day(point.date)}, {"totalValue", point.totalValue}});
    }
    const std::string bytes = report.dump(2, ' ', false, Json::error_handler_t::replace) + '\n';
    std::fwrite(bytes.data(), 1, bytes.size(), out);
}
