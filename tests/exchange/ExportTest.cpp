#include "exchange/ExportFolder.h"
#include "exchange/FolderImport.h"
#include "market/NoteCompanyEvent.h"
#include "market/SplitCompanyEvent.h"
#include "tests/support/Bytes.h"
#include "tests/support/SmallPortfolio.h"
#include "tests/support/ToolRun.h"
#include "valuation/Evolution.h"
#include "valuation/State.h"

#include <cmath>
#include <gtest/gtest.h>
#include <iterator>

namespace {

/// Names as files may have them: equal ones, and such as are hard to tell in a table.
constexpr const char* kNames[] = {"Main",       "Main",      "Main #2",     "EUR",          " A  b ", "x,y;\"z\"",
                                  "one\ntwo\r", "\xE9t\xE9", "Übersicht\t", "C:\\new\\x41", "\\"};

/// Files of all that a person or a program can bring about, sensible or not.
class RandomFiles {
    unsigned below(std::size_t n) { return ::below(random_, n); }
    template <class List>
    auto pick(const List& list)
    {
        return list[below(std::size(list))];
    }

public:
    explicit RandomFiles(unsigned seed) : random_(seed)
    {
        Catalogue catalogue;
        Wallet wallet;
        for (int i = 0; i < 4; ++i)
            catalogue.addCurrency(makeCurrency());
        if (below(4) != 0)
            catalogue.setReferenceCurrency(pick(catalogue.getCurrencies()));
        wallet.setCatalogue(catalogue);
        for (int i = 0; i < 5; ++i) {
            accounts_.push_back(addAccount(wallet, name(), pick(catalogue.getCurrencies())));
            accounts_.back()->setDefaultTransferAccount(below(2) == 0);
            shares_.push_back(new Share(&wallet, pick(companies_)));
        }
        for (int i = 0; i < 80; ++i)
            operate();
        for (int i = 0; i < Wallet::kParameterCount; ++i)
            wallet.setParameter(static_cast<Wallet::Parameter>(i),
                                i == Wallet::kInvestementPeriod ? static_cast<float>(below(900)) - 90 : amount());
        marketFile = written([&](FILE* file) { EXPECT_EQ(catalogue.wrt(file, kStart), 0); });
        portfolioFile = written([&](FILE* file) { EXPECT_EQ(wallet.wrt(file, kStart), 0); });
    }

    std::string marketFile, portfolioFile;

private:
    const char* name() { return pick(kNames); }
    float amount()
    {
        constexpr float kOdd[] = {0, -0.0F, NAN, INFINITY, 1e-40F, 3.4e38F, 29.95F, 0.0017F};
        return below(12) == 0 ? pick(kOdd) : static_cast<float>(random_()) / 1e7F - 20;
    }
    Date date()
    {
        return below(30) == 0 ? Date(static_cast<short>(below(60)), static_cast<short>(below(14)),
                                     static_cast<int>(below(40000)) - 2000)
                              : daysAfterStart(below(40));
    }

    Currency* makeCurrency()
    {
        auto* currency = new Currency(name(), name(), nullptr);
        for (int i = 0; i < 5; ++i)
            new CurrencyQuote(currency, date(), amount());
        for (unsigned i = below(3); i > 0; --i) {
            auto* market = new Market(name());
            market->setCurrency(currency);
            for (unsigned j = below(4); j > 0; --j)
                companies_.push_back(makeCompany(market));
        }
        if (companies_.empty()) {
            auto* market = new Market("Paris");
            market->setCurrency(currency);
            companies_.push_back(makeCompany(market));
        }
        return currency;
    }
    Company* makeCompany(Market* market)
    {
        auto* company = new Company(market, name(), below(5) == 0 ? "" : name());
        for (int i = 0; i < 9; ++i)
            new CompanyQuote(company, date(), amount());
        new NoteCompanyEvent(company, date(), name(), name());
        new SplitCompanyEvent(company, date(), static_cast<short>(random_()), 1);
        return company;
    }
    void operate()
    {
        Account* account = pick(accounts_);
        if (below(2) == 0) {
            Share* share = pick(shares_);
            auto* traded = new ShareOperation(date(), share, below(3) != 0, static_cast<int>(below(90)) - 9, amount(),
                                              false, amount());
            traded->setAccount(account);
        } else if (below(2) == 0)
            new DepositAccountOperation(date(), account, amount(), false);
        else {
            auto* sent = new TransferAccountOperation(date(), account, pick(accounts_), amount(), false);
            // Income and charges, too, and what only looks like one.
            constexpr float kCosts[] = {0, -5, 1};
            sent->setAmount(below(2) == 0 ? sent->getAmount() : 0);
            sent->setCost(below(2) == 0 ? pick(kCosts) : amount());
            sent->setRateCost(below(2) == 0 ? pick(kCosts) : amount());
            sent->setFromCurrencyQuote(below(2) == 0 ? 1 : amount());
        }
    }

    std::mt19937 random_;
    std::vector<Company*> companies_;
    std::vector<Account*> accounts_;
    std::vector<Share*> shares_;
};

/// What a program has read of two files; empty for new ones.
struct Loaded {
    Loaded() = default;
    explicit Loaded(const RandomFiles& files)
    {
        EXPECT_EQ(catalogue.rd(BytesFile(files.marketFile)), 0);
        wallet.setCatalogue(catalogue);
        EXPECT_EQ(wallet.rd(BytesFile(files.portfolioFile), nullptr), 0);
    }
    std::string market() const
    {
        return written([&](FILE* file) { EXPECT_EQ(catalogue.wrt(file, kStart), 0); });
    }
    std::string portfolio() const
    {
        return written([&](FILE* file) { EXPECT_EQ(wallet.wrt(file, kStart), 0); });
    }

    Catalogue catalogue;
    Wallet wallet;
};

void exportTo(const std::string& folder, Loaded& loaded)
{
    EvolutionOutcome outcome;
    const State* state = refreshStates(loaded.wallet, daysAfterStart(20), false, &outcome);
    ExportFolder tables(folder, loaded.catalogue, &loaded.wallet);
    tables.addMarketData();
    tables.addPortfolio(*state, evolutionPoints(loaded.wallet, loaded.catalogue));
    tables.commit();
}

void importFrom(const std::string& folder, Loaded& loaded)
{
    FolderImport tables(folder);
    tables.readMarketData(loaded.catalogue);
    tables.readPortfolio(loaded.wallet);
}

} // namespace

TEST(ExportTest, WhatIsReadBackIsWhatWasThereByteForByte)
{
    const TemporaryFolder folder("pelorin-export-test");
    for (unsigned seed = 1; seed <= 25; ++seed) {
        // Files of equal bytes value to the same bits on any day.
        Loaded before{RandomFiles(seed)};
        exportTo(folder.path, before);
        Loaded after;
        importFrom(folder.path, after);
        ASSERT_EQ(after.market(), before.market()) << seed;
        ASSERT_EQ(after.portfolio(), before.portfolio()) << seed;
    }
}
