#include "sample/SamplePortfolio.h"

#include "market/Catalogue.h"
#include "market/Company.h"
#include "market/Currency.h"
#include "portfolio/Account.h"
#include "portfolio/DepositAccountOperation.h"
#include "portfolio/Share.h"
#include "portfolio/ShareOperation.h"
#include "portfolio/TransferAccountOperation.h"
#include "portfolio/Wallet.h"
#include "sample/SampleMarket.h"

#include <string_view>
#include <unordered_map>

namespace {

constexpr const char* kSavings = "Savings";
constexpr const char* kParis = "Paris broker";
constexpr const char* kNewYork = "New York broker";
constexpr const char* kLondon = "London broker";

constexpr struct AccountPlan {
    const char* name;
    const char* symbol;
    bool isDefaultTransfer;
} kAccounts[] = {{kSavings, "EUR", true}, {kParis, "EUR", false}, {kNewYork, "USD", false}, {kLondon, "GBP", false}};

constexpr struct DepositPlan {
    std::size_t day;
    const char* account;
    float amount;
} kDeposits[] = {
    {0, kSavings, 40000},  {131, kSavings, 5000}, {262, kSavings, 5000}, {393, kSavings, 5000},  {524, kSavings, 6000},
    {655, kSavings, 6000}, {786, kSavings, 6000}, {917, kSavings, 6000}, {1048, kSavings, 7000}, {1179, kSavings, 7000},
};

constexpr struct TransferPlan {
    std::size_t day;
    const char* from;
    const char* to;
    float amount;
    float rateCost; // what the exchange takes
    float cost;
} kTransfers[] = {
    {2, kSavings, kParis, 14000, 0, 0},           {3, kSavings, kNewYork, 18000, 0.002F, 12},
    {134, kSavings, kLondon, 8000, 0.002F, 12},   {396, kSavings, kParis, 5000, 0, 0},
    {527, kSavings, kNewYork, 12000, 0.002F, 12}, {700, kNewYork, kSavings, 5000, 0.002F, 15},
    {789, kSavings, kLondon, 5000, 0.002F, 12},   {920, kSavings, kParis, 8000, 0, 0},
    {1100, kLondon, kSavings, 2500, 0.002F, 10},  {1182, kSavings, kNewYork, 9000, 0.002F, 12},
};

constexpr struct TradePlan {
    std::size_t day;
    const char* account;
    const char* ticker;
    int amount; // to buy for about that much; a percentage of the holding to sell when it is negative
} kTrades[] = {
    {6, kParis, "VMBC", 4000},      {6, kNewYork, "QLLN", 5000},    {12, kNewYork, "NDWK", 5000},
    {34, kParis, "EARM", 4000},     {41, kNewYork, "OSDR", 4000},   {66, kNewYork, "LXRO", 4000},
    {90, kParis, "BVQY", 3500},     {138, kLondon, "WTCB", 2500},   {150, kLondon, "MRLM", 2000},
    {160, kLondon, "THBW", 1500},   {190, kParis, "BVQY", -50},     {205, kParis, "CHLV", 3000},
    {301, kNewYork, "LXRO", -50},   {318, kNewYork, "PRHG", 2000},  {399, kParis, "EARM", 2500},
    {436, kParis, "VMBC", -40},     {472, kParis, "MDLB", 4000},    {530, kNewYork, "ZPHR", 4000},
    {535, kNewYork, "CDFP", 3500},  {571, kNewYork, "LXRO", -100},  {610, kParis, "CHLV", -100},
    {652, kNewYork, "QLLN", -40},   {690, kLondon, "WTCB", -50},    {698, kNewYork, "NDWK", -25},
    {705, kLondon, "KMBR", 1500},   {712, kNewYork, "HWMR", 4000},  {735, kParis, "EARM", -50},
    {764, kNewYork, "AMOE", 3000},  {776, kParis, "BVQY", 3000},    {800, kLondon, "MRLM", 2500},
    {833, kLondon, "THBW", 1500},   {905, kNewYork, "ZPHR", -50},   {924, kParis, "MDLB", 3000},
    {931, kParis, "VMBC", 3000},    {962, kNewYork, "TNHP", 2500},  {1003, kLondon, "KMBR", -100},
    {1014, kNewYork, "NDWK", -30},  {1046, kNewYork, "OSDR", -100}, {1092, kLondon, "MRLM", -30},
    {1121, kParis, "EARM", 3000},   {1150, kNewYork, "AMOE", -100}, {1186, kNewYork, "PRHG", 4500},
    {1210, kNewYork, "SRVN", 3000}, {1248, kParis, "MDLB", -40},    {1262, kLondon, "MRLM", -50},
    {1271, kNewYork, "AMOE", 4000}, {1288, kParis, "CHLV", 4500},   {1296, kNewYork, "ZPHR", 3000},
};

/// Carries out the plans, each kind in the order of its table. Deposits and transfers may come before the trades that
/// they pay for are made: the accounts sort their operations by day, and no balance is kept here.
class Portfolio {
public:
    Portfolio(Wallet& wallet, const Catalogue& catalogue, const std::vector<Date>& days)
        : wallet_(wallet), catalogue_(catalogue), days_(days)
    {
        for (const AccountPlan& plan : kAccounts) {
            auto* account = new Account(plan.name); // owned by the wallet
            account->setWallet(&wallet);
            account->setCurrency(catalogue.getCurrencyByRepresentation(plan.symbol));
            account->setDefaultTransferAccount(plan.isDefaultTransfer);
        }
    }

