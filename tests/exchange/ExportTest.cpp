#include "exchange/ExportFolder.h"
#include "exchange/FolderImport.h"
#include "exchange/Journal.h"
#include "market/NoteCompanyEvent.h"
#include "market/SplitCompanyEvent.h"
#include "tests/support/Bytes.h"
#include "tests/support/SmallPortfolio.h"
#include "tests/support/ToolRun.h"
#include "valuation/Evolution.h"
#include "valuation/State.h"
#include "valuation/Totals.h"

#include <cmath>
#include <gmock/gmock.h>
#include <iterator>
#include <numeric>

using testing::HasSubstr;

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
        marketFile = bytesWritten(catalogue, kStart);
        portfolioFile = bytesWritten(wallet, kStart);
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
    std::string market() const { return bytesWritten(catalogue, kStart); }
    std::string portfolio() const { return bytesWritten(wallet, kStart); }

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
    tables.readPortfolio(loaded.wallet, loaded.catalogue);
}

} // namespace

TEST(ExportTest, WhatIsReadBackIsWhatWasThereByteForByte)
{
    const TemporaryFolder folder("pelorin-export-test");
    std::vector<unsigned> seeds(25);
    std::iota(seeds.begin(), seeds.end(), 1);
    seeds.insert(seeds.end(),
                 {164, 331}); // markets that a table calls alike, and an income with a zero that has a sign
    for (const unsigned seed : seeds) {
        // Files of equal bytes value to the same bits on any day.
        Loaded before{RandomFiles(seed)};
        exportTo(folder.path, before);
        Loaded after;
        importFrom(folder.path, after);
        ASSERT_TRUE(after.market() == before.market()) << seed;
        ASSERT_TRUE(after.portfolio() == before.portfolio()) << seed;
        // And it stays so when they are read once more: what bears the name of another one is told from it.
        importFrom(folder.path, after);
        ASSERT_TRUE(after.market() == before.market()) << seed;
        ASSERT_TRUE(after.portfolio() == before.portfolio()) << seed;
    }
}

TEST(ExportTest, TablesAddWhatIsNewToFilesThatAreThereAndRefuseTheRest)
{
    const TemporaryFolder folder("pelorin-export-test");
    const std::string sample = "data/Companies/Sample data/PortoFolios/Sample";
    const std::string into = " --from tables --into market --portfolio wallet";
    const auto import = [&](const std::string& options) {
        return ToolRun("env", "HOME=\"$PWD\" '" PELORIN_IMPORT "' " + options, folder);
    };
    ASSERT_EQ(ToolRun(PELORIN_SAMPLE, "data --date 20/07/2025", folder).status, 0);
    EXPECT_EQ(ToolRun(PELORIN_EXPORT, sample + " --to tables --date 20/07/2025", folder).err, "");
    EXPECT_EQ(folder.content("tables/operations.csv").substr(0, 161),
              "Date,Type,Account,To Account,Market,Ticker,Quantity,Quote,Amount,Cost,Rate Cost,From Quote,To Quote\n"
              "2020-07-20,Deposit,Savings,,,,,,40000,,,,\n2020-07-22,Transfer");
    EXPECT_EQ(import(into).out, "quotes: 26100 new, 0 changed, 0 equal\nrates: 3915 new, 0 changed, 0 equal\n"
                                "operations: 68 new, 0 changed, 0 equal\nrefused: 0\n");
    const std::string market = folder.content("market"), wallet = folder.content("wallet");
    EXPECT_EQ(ToolRun(PELORIN_VALUE, sample + " --date 20/09/2025 --evolution --json", folder).out,
              ToolRun(PELORIN_VALUE, "market wallet --date 20/09/2025 --evolution --json", folder).out);

    // A quote that changes, one that comes between others, one day of a company that is new, and a deposit.
    const auto append = [&](const char* table, const char* row) { folder.write(table, folder.content(table) + row); };
    append("tables/quotes.csv",
           "2020-07-21,VMBC,50,Paris,EUR\n2020-07-25,VMBC,51,Paris,EUR\n2020-07-25,N,1,Paris,EUR\n");
    append("tables/listing.csv", "N,Paris,EUR,New,\n");
    append("tables/operations.csv", "2020-07-20,Deposit,Savings,,,,,,40000,,,,\n");
    const std::string changes = "quotes: 2 new, 1 changed, 26099 equal\nrates: 0 new, 0 changed, 3915 equal\n"
                                "operations: 1 new, 0 changed, 68 equal\nrefused: 0\n";
    EXPECT_EQ(import(into + " --dry-run").out, changes);
    EXPECT_TRUE(folder.content("market") + folder.content("wallet") == market + wallet);
    EXPECT_EQ(import(into).out, changes);
    EXPECT_EQ(folder.content("market").size(), market.size() + 2 * 12 + 4 + 3 + 4 + 1 + 4 + 4);
    EXPECT_EQ(folder.content("wallet").size(), wallet.size() + 13);

    // From here on the tables also have a currency and a market that are called like others.
    append("tables/currencies.csv", "EUX,Euro,,\n");
    append("tables/markets.csv", "Paris,EUX,\n");
    append("tables/listing.csv", "VMBC,Paris,EUX,,\n");
    folder.write("foreign/quotes.csv", "Date,Ticker,Close\n");
    folder.write("dollar",
                 bytesOf("03000000'USD' 01000000 0000000000000000 03000000'USD' 03000000'USD' 00000000 00000000"));
    const struct {
        std::string arguments;
        const char *table, *row, *message;
    } cases[] = {
        {into, "rates.csv", "2020-07-20,XXX,1\n", "\"XXX\" under Currency is in no other table"},
        {into, "rates.csv", "2020-07-20,USD,\n", "\"\" is no number with a decimal point"},
        {into, "accounts.csv", "Savings,USD,,,,\n", "accounts.csv, line 6: names the account \"Savings\" once more"},
        {into, "accounts.csv", "New,EUX,,,,\n", "cannot refer to the currency \"EUX\" by the name \"Euro\""},
        {into, "holdings.csv", "2025-07-20,Paris,VMBC,EUX,,,,,,\n",
         "cannot refer to the market of the company \"VMBC\" by the name \"Paris\""},
        {" --from tables --into dollar", "rates.csv", "",
         "has the reference currency \"EUR\", and the market file has \"USD\""},
        {" --from foreign --into market", "rates.csv", "", "foreign/currencies.csv: cannot be opened"},
    };
    const std::string now = folder.content("market") + folder.content("wallet");
    for (const auto& c : cases) {
        const std::string path = std::string("tables/") + c.table, whole = folder.content(path);
        folder.write(path, whole + c.row);
        const ToolRun run = import(c.arguments);
        folder.write(path, whole);
        EXPECT_EQ(run.status, 1) << c.message;
        EXPECT_THAT(run.err, HasSubstr(c.message));
    }
    folder.write("tables/accounts.csv",
                 "Account,Currency,Default Transfer,Cash,Value in Reference,Original\nSavings,USD,,,,\n");
    EXPECT_THAT(import(into).err, HasSubstr("accounts.csv, line 2: has the account \"Savings\" in \"USD\""));
    EXPECT_TRUE(folder.content("market") + folder.content("wallet") == now);
    EXPECT_THAT(ToolRun(PELORIN_EXPORT, sample + " --to foreign", folder).err, HasSubstr("was not made by an export"));
    EXPECT_EQ(folder.content("foreign/quotes.csv"), "Date,Ticker,Close\n");
    EXPECT_THAT(ToolRun(PELORIN_EXPORT, "data/Companies/Sample --to tables", folder).err,
                HasSubstr("tables/accounts.csv: is from before"));
    for (const std::string form : {"csv", "ledger"})
        EXPECT_THAT(ToolRun("ulimit", "-f 64; '" PELORIN_EXPORT "' " + sample + " --to full --as " + form, folder).err,
                    HasSubstr(": cannot be written: File too large"))
            << form;
    EXPECT_TRUE(std::filesystem::is_empty(folder / "full"));
}

