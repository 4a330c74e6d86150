// Commands in any order: whatever a person does, both ends of every link agree, the lists show what there is, and what
// is saved comes back the same.

#include "market/Company.h"
#include "market/CompanyEvent.h"
#include "market/Currency.h"
#include "market/Market.h"
#include "platform/DialogAnswers.h"
#include "platform/ListItem.h"
#include "platform/ListView.h"
#include "platform/Menu.h"
#include "platform/MenuField.h"
#include "platform/MenuItem.h"
#include "platform/TextControl.h"
#include "platform/qt/WindowWidget.h"
#include "tests/gui/WindowFixture.h"
#include "tests/support/Bytes.h"
#include "tests/support/Links.h"
#include "valuation/Evolution.h"
#include "valuation/Totals.h"
#include "views/DateText.h"
#include "views/OperationView.h"

#include <QAbstractItemView>
#include <QTest>

#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <random>

namespace {

const Date kDay(21, 11, 2024);

class RandomCommandsTest : public WindowTest, public testing::WithParamInterface<unsigned> {
protected:
    RandomCommandsTest() : random_(GetParam())
    {
        DialogAnswers::current().alert = [this](const char*, const char*) { return static_cast<int32>(under(4) > 0); };
    }
    ~RandomCommandsTest() override
    {
        settle(); // what waits may ask
        DialogAnswers::current().alert = nullptr;
    }

    /// One thing that a person may do.
    struct Action {
        const char* name;
        std::size_t weight; // how likely it is
        void (RandomCommandsTest::*run)();
    };
    static const std::vector<Action> kActions;
    static constexpr std::pair<const char*, const char*> kLists[] = {
        {"CompanyView", "lstMarkets"},       {"CompanyView", "lstCompanies"},    {"CompanyView", "lstQuotes"},
        {"CompanyView", "lstCompanyEvents"}, {"CurrencyView", "lstCurrencies"},  {"CurrencyView", "lstMarkets"},
        {"CurrencyView", "lstQuotes"},       {"OperationView", "lstOperations"}, {"WalletView", "lstAccounts"}};

    const Action& anyAction()
    {
        std::vector<const Action*> drawn;
        for (const Action& action : kActions)
            drawn.insert(drawn.end(), action.weight, &action);
        return *drawn[under(drawn.size())];
    }
    unsigned under(std::size_t n) { return below(random_, n); }
    BListView& listOf(const char* page, const char* name)
    {
        return dynamic_cast<BListView&>(*window().FindView(page)->FindView(name));
    }
    void put(const char* page, const char* field, const std::string& text)
    {
        dynamic_cast<BTextControl&>(*window().FindView(page)->FindView(field)).SetText(text.c_str());
    }
    void send(std::initializer_list<uint32> codes) { window().PostMessage(codes.begin()[under(codes.size())]); }

    /// Half of the runs give a name only once: a portfolio file then means what it was written from.
    std::string name()
    {
        static const char* const kNames[] = {"", " ", "Paris", "NYSE", "\u00C9nergie", "a longer name, with blanks"};
        const std::string name = kNames[under(std::size(kNames))];
        return areNamesUnique_ ? name + std::to_string(nextName_++) : name;
    }
    /// Most of them are no other currency's: a file finds its reference again by the symbol.
    std::string symbol() { return under(8) == 0 && !areNamesUnique_ ? "" : "C" + std::to_string(nextSymbol_++); }
    std::string knownSymbol()
    {
        const auto& currencies = window().catalogue().getCurrencies();
        if (currencies.empty())
            return "none";
        return std::string(currencies[under(currencies.size())]->getRepresentation().bytes());
    }
    std::string day() { return under(10) == 0 ? "31/2/2024" : dateOf(Date(1, 1, 2024), under(60)); }
    /// A day that no quote has: of two quotes of a day a file would keep one.
    std::string freshDay() { return dateOf(Date(1, 1, 1950), nextDay_++); }
    static std::string dateOf(Date start, unsigned days) { return start.moveBy(days).toString().getCharacterArray(); }
    /// With no rate of 0, which as the reference would leave nothing to compare, where values are compared.
    std::string number()
    {
        if (areNamesUnique_)
            return std::to_string((under(4000) + 1) / 100.0);
        return under(10) == 0 ? "no number" : std::to_string(under(4000) / 100.0);
    }