    void add(const DepositPlan& plan)
    {
        new DepositAccountOperation(days_[plan.day], wallet_.getAccountByName(plan.account), plan.amount, false);
    }

    void add(const TransferPlan& plan)
    {
        const Date& day = days_[plan.day];
        Account* from = wallet_.getAccountByName(plan.from);
        Account* to = wallet_.getAccountByName(plan.to);
        auto* transfer = new TransferAccountOperation(day, from, to, plan.amount, false);
        transfer->setRateCost(plan.rateCost);
        transfer->setCost(plan.cost);
        transfer->setFromCurrencyQuote(rateOf(*from, day));
        transfer->setToCurrencyQuote(rateOf(*to, day));
    }

    void add(const TradePlan& plan)
    {
        const Date& day = days_[plan.day];
        Holding& holding = find(plan.ticker);
        const float quote = holding.company->getRealQuote(day);
        const bool buy = plan.amount > 0;
        const int quantity =
            buy ? static_cast<int>(static_cast<double>(plan.amount) / quote) : holding.quantity * -plan.amount / 100;
        // What is held is known here only: quantities are computed from the operations, which would take a valuation
        // each.
        holding.quantity += buy ? quantity : -quantity;
        const float cost = buy ? wallet_.getBuyCost() : wallet_.getSellCost();
        auto* trade = new ShareOperation(day, holding.share, buy, quantity, quote, false, cost);
        trade->setAccount(wallet_.getAccountByName(plan.account));
    }

private:
    struct Holding {
        Company* company = nullptr;
        Share* share = nullptr;
        int quantity = 0;
    };

    static float rateOf(const Account& account, const Date& day)
    {
        Currency* currency = nullptr;
        return account.getCurrency(&currency) == 0 ? currency->getRealQuote(day) : 1;
    }

    Holding& find(const char* ticker)
    {
        Holding& holding = holdings_[ticker];
        // A place that was just made has no company; afterwards each ticker has one holding in the wallet.
        if (holding.company != nullptr)
            return holding;
        holding.company = findCompany(catalogue_, ticker);
        holding.share = new Share(&wallet_, holding.company); // owned by the wallet
        return holding;
    }

    Wallet& wallet_;
    const Catalogue& catalogue_;
    const std::vector<Date>& days_;
    std::unordered_map<std::string_view, Holding> holdings_; // by ticker
};

} // namespace

void fillSamplePortfolio(Wallet& wallet, const Catalogue& catalogue, const std::vector<Date>& days)
{
    Portfolio portfolio(wallet, catalogue, days);
    for (const DepositPlan& plan : kDeposits)
        portfolio.add(plan);
    for (const TransferPlan& plan : kTransfers)
        portfolio.add(plan);
    for (const TradePlan& plan : kTrades)
        portfolio.add(plan);
}