namespace {

/// The last number in euros that a program writes about a journal; none where it fails or complains.
double lastEuros(const char* program, const std::string& arguments, const TemporaryFolder& folder)
{
    const ToolRun run(program, arguments, folder);
    const std::size_t end = run.out.find_last_of("0123456789");
    const std::size_t begin = run.out.find_last_not_of("-.0123456789", end);
    if (run.status != 0 || !run.err.empty() || end == run.out.npos) {
        ADD_FAILURE() << program << ' ' << arguments << ": " << run.err;
        return NAN;
    }
    return std::stod(run.out.substr(begin + 1));
}

/// Whether all programs that read journals come to `total` on that day, of which the folder has both kinds.
void expectPeersToFind(double total, const std::string& day, const TemporaryFolder& folder)
{
    constexpr double kCent = 0.0101;
    const std::string query = "SELECT SUM(CONVERT(POSITION, 'EUR', " + day + ")) WHERE account ~ '^Assets'";
    EXPECT_NEAR(lastEuros("ledger", "-f portfolio.ledger bal Assets -X EUR", folder), total, kCent) << day;
    EXPECT_NEAR(
        lastEuros("env", "LC_ALL=C.UTF-8 hledger -f portfolio.ledger bal Assets --value=" + day + ",EUR", folder),
        total, kCent)
        << day;
    EXPECT_NEAR(lastEuros("bean-query", "-f csv portfolio.beancount \"" + query + '"', folder), total, kCent) << day;
}

} // namespace

TEST(JournalTest, OtherProgramsValueTheSampleAsPelorinDoes)
{
    const TemporaryFolder folder("pelorin-journal-test");
    ASSERT_EQ(ToolRun(PELORIN_SAMPLE, "data --date 20/07/2025", folder).status, 0);
    const std::string files = "data/Companies/Sample data/PortoFolios/Sample --date ";
    // Within the sample, on a day when the sum of the total has lost two cents, and behind its end, where quotes are
    // estimated.
    const std::pair<const char*, const char*> days[] = {
        {"30/12/2022", "2022-12-30"}, {"19/06/2025", "2025-06-19"}, {"20/10/2025", "2025-10-20"}};
    for (const auto& [day, iso] : days) {
        const std::string json = ToolRun(PELORIN_VALUE, files + day + " --json", folder).out;
        for (const std::string form : {"ledger", "beancount"})
            EXPECT_EQ(ToolRun(PELORIN_EXPORT, files + day + " --to . --as " + form, folder).err, "");
        expectPeersToFind(std::stod(json.substr(json.find("totalValue\": ") + 13)), iso, folder);
    }
}

