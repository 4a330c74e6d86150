#include "tests/bench/GeneratedFiles.h"

#include "tests/bench/ChildRun.h"
#include "tests/support/Bytes.h"
#include "tests/support/SmallPortfolio.h"

#include <stdexcept>
#include <string>

namespace {

/// Builds a portfolio and its market data. Everything made here is owned by what it is linked to.
class Generator {
public:
    Generator(const DataSize& size, Portfolio& portfolio)
        : size_(size), portfolio_(portfolio), first_(Portfolio::lastDay())
    {
        first_.setYear(first_.getYear() - size.years);
        for (int i = 0; i < GeneratedFiles::kCurrencies; ++i)
            makeCurrency(std::to_string(i));
        portfolio.wallet.setCatalogue(portfolio.catalogue);
        makeWallet();
    }

private:
    float between(double low, double high)
    {
        return static_cast<float>(std::uniform_real_distribution(low, high)(random_));
    }
    int below(int bound) { return std::uniform_int_distribution(0, bound - 1)(random_); }

    void makeCurrency(const std::string& number)
    {
        auto* currency = new Currency(("Currency " + number).c_str(), ("C" + number).c_str(), nullptr);
        portfolio_.catalogue.addCurrency(currency);
        const bool isReference = portfolio_.catalogue.getReferenceCurrency() == nullptr;
        if (isReference)
            portfolio_.catalogue.setReferenceCurrency(currency);
        for (Date day = first_; day <= Portfolio::lastDay(); day + 1)
            new CurrencyQuote(currency, day, isReference ? 1 : between(0.5, 1.5));
        auto* market = new Market(("Market " + number).c_str());
        market->setCurrency(currency);
        for (int i = 0; i < size_.companies / GeneratedFiles::kCurrencies; ++i)
            makeCompany(market, std::to_string(i) + "." + number);
    }

    void makeCompany(Market* market, const std::string& ticker)
    {
        auto* company = new Company(market, ("Company " + ticker).c_str(), ticker.c_str());
        float price = between(10, 100);
        int weekday = 0;
        for (Date day = first_; day <= Portfolio::lastDay(); day + 1, weekday = (weekday + 1) % 7)
            if (weekday < 5)
                new CompanyQuote(company, day, price *= between(0.98, 1.0205));
    }

    void makeWallet()
    {
        const auto& currencies = portfolio_.catalogue.getCurrencies();
        for (std::size_t i = 0; i < static_cast<std::size_t>(size_.accounts); ++i)
            accounts_.push_back(addAccount(portfolio_.wallet, ("Account " + std::to_string(i)).c_str(),
                                           currencies[i % GeneratedFiles::kCurrencies]));
        const std::vector<Market*> markets = portfolio_.catalogue.getMarkets();
        for (std::size_t i = 0; i < static_cast<std::size_t>(size_.holdings); ++i) {
            const auto companies = all(*markets[i % GeneratedFiles::kCurrencies], &Market::getAllCompanies);
            shares_.push_back(new Share(&portfolio_.wallet, companies[i / GeneratedFiles::kCurrencies]));
        }
        const int begin = first_ - kStart, days = Portfolio::lastDay() - first_;
        for (int i = 0; i < size_.operations; ++i)
            makeOperation(i % 10, begin + (i > 0 ? below(days) : 0)); // the first one begins the evolution
    }

    void makeOperation(int kind, int day)
    {
        Account* account = accounts_[static_cast<unsigned>(below(size_.accounts))];
        if (kind == 0) {
            deposit(account, day, between(1000, 10000));
        } else if (kind == 1) {
            Account* recipient = accounts_[static_cast<unsigned>(below(size_.accounts))];
            TransferAccountOperation* sent = transfer(account, recipient, day, between(100, 1000));
            sent->setRateCost(0.001F);
            sent->setFromCurrencyQuote(between(0.5, 1.5));
        } else {
            Share* share = shares_[static_cast<unsigned>(below(size_.holdings))];
            float price;
            share->getQuote(daysAfterStart(day), &price);
            trade(share, account, day, kind < 7 ? 50 : -70, price, 29.95F);
        }
    }

    const DataSize& size_;
    Portfolio& portfolio_;
    Date first_;
    std::mt19937 random_{1};
    std::vector<Account*> accounts_;
    std::vector<Share*> shares_;
};

} // namespace

const GeneratedFiles::Files& GeneratedFiles::files(const DataSize& size)
{
    const auto found = files_.find(size);
    if (found != files_.end())
        return found->second;
    const std::string number = std::to_string(files_.size());
    const Files files{folder_.path / ("market" + number), folder_.path / ("wallet" + number)};
    // In a child, so that this process stays as small as it is when the children that are measured begin.
    const ChildRun run([] { return true; },
                       [&] {
                           Portfolio portfolio;
                           Generator(size, portfolio);
                           const Date day = Portfolio::lastDay();
                           folder_.write(files.market, written([&](FILE* f) { portfolio.catalogue.wrt(f, day); }));
                           folder_.write(files.wallet, written([&](FILE* f) { portfolio.wallet.wrt(f, day); }));
                           return true;
                       });
    if (!run.succeeded)
        throw std::runtime_error("cannot write files into " + folder_.path.string());
    return files_[size] = files;
}