    /// Changes what is selected in a list.
    void pick(const char* page, const char* name)
    {
        BListView& rows = listOf(page, name);
        if (rows.CountItems() == 0 || under(12) == 0) {
            static_cast<QAbstractItemView*>(rows.widget())->clearSelection();
            return;
        }
        const auto first = static_cast<int32>(under(static_cast<std::size_t>(rows.CountItems())));
        const auto most = static_cast<std::size_t>(rows.CountItems() - first);
        const auto last = first + static_cast<int32>(under(3) == 0 ? under(most) : 0);
        rows.Select(first, last, under(4) == 0);
    }

    void pickSomething()
    {
        const auto& [page, list] = kLists[under(std::size(kLists))];
        pick(page, list);
    }
    /// Another page, and what is done there by keys and pointer and changes nothing.
    void lookAround()
    {
        QWidget& desktop = window().widget();
        QTest::keyClick(&desktop, static_cast<Qt::Key>(Qt::Key_1 + under(5)), Qt::AltModifier);
        settle();
        for (auto* list : desktop.findChildren<QAbstractItemView*>()) {
            if (!list->isVisible())
                continue;
            QTest::keyClick(list, static_cast<Qt::Key>(Qt::Key_A + under(26)));
            QTest::keyClick(list, Qt::Key_C, Qt::ControlModifier);
        }
        for (const char* name : {"grvQuotes", "grvEvolution"}) {
            for (auto* chart : desktop.findChildren<QWidget*>(name))
                QTest::mouseMove(chart, {static_cast<int>(under(700)), static_cast<int>(under(200))});
        }
        auto* date = desktop.findChild<QWidget*>("WalletView")->findChild<QWidget*>("txtDate");
        for (const Qt::Key key : {Qt::Key_PageUp, Qt::Key_Up, Qt::Key_Down, Qt::Key_PageDown})
            QTest::keyClick(date, key);
        put("WalletView", "txtDate", "21/11/2024"); // an empty field has begun today, and now is a month back
        send({'WTDa'});
    }
    void addCurrency()
    {
        settle(); // what waits would change the fields, or take them twice
        put("CurrencyView", "txtCurrencyName", name());
        put("CurrencyView", "txtCurrencyRepresentation", symbol());
        send({'RBAd', 'RBAd', 'RBUp'});
        settle();
    }
    void changeReference()
    {
        settle();
        const int32 row = listOf("CurrencyView", "lstCurrencies").CurrentSelection();
        const auto& currencies = window().catalogue().getCurrencies();
        // Rates by one that has none are infinite from then on.
        if (row >= 0 && areNamesUnique_ && currencies[static_cast<std::size_t>(row)]->getNbrQuotes() == 0)
            return;
        send({'RBSr'});
    }
    void addMarket()
    {
        put("CompanyView", "txtMarketName", name());
        put("CompanyView", "txtMarketCurrencyRepresentation", knownSymbol());
        send({'CBAm', 'CBAm', 'CBUm'});
    }
    void addCompany()
    {
        put("CompanyView", "txtAbbreviation", name());
        put("CompanyView", "txtName", name());
        send({'CBAc'});
    }
    /// Selects a row where none is, so that the next command finds something to work on.
    void ensureSelection(const char* page, const char* name)
    {
        settle();
        if (listOf(page, name).CountSelected() == 0)
            pick(page, name);
        settle();
    }
    void changeQuotes()
    {
        const bool isCompany = under(3) > 0;
        const char* page = isCompany ? "CompanyView" : "CurrencyView";
        ensureSelection(page, isCompany ? "lstCompanies" : "lstCurrencies");
        const uint32 add = isCompany ? 'CBAq' : 'RBAq', update = isCompany ? 'CBUq' : 'RBUq';
        for (unsigned n = 1 + under(5); n > 0; --n) {
            const bool isUpdate = under(4) == 0;
            put(page, "txtQuoteDate", isUpdate ? freshDay() : day());
            put(page, "txtQuoteValue", number());
            send({isUpdate ? update : add});
            settle();
        }
    }
    void removeOrSplitQuotes()
    {
        put("CompanyView", "txtSplitRangeNum", number());
        put("CompanyView", "txtSplitRangeDenum", number());
        send({'CBSq', 'CBRq', 'RBRq', 'CCWs'});
    }
    void changeEvent()
    {
        ensureSelection("CompanyView", "lstCompanies");
        put("CompanyView", "txtCompanyEventDate", day());
        put("CompanyView", "txtCompanyEventTitle", name());
        put("CompanyView", "txtEventSplitRangeNum", number());
        send({'CMSp', 'CMNo'});
        send({'CBEa', 'CBEa', 'CBEu', 'CBEr'});
    }
    void changeAccount()
    {
        settle();
        const std::vector<Account*> accounts = all(wallet(), &Wallet::getAllAccounts);
        const auto stranded =
            std::ranges::find_if(accounts, [](auto* account) { return account->getCurrencyName().isUndefined(); });
        const bool isMended = stranded != accounts.end(); // its currency was removed; no file can be written
        if (isMended) {
            listOf("WalletView", "lstAccounts").Select(static_cast<int32>(stranded - accounts.begin()));
            settle();
        }
        put("WalletView", "txtAccountName", name());
        put("WalletView", "txtAccountCurrency", knownSymbol());
        send({isMended ? static_cast<uint32>('WBUa') : 'WBAa', 'WBAa', 'WBUa'});
    }
    std::string accountName()
    {
        const std::vector<Account*> accounts = all(wallet(), &Wallet::getAllAccounts);
        return accounts.empty() ? "" : std::string(accounts[under(accounts.size())]->getName().bytes());
    }
    float amount() { return static_cast<float>(under(4000) + 1) / 4; }
    void changeOperation()
    {
        settle();
        static const char* const kTypes[] = {"DEPOSIT", "TRANSFER", "BUY", "SELL"};
        auto& page = dynamic_cast<OperationView&>(*window().FindView("OperationView"));
        page.SetType(kTypes[under(std::size(kTypes))]);
        page.setDate(readDate(day()));
        page.setAutomatic(under(8) == 0);
        page.setBaseAccount(accountName().c_str());
        page.setTransferAccount(accountName().c_str());
        page.setAmount(amount());
        page.setTransferCost(amount());
        page.setTransferFromQuote(amount());
        page.setTransferToQuote(amount());
        page.setQuantity(static_cast<int>(under(20)));
        page.setQuote(amount());
        chooseCompany(page);
        send({'OBAd', 'OBAd', 'OBAd', 'OBUp', 'OBRe'});
    }
    /// One that the chosen account can pay for, where there is one.
    void chooseCompany(OperationView& page)
    {
        const Account* account = wallet().getAccountByName(page.getBaseAccount());
        for (const Market* market : window().catalogue().getMarkets()) {
            const std::vector<Company*> companies = all(*market, &Market::getAllCompanies);
            if (companies.empty() || account == nullptr ||
                market->getCurrencyRepresentation() != account->getCurrencyRepresentation())
                continue;
            page.setMarketName(market->getName());
            page.setCompanyAbbreviation(companies[under(companies.size())]->getAbbreviation());
        }
    }
    /// Also for no day at all, when nothing is valued.
    void revalue()
    {
        put("WalletView", "txtDate", under(3) == 0 ? "" : "21/11/2024");
        send({'WTDa', 'WTDa', 'WCCe', 'OCPr'});
    }

