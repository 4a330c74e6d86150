#include "tools/Reports.h"

#include "foundation/DateText.h"
#include "market/Currency.h"
#include "portfolio/Account.h"
#include "portfolio/DepositAccountOperation.h"
#include "portfolio/OperationKind.h"
#include "portfolio/Share.h"
#include "portfolio/ShareOperation.h"
#include "portfolio/TransferAccountOperation.h"
#include "tools/Valuation.h"
#include "valuation/AccountState.h"
#include "valuation/ShareState.h"
#include "valuation/State.h"

#include <cctype>
#include <nlohmann/json.hpp>
#include <ranges>

namespace {

/// Keeps the order of the keys. Its floats take 9 significant digits at most, which read back to the same float; one
/// that is not finite becomes null.
using Json =
    nlohmann::basic_json<nlohmann::ordered_map, std::vector, std::string, bool, std::int64_t, std::uint64_t, float>;

/// One line; bytes that are no UTF-8 become U+FFFD.
std::string dump(const Json& json)
{
    return json.dump(-1, ' ', false, Json::error_handler_t::replace);
}

/// An object on a stream, a line for each member and for each item of a list. It is never held as a whole: a name may
/// be as long as a file, and every operation repeats its account's.
class ObjectWriter {
public:
    explicit ObjectWriter(FILE* out) : out_(out) { put("{"); }

    void add(const char* key, const Json& value) { put(beginMember(key) + dump(value)); }
    /// `describe` makes a value of each of `items`.
    template <class Items, class Describe>
    void addList(const char* key, Items&& items, const Describe& describe)
    {
        put(beginMember(key) + "[");
        // The line of an item is ended by what follows it: only then is it known whether a comma belongs there.
        bool isFirst = true;
        for (const auto& item : items) {
            put((isFirst ? "\n    " : ",\n    ") + dump(describe(item)));
            isFirst = false;
        }
        put(isFirst ? "]" : "\n  ]");
    }
    void end() { put("\n}\n"); }

private:
    std::string beginMember(const char* key)
    {
        const std::string member = (isFirstMember_ ? "\n  " : ",\n  ") + dump(key) + ": ";
        isFirstMember_ = false;
        return member;
    }
    void put(const std::string& bytes) { std::fwrite(bytes.data(), 1, bytes.size(), out_); }

