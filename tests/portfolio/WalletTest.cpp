#include "portfolio/Wallet.h"
#include "tests/support/Links.h"

TEST(WalletTest, ProfitsGoToTheFirstFlaggedAccountOfTheCurrencyOtherwiseToItsFirst)
{
    const struct {
        const char* accounts; // a letter for the currency of each, E, D or - for none; in capitals when it is flagged
        int expected;
        const char* why;
    } cases[] = {{"", -1, "no account at all"},
                 {"dD-", -1, "none in the currency"},
                 {"dee", 1, "none flagged: the first"},
                 {"eE", 1, "the flagged one, though later"},
                 {"eEE", 1, "the first of two flagged ones"},
                 {"De-", 1, "a flag in another currency does not count"}};
    for (const auto& c : cases) {
        SmallPortfolio p;
        for (const char letter : std::string(c.accounts)) {
            Currency* currency = letter == '-' ? nullptr : std::tolower(letter) == 'e' ? p.euro : p.dollar;
            addAccount(p.wallet, "A", currency)->setDefaultTransferAccount(std::isupper(letter) != 0);
        }
        const Account* expected = c.expected >= 0 ? p.wallet.getAccount(static_cast<unsigned>(c.expected)) : nullptr;
        EXPECT_EQ(p.wallet.findDefaultTransferAccount("EUR"), expected) << c.why;
        EXPECT_EQ(p.wallet.findDefaultTransferAccount(String()), nullptr) << "no account without a currency is meant";
    }
}

TEST(WalletTest, LookUpsNeedEveryNameAndGiveTheFirstMatch)
{
    SmallPortfolio p;
    auto* twin = new Market("York"); // lists what the first market of its name does not
    twin->setCurrency(p.dollar);
    auto* gamma = new Company(twin, "Gamma", "GA");
    new Company(twin, "Twin of Beta", "AC");
    p.wallet.setCatalogue(p.catalogue);
    auto* share = new Share(&p.wallet, p.beta);
    new Share(&p.wallet, p.beta);
    const Account* account = addAccount(p.wallet, "A", p.euro);
    addAccount(p.wallet, "A", p.dollar);

    const struct {
        const char *market, *ticker;
        Company* company;
        Share* holding;
    } cases[] = {{"Paris", "AC", p.alpha, nullptr}, {"York", "AC", p.beta, share},
                 {"York", "GA", gamma, nullptr},    {"york", "AC", nullptr, nullptr},
                 {"York", "Ac", nullptr, nullptr},  {"Paris", "GA", nullptr, nullptr}};
    for (const auto& c : cases) {
        Company* company;
        Share* holding;
        EXPECT_EQ(p.wallet.getCompany(c.market, c.ticker, &company), c.company != nullptr ? 0 : -1);
        EXPECT_EQ(company, c.company) << c.market << ' ' << c.ticker;
        EXPECT_EQ(p.wallet.getShare(c.market, c.ticker, &holding), c.holding != nullptr ? 0 : -1);
        EXPECT_EQ(holding, c.holding) << c.market << ' ' << c.ticker;
    }
    EXPECT_EQ(p.wallet.getAccountByName("A"), account);
    EXPECT_EQ(p.wallet.getAccountByName("a"), nullptr);
}

TEST(WalletTest, TheRateCostOfATradeIsThePresentOne)
{
    SmallPortfolio p;
    auto* share = new Share(&p.wallet, p.alpha);
    const ShareOperation* bought = trade(share, nullptr, 0, 1, 10);
    EXPECT_EQ(bought->getOperationRateCost(), 0.0017F);
    p.wallet.setSellRateCost(0.25F);
    EXPECT_EQ(trade(share, nullptr, 0, -1, 10)->getOperationRateCost(), 0.25F);
    share->setWallet(nullptr);
    EXPECT_EQ(bought->getOperationRateCost(), 0);
    EXPECT_EQ(ShareOperation().getOperationRateCost(), 0);
}

TEST(WalletTest, ACompanysHoldingsGoFromTheFrontAndLeaveTheOthersInOneOrder)
{
    SmallPortfolio p;
    auto* gamma = new Company(p.york, "Gamma", "GA");
    for (Company* company : {p.alpha, p.alpha, p.beta, gamma})
        new Share(&p.wallet, company);
    const std::vector<Share*> former = all(p.wallet, &Wallet::getAllShares);
    delete p.alpha;
    EXPECT_EQ(all(p.wallet, &Wallet::getAllShares), (std::vector{former[3], former[2]}));
}