    /// Everything that the lists of the two pages show, and that it is what the selection is about.
    void expectListsShowTheModel()
    {
        for (const auto& [page, name] : kLists) {
            const BListView& rows = listOf(page, name);
            for (int32 i = 0; i < rows.CountItems(); ++i)
                EXPECT_NE(rows.ItemAt(i)->Text(), "\n"); // reads the object of the row
        }
        const auto& currencies = window().catalogue().getCurrencies();
        const auto markets = window().catalogue().getMarkets();
        ASSERT_EQ(count("CompanyView", "lstMarkets"), markets.size());
        ASSERT_EQ(count("CurrencyView", "lstCurrencies"), currencies.size());
        for (std::size_t i = 0; i < currencies.size(); ++i) {
            const BListItem* row = listOf("CurrencyView", "lstCurrencies").ItemAt(static_cast<int32>(i));
            EXPECT_TRUE(row->Text().starts_with(currencies[i]->getName().bytes()));
        }
        const int32 currency = listOf("CurrencyView", "lstCurrencies").CurrentSelection();
        const Currency* shown = currency < 0 ? nullptr : currencies[static_cast<std::size_t>(currency)];
        EXPECT_EQ(count("CurrencyView", "lstMarkets"), shown != nullptr ? shown->getNbrMarkets() : 0);
        EXPECT_EQ(count("CurrencyView", "lstQuotes"), shown != nullptr ? shown->getNbrQuotes() : 0);
        expectDates("CurrencyView");
        expectDates("CompanyView");
        if (window().getCompanyListView()->CountSelected() == 0) {
            EXPECT_EQ(count("CompanyView", "lstQuotes") + count("CompanyView", "lstCompanyEvents"), 0U);
        }
    }
    std::size_t count(const char* page, const char* name)
    {
        return static_cast<std::size_t>(listOf(page, name).CountItems());
    }
    /// The rows of quotes go by date, as the series do.
    void expectDates(const char* page)
    {
        const BListView& rows = listOf(page, "lstQuotes");
        std::vector<std::string> days;
        for (int32 i = 0; i < rows.CountItems(); ++i) {
            const std::string day = rows.ItemAt(i)->Text();
            days.push_back(day.substr(6, 4) + day.substr(3, 2) + day.substr(0, 2));
        }
        EXPECT_TRUE(std::ranges::is_sorted(days));
    }