    FILE* out_;
    bool isFirstMember_ = true;
};

std::string text(const String& text)
{
    return std::string(text.bytes());
}

Json day(const Date& date)
{
    return date.isUndefined() ? Json() : Json(dateText(date));
}

void addTotals(const Valuation& valuation, ObjectWriter& report)
{
    const Totals totals = valuation.totals();
    const Currency* reference = valuation.catalogue().getReferenceCurrency();
    const auto known = [&totals](float total) { return totals.isKnown ? Json(total) : Json(); };
    report.add("reference", totals.isKnown ? Json(text(reference->getRepresentation())) : Json());
    report.add("totalDeposit", known(totals.totalDeposit));
    report.add("totalValue", known(totals.totalValue));
    report.add("profit", known(totals.profit));
    report.add("annualRevenue", known(totals.annualRevenue));
    const auto rate = [](const AnnualReturn& annual) { return annual.isKnown() ? Json(annual.rate) : Json(); };
    report.add("moneyWeightedReturn", rate(valuation.returns().moneyWeighted));
    report.add("timeWeightedReturn", rate(valuation.returns().timeWeighted));
}

Json describeAccount(const AccountState* cash)
{
    const Account* account = cash->account();
    return {{"name", text(cash->getAccountName())},
            {"currency", text(cash->getCurrencyRepresentation())},
            {"cash", cash->getCash()},
            {"defaultTransfer", account != nullptr && account->isDefaultTransferAccount()}};
}

Json describeSums(const HoldingSums& sums)
{
    return {{"bought", sums.bought},
            {"sold", sums.sold},
            {"costs", sums.costs},
            {"income", sums.income},
            {"realisedGain", sums.realisedGain},
            {"unrealisedGain", sums.unrealisedGain ? Json(*sums.unrealisedGain) : Json()}};
}

Json describeHolding(const ShareState* holding, const HoldingFigures& figures)
{
    const Share* share = holding->share();
    Json json = {{"market", share != nullptr ? text(share->getMarketName()) : ""},
                 {"ticker", text(holding->getCompanyAbbreviation())},
                 {"name", text(holding->getCompanyName())},
                 {"quantity", holding->getQuantity()},
                 {"buyQuote", holding->getBuyQuote()},
                 {"quote", holding->getQuote()},
                 {"endDate", day(holding->getEndDate())},
                 {"currency", text(holding->getCurrencyRepresentation())}};
    json.update(describeSums(figures.own));
    json["inReference"] = figures.inReference ? describeSums(*figures.inReference) : Json();
    return json;
}

Json describe(const TransferAccountOperation& transfer)
{
    const Account* recipient = transfer.recipient();
    return {{"recipient", recipient != nullptr ? Json(text(recipient->getName())) : Json()},
            {"amount", transfer.getAmount()},
            {"rateCost", transfer.getRateCost()},
            {"cost", transfer.getCost()},
            {"fromCurrencyQuote", transfer.getFromCurrencyQuote()},
            {"toCurrencyQuote", transfer.getToCurrencyQuote()}};
}

Json describe(const ShareOperation& trade)
{
    const Share* share = trade.share();
    return {{"market", share != nullptr ? text(share->getMarketName()) : ""},
            {"ticker", share != nullptr ? text(share->getCompanyAbbreviation()) : ""},
            {"quantity", trade.getQuantity()},
            {"quote", trade.getQuote()},
            {"operationCost", trade.getOperationCost()}};
}

std::string kindText(const Operation& operation)
{
    std::string kind = nameOf(kindOf(operation));
    kind[0] = static_cast<char>(std::tolower(kind[0]));
    return kind;
}

/// An operation that an account lists.
Json describeOperation(const Operation* operation)
{
    constexpr const char* kTypes[] = {"", "deposit", "transfer", "buy", "sell"}; // by type code
    Json json = {{"account", text(operation->account()->getName())},
                 {"type", kTypes[operation->getType()]},
                 {"kind", kindText(*operation)},
                 {"date", day(operation->getDate())},
                 {"automatic", operation->isAutomatic()}};
    if (const auto* deposit = dynamic_cast<const DepositAccountOperation*>(operation))
        json["amount"] = deposit->getAmount();
    else if (const auto* transfer = dynamic_cast<const TransferAccountOperation*>(operation))
        json.update(describe(*transfer));
    else if (const auto* trade = dynamic_cast<const ShareOperation*>(operation))
        json.update(describe(*trade));
    return json;
}

Json describePoint(const EvolutionPoint& point)
{
    return {{"date", day(point.date)}, {"totalValue", point.totalValue}};
}

} // namespace

void writeJsonReport(const Valuation& valuation, FILE* out)
{
    const State& state = valuation.state();
    ObjectWriter report(out);
    report.add("date", day(state.getDate()));
    addTotals(valuation, report);
    report.add("firstOperationDate", day(state.getFirstOperationDate()));
    report.addList("accounts", state.accountStates(), describeAccount);
    auto figures = valuation.figures().begin(); // of each, in the same order
    report.addList("shares", state.shareStates(),
                   [&figures](const ShareState* holding) { return describeHolding(holding, *figures++); });
    // A view, and no list: a portfolio may have millions of operations.
    const auto operations = valuation.wallet().accounts() | std::views::transform(&Account::operations);
    report.addList("operations", operations | std::views::join, describeOperation);
    if (valuation.hasEvolution())
        report.addList("evolution", valuation.evolution(), describePoint);
    report.end();
}
