#include "tests/bench/GeneratedFiles.h"

#include "market/Company.h"
#include "portfolio/DepositAccountOperation.h"
#include "portfolio/ShareOperation.h"
#include "portfolio/TransferAccountOperation.h"
#include "tests/bench/ChildRun.h"
#include "tests/bench/Portfolio.h"

#include <random>
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
        for (int i = 0; i < size_.accounts; ++i) {
            accounts_.push_back(new Account(("Account " + std::to_string(i)).c_str()));
            accounts_.back()->setWallet(&portfolio_.wallet);
            accounts_.back()->setCurrency(
                portfolio_.catalogue.getCurrencies()[static_cast<unsigned>(i % GeneratedFiles::kCurrencies)]);
        }
        const std::vector<Market*> markets = portfolio_.catalogue.getMarkets();
        for (int i = 0; i < size_.holdings; ++i) {
            unsigned n;
            Company** companies = markets[static_cast<unsigned>(i % GeneratedFiles::kCurrencies)]->getAllCompanies(&n);
            shares_.push_back(new Share(&portfolio_.wallet, companies[i / GeneratedFiles::kCurrencies]));
        }
        const int days = Portfolio::lastDay() - first_;
        for (int i = 0; i < size_.operations; ++i) {
            Date day = first_;
            makeOperation(i % 10, day.moveBy(i > 0 ? below(days) : 0)); // the first one begins the evolution
        }
    }

    void makeOperation(int kind, const Date& day)
    {
        Account* account = accounts_[static_cast<unsigned>(below(size_.accounts))];
        if (kind == 0) {
            new DepositAccountOperation(day, account, between(1000, 10000), false);
        } else if (kind == 1) {
            Account* recipient = accounts_[static_cast<unsigned>(below(size_.accounts))];
            auto* transfer = new TransferAccountOperation(day, account, recipient, between(100, 1000), false);
            transfer->setRateCost(0.001F);
            transfer->setFromCurrencyQuote(between(0.5, 1.5));
        } else {
            Share* share = shares_[static_cast<unsigned>(below(size_.holdings))];
            auto* trade = new ShareOperation(day, share, kind < 7, kind < 7 ? 50 : 70, 0, false, 29.95F);
            share->getQuote(day, &price_);
            trade->setQuote(price_);
            trade->setAccount(account);
        }
    }

    const DataSize& size_;
    Portfolio& portfolio_;
    Date first_;
    std::mt19937 random_{1};
    std::vector<Account*> accounts_;
    std::vector<Share*> shares_;
    float price_ = 0;
};

template <class Object>
bool save(const Object& object, const std::filesystem::path& path)
{
    FILE* file = std::fopen(path.c_str(), "wb");
    const int result = file != nullptr ? object.wrt(file, Portfolio::lastDay()) : -1;
    return file != nullptr && std::fclose(file) == 0 && result == 0;
}

} // namespace

GeneratedFiles::GeneratedFiles()
{
    std::string folder = std::filesystem::temp_directory_path() / "pelorin-bench-XXXXXX";
    if (mkdtemp(folder.data()) == nullptr)
        throw std::runtime_error("cannot make a temporary folder");
    folder_ = folder;
}

GeneratedFiles::~GeneratedFiles()
{
    std::error_code ignored;
    std::filesystem::remove_all(folder_, ignored);
}

const GeneratedFiles::Files& GeneratedFiles::files(const DataSize& size)
{
    const auto found = files_.find(size);
    if (found != files_.end())
        return found->second;
    const std::string number = std::to_string(files_.size());
    const Files files{folder_ / ("market" + number), folder_ / ("wallet" + number)};
    // In a child, so that this process stays as small as it is when the children that are measured begin.
    const ChildRun run([] { return true; },
                       [&] {
                           Portfolio portfolio;
                           Generator(size, portfolio);
                           return save(portfolio.catalogue, files.market) && save(portfolio.wallet, files.wallet);
                       });
    if (!run.succeeded)
        throw std::runtime_error("cannot write files into " + folder_.string());
    return files_[size] = files;
}