TEST(JournalTest, WhatReplayAndNamesHaveOfOddThingsComesOutTheSame)
{
    const TemporaryFolder folder("pelorin-journal-test");
    SmallPortfolio p;
    auto* odd = new Currency("Pound; of old", "\xC2\xA3", nullptr);
    p.catalogue.addCurrency(odd);
    p.catalogue.addCurrency(new Currency("Unused", "SEK", nullptr));
    new CurrencyQuote(p.catalogue.getCurrencies().back(), kStart, 0.125F);
    new CurrencyQuote(odd, daysAfterStart(3), 1.25F);
    new CurrencyQuote(p.dollar, daysAfterStart(9), 0.75F);
    Account* main = addAccount(p.wallet, "Main", p.euro);
    Account* second = addAccount(p.wallet, "Main", p.dollar);
    Account* savings = addAccount(p.wallet, "\xC3\x89pargne: a  (b);c\xC2\xA0\xC2\xA0z", p.euro);
    Account* old = addAccount(p.wallet, "", odd);
    deposit(main, 0, 100000.1F);
    deposit(main, 2, -0.333333F);
    transfer(main, second, 1, 5000.7F)->setFromCurrencyQuote(0.9F);
    transfer(main, savings, 1, 20)->setCost(30); // the sender pays 30
    transfer(main, old, 2, 100)->setRateCost(0.01F);
    // Income, a charge, and neither.
    for (const auto& [amount, rateCost, cost] : {std::tuple(0.0F, 0.0F, -12.3F), {4.56F, 1.0F, 0.0F}, {7, 0.5F, 1}})
        withTerms(transfer(savings, savings, 3, amount), rateCost, cost);
    // Tickers that are two companies', a currency's, none, too short, words and signs; with quotes up to the fifth day.
    int n = 0;
    for (const char* ticker : {"AC", "USD", "", "F", "s", "TRUE", "x \"y\";z", "BRK.B", "\xC3\xA9t\xC3\xA9", "AC\\"}) {
        auto* company = new Company(++n % 2 == 0 ? p.paris : p.york, "Name;  \"\\", ticker);
        new CompanyQuote(company, kStart, 10.1F * static_cast<float>(n));
        new CompanyQuote(company, daysAfterStart(5), n == 4 ? -3.0F : 7.7F);
        auto* share = new Share(&p.wallet, company);
        for (Account* account : {main, second}) // one of them in another currency
            trade(share, account, 4, 10 * n, 10, 29.95F);
        trade(share, main, 5, n == 3 ? -999 : -7, n == 5 ? -2.0F : 0.0F, 1);
        trade(share, main, 8, 1, 99, 1); // of the day itself, at what is not its quote
        trade(share, main, 9, 1, 10, 1); // after it
    }
    const Date day = daysAfterStart(8);
    const State* state = refreshStates(p.wallet, day, false, nullptr);
    for (const JournalForm* form : {&ledgerForm(), &beancountForm()}) {
        const Journal journal(p.catalogue, p.wallet, *state, *form);
        folder.write(form == &ledgerForm() ? "portfolio.ledger" : "portfolio.beancount",
                     written([&](FILE* file) { journal.write(file); }));
        EXPECT_THAT(journal.remarks(), testing::IsEmpty());
    }
    expectPeersToFind(Totals(*state, p.catalogue).totalValue, "1999-01-09", folder);
    EXPECT_EQ(beancountForm().symbol("A'B"), "A-B"); // queries have symbols between apostrophes
    // The last transaction is for roundings, and must not make up for a move that is wrong.
    const std::string text = folder.content("portfolio.ledger"), rounding = "Equity:Rounding  ";
    EXPECT_THAT(text, HasSubstr("\nP 1999-01-09 SEK 0.125 EUR\n"));
    for (std::size_t at = text.find(rounding); at != text.npos; at = text.find(rounding, at + 1))
        EXPECT_LT(std::abs(std::stod(text.substr(at + rounding.size()))), 0.1);
    EXPECT_EQ(ToolRun("env", "LC_ALL=C.UTF-8 hledger -f portfolio.ledger check --strict", folder).err, "");
    EXPECT_EQ(ToolRun("ledger", "-f portfolio.ledger --pedantic bal", folder).err, "");
    EXPECT_EQ(ToolRun("bean-check", "portfolio.beancount", folder).err, "");

    deposit(main, -2, 5e20F);
    EXPECT_THROW(Journal(p.catalogue, p.wallet, *refreshStates(p.wallet, day, false, nullptr), ledgerForm()),
                 std::runtime_error);
}