TEST(WalletTest, RemovingAutomaticOperationsSkipsNoNeighbour)
{
    for (const char* pattern : {"aaaa", "amaam", "maama"}) {
        SmallPortfolio p;
        Account* from = addAccount(p.wallet, "from", p.euro);
        Account* to = addAccount(p.wallet, "to", p.euro);
        auto* share = new Share(&p.wallet, p.alpha);
        std::vector<Operation*> sent;
        std::vector<ShareOperation*> sold, manual;
        for (int day = 0; pattern[day] != '\0'; ++day) {
            const bool isAutomatic = pattern[day] == 'a';
            auto* transferred = transfer(from, to, day, 1, isAutomatic);
            sold.push_back(new ShareOperation(daysAfterStart(day), share, false, 1, 1, isAutomatic, 0));
            if (!isAutomatic) {
                sent.push_back(transferred);
                manual.push_back(sold.back());
            }
        }
        p.wallet.removeAutomaticOperations();
        EXPECT_EQ(all(*from, &Account::getAllOperations), sent) << pattern;
        EXPECT_EQ(to->getNbrTransferOperations(), sent.size()) << pattern;
        EXPECT_EQ(all(*share, &Share::getAllShareOperations), sold) << "sales stay in: " << pattern;
        share->removeAutomaticShareOperations();
        EXPECT_EQ(all(*share, &Share::getAllShareOperations), manual) << pattern;
    }
}

namespace {

/// Makes, moves and destroys objects of several wallets and currencies at random.
class Shuffle {
public:
    explicit Shuffle(unsigned seed) : random_(seed) {}
    ~Shuffle()
    {
        while (!currencies_.empty())
            destroyOne(currencies_);
        while (!wallets_.empty())
            destroyOne(wallets_);
    }
    Shuffle(const Shuffle&) = delete;
    Shuffle& operator=(const Shuffle&) = delete;

    Links links() const { return {currencies_, wallets_}; }

    void step()
    {
        const Links now = links();
        // Each of these has an owner, so that there is one of everything when there is one of them.
        if (now.companies.empty() || now.transfers.empty() || now.trades.empty() || now.states.empty())
            return makeOneOfEach();
        Wallet* wallet = pick(now.wallets);
        Account* account = pick(now.accounts);
        Share* share = pick(now.shares);
        Operation* operation = pick(now.operations);
        const int day = below(4);
        const std::function<void()> actions[] = {
            [&] { new Share(wallet, pick(now.companies)); },
            [&] { addAccount(*wallet, "A", pick(now.currencies)); },
            [&] { deposit(account, day, 1, day == 0); },
            [&] { transfer(account, pick(now.accounts), day, 1, day == 0); },
            [&] { trade(share, day == 0 ? nullptr : account, day, below(3) - 1, 1); },
            [&] { new State(wallet, daysAfterStart(day), true); },
            [&] { account->setWallet(wallet); },
            [&] { share->setWallet(wallet); },
            [&] { account->setCurrency(pick(now.currencies)); },
            [&] { operation->setAccount(account); },
            [&] { operation->setDate(daysAfterStart(day)); },
            [&] { pick(now.transfers)->setRecepientAccount(account); },
            [&] { pick(now.trades)->setShare(share); },
            [&] { delete account; },
            [&] { delete share; },
            [&] { delete operation; },
            [&] { delete pick(now.states); },
            [&] { wallet->removeAllStates(); },
            [&] { delete pick(now.companies); },
            [&] { delete (day == 0 ? pick(now.markets) : nullptr); },
            [&] { day == 0 ? destroyOne(currencies_) : void(); },
            [&] { day == 0 ? destroyOne(wallets_) : void(); },
        };
        constexpr std::size_t kMaking = 6;
        actions[below(below(2) == 0 ? kMaking : std::size(actions))]();
    }

private:
    int below(std::size_t n) { return static_cast<int>(::below(random_, n)); }

    template <class T>
    T* pick(const std::vector<T*>& objects)
    {
        return objects[::below(random_, objects.size())];
    }

    template <class T>
    void destroyOne(std::vector<T*>& objects)
    {
        const auto place = objects.begin() + below(objects.size());
        delete *place;
        objects.erase(place);
    }

    void makeOneOfEach()
    {
        wallets_.push_back(new Wallet);
        currencies_.push_back(new Currency("Euro", "EUR", nullptr));
        auto* market = new Market("Paris");
        market->setCurrency(currencies_.back());
        Account* account = addAccount(*wallets_.back(), "A", currencies_.back());
        transfer(account, account, 1, 1);
        trade(new Share(wallets_.back(), new Company(market, "Alpha", "AC")), account, 1, 1, 1);
        new State(wallets_.back(), kStart, false);
    }

    std::mt19937 random_;
    std::vector<Currency*> currencies_;
    std::vector<Wallet*> wallets_;
};

} // namespace

TEST(WalletTest, BothEndsOfEveryLinkAgreeWhateverIsDestroyed)
{
    for (unsigned seed = 1; seed <= 20 && !HasFailure(); ++seed) {
        Shuffle shuffle(seed);
        for (int i = 0; i < 250 && !HasFailure(); ++i) {
            SCOPED_TRACE("seed " + std::to_string(seed) + ", step " + std::to_string(i));
            shuffle.step();
            shuffle.links().expectConsistent();
        }
    }
}