    void expectLinks()
    {
        const Links links(window().catalogue().getCurrencies(), {&wallet()});
        links.expectConsistent();
        for (const Company* company : links.companies) {
            for (unsigned i = 0; i < company->getNbrQuotes(); ++i)
                expectOwner(company, company->getQuote(i));
            for (CompanyEvent* event : all(*company, &Company::getAllEvents))
                expectOwner(company, event);
        }
        const auto& currencies = window().catalogue().getCurrencies();
        for (Currency* currency : currencies) {
            Currency* reference;
            currency->getReferenceCurrency(&reference);
            EXPECT_NE(std::ranges::find(currencies, reference), currencies.end()) << "it stores one that is gone";
        }
    }
    template <class Element>
    static void expectOwner(const Company* company, Element* element)
    {
        Company* owner;
        EXPECT_EQ(element->getCompany(&owner), 0);
        EXPECT_EQ(owner, company);
    }

    void expectTheSameAfterSaveAndLoad()
    {
        const auto write = [](const Catalogue& catalogue) {
            return written([&](FILE* file) { EXPECT_EQ(catalogue.wrt(file, kDay), 0); });
        };
        const std::string saved = write(window().catalogue());
        Catalogue loaded;
        EXPECT_EQ(loaded.rd(BytesFile(saved)), 0);
        EXPECT_EQ(write(loaded) == saved, true);
        expectTheSameValue(loaded);
    }
    /// The portfolio, too, when it comes back from its file to the loaded `catalogue`.
    void expectTheSameValue(const Catalogue& catalogue)
    {
        window().UpdateState(); // a new reference currency does not value anew by itself
        if (window().getState() == nullptr)
            return;
        const std::vector<Account*> accounts = all(wallet(), &Wallet::getAllAccounts);
        const bool canBeSaved =
            std::ranges::none_of(accounts, [](auto* account) { return account->getCurrencyName().isUndefined(); });
        const std::string saved =
            written([&](FILE* file) { EXPECT_EQ(wallet().wrt(file, kDay), canBeSaved ? 0 : -1); });
        const Currency* reference = window().getReferenceCurrency();
        if (!canBeSaved || !areNamesUnique_ || reference == nullptr || reference->getRepresentation().isUndefined())
            return; // it does not come back, or as something else
        Wallet loaded;
        loaded.setCatalogue(catalogue);
        EXPECT_EQ(loaded.rd(BytesFile(saved), nullptr), 0);
        const Totals expected(*refreshStates(loaded, kDay, false, nullptr), catalogue);
        const Totals shown(*window().getState(), window().catalogue());
        EXPECT_EQ(shown.isKnown, expected.isKnown);
        // Transfers of a day and of several senders change places in a file, and then round in another order.
        for (const auto& [a, b] :
             {std::pair(shown.totalDeposit, expected.totalDeposit), std::pair(shown.totalValue, expected.totalValue)}) {
            EXPECT_EQ(std::isfinite(a), std::isfinite(b)); // a rate of 0 may have become the reference
            if (std::isfinite(a) && std::isfinite(b)) {
                EXPECT_NEAR(a, b, 1e-5 * (1 + std::abs(b)));
                valuesCompared_ += a != 0;
            }
        }
    }
    /// The list has every operation, and the menus every account.
    void expectOperationsShow()
    {
        if (window().getState() == nullptr)
            return;
        std::size_t operations = 0;
        const std::vector<Account*> accounts = all(wallet(), &Wallet::getAllAccounts);
        for (const Account* account : accounts)
            operations += account->getNbrOperations();
        EXPECT_EQ(count("OperationView", "lstOperations"), operations);
        EXPECT_EQ(count("WalletView", "lstAccounts"), accounts.size());
        for (const char* name : {"baseAccount", "transferAccount"}) {
            const auto& menu = dynamic_cast<BMenuField&>(*window().FindView(name));
            ASSERT_EQ(menu.Menu()->CountItems(), static_cast<int32>(accounts.size()));
            for (int32 i = 0; i < menu.Menu()->CountItems(); ++i)
                EXPECT_EQ(menu.Menu()->ItemAt(i)->Label(), accounts[static_cast<std::size_t>(i)]->getName().bytes());
        }
    }
    int valuesCompared() const { return valuesCompared_; }
    bool areNamesUnique() const { return areNamesUnique_; }

private:
    std::mt19937 random_;
    unsigned nextSymbol_ = 0;
    unsigned nextDay_ = 0;
    unsigned nextName_ = 0;
    bool areNamesUnique_ = GetParam() % 2 == 0;
    int valuesCompared_ = 0;
};

const std::vector<RandomCommandsTest::Action> RandomCommandsTest::kActions = {
    {"select", 4, &RandomCommandsTest::pickSomething},
    {"currency", 1, &RandomCommandsTest::addCurrency},
    {"reference", 1, &RandomCommandsTest::changeReference},
    {"market", 2, &RandomCommandsTest::addMarket},
    {"company", 3, &RandomCommandsTest::addCompany},
    {"quote", 4, &RandomCommandsTest::changeQuotes},
    {"quotes", 1, &RandomCommandsTest::removeOrSplitQuotes},
    {"event", 2, &RandomCommandsTest::changeEvent},
    {"account", 2, &RandomCommandsTest::changeAccount},
    {"operation", 6, &RandomCommandsTest::changeOperation},
    {"look", 1, &RandomCommandsTest::lookAround},
    {"revalue", 1, &RandomCommandsTest::revalue},
};

TEST_P(RandomCommandsTest, LinksListsAndFileAgreeAfterEachCommand)
{
    constexpr int kSteps = 1200;
    constexpr unsigned kRarely = 40; // steps between the removals of much
    std::size_t mostMarkets = 0;
    for (int step = 0; step < kSteps && !HasFailure(); ++step) {
        const Action& action = anyAction();
        SCOPED_TRACE("step " + std::to_string(step) + ": " + action.name);
        (this->*action.run)();
        for (const uint32 removal : {'CBRm', 'CBRc', 'RBRe', 'WBRa'}) // of a market, a company, a currency, an account
            if (under(kRarely) == 0)
                send({removal});
        if (under(3) == 0)
            continue; // the next command comes before this one has been handled
        settle();
        mostMarkets = std::max(mostMarkets, window().catalogue().getMarkets().size());
        expectLinks();
        expectListsShowTheModel();
        expectOperationsShow();
        expectTheSameAfterSaveAndLoad();
    }
    EXPECT_GT(mostMarkets, 4U) << "else there was little to go wrong";
    if (areNamesUnique()) {
        EXPECT_GT(valuesCompared(), 4);
    }
}

/// For longer runs, which take other seeds each time: see CONTRIBUTING.md.
unsigned firstSeed()
{
    const char* text = std::getenv("PELORIN_FIRST_SEED");
    return text != nullptr ? static_cast<unsigned>(std::strtoul(text, nullptr, 10)) : 1;
}

INSTANTIATE_TEST_SUITE_P(Seeds, RandomCommandsTest, testing::Range(firstSeed(), firstSeed() + 4));

} // namespace
