// Commands in any order: whatever a person does, both ends of every link agree, the lists show what there is, and what
// is saved comes back the same.

#include "market/Company.h"
#include "market/CompanyEvent.h"
#include "market/Currency.h"
#include "market/Market.h"
#include "platform/DialogAnswers.h"
#include "platform/ListItem.h"
#include "platform/ListView.h"
#include "platform/TextControl.h"
#include "tests/gui/WindowFixture.h"
#include "tests/support/Bytes.h"
#include "tests/support/Links.h"

#include <algorithm>
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
        void (RandomCommandsTest::*run)();
    };
    static const std::vector<Action> kActions;

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

    std::string name()
    {
        static const char* const kNames[] = {"", " ", "Paris", "NYSE", "\u00C9nergie", "a longer name, with blanks"};
        return kNames[under(std::size(kNames))];
    }
    /// Most of them are no other currency's: a file finds its reference again by the symbol.
    std::string symbol() { return under(8) == 0 ? "" : "C" + std::to_string(nextSymbol_++); }
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
    std::string number() { return under(10) == 0 ? "no number" : std::to_string(under(4000) / 100.0); }

    /// Changes what is selected in a list.
    void pick(const char* page, const char* name)
    {
        BListView& rows = listOf(page, name);
        if (rows.CountItems() == 0 || under(12) == 0) {
            rows.DeselectAll();
            return;
        }
        const auto first = static_cast<int32>(under(static_cast<std::size_t>(rows.CountItems())));
        const auto most = static_cast<std::size_t>(rows.CountItems() - first);
        const auto last = first + static_cast<int32>(under(3) == 0 ? under(most) : 0);
        rows.Select(first, last, under(4) == 0);
    }

    void pickSomething()
    {
        static const std::pair<const char*, const char*> kLists[] = {
            {"CompanyView", "lstMarkets"},  {"CompanyView", "lstCompanies"},     {"CompanyView", "lstCompanies"},
            {"CompanyView", "lstQuotes"},   {"CompanyView", "lstCompanyEvents"}, {"CurrencyView", "lstCurrencies"},
            {"CurrencyView", "lstMarkets"}, {"CurrencyView", "lstQuotes"},       {"OperationView", "lstOperations"},
        };
        const auto& [page, list] = kLists[under(std::size(kLists))];
        pick(page, list);
    }
    void addCurrency()
    {
        settle(); // what waits would change the fields, or take them twice
        put("CurrencyView", "txtCurrencyName", name());
        put("CurrencyView", "txtCurrencyRepresentation", symbol());
        send({'RBAd', 'RBAd', 'RBUp'});
        settle();
    }
    void changeReference() { send({'RBSr'}); }
    void removeCurrency() { send({'RBRe'}); }
    void addMarket()
    {
        put("CompanyView", "txtMarketName", name());
        put("CompanyView", "txtMarketCurrencyRepresentation", knownSymbol());
        send({'CBAm', 'CBAm', 'CBUm'});
    }
    void removeMarket() { send({'CBRm'}); }
    void addCompany()
    {
        put("CompanyView", "txtAbbreviation", name());
        put("CompanyView", "txtName", name());
        send({'CBAc'});
    }
    void removeCompany() { send({'CBRc'}); }
    void changeQuote()
    {
        const bool isCompany = under(2) == 0;
        const char* page = isCompany ? "CompanyView" : "CurrencyView";
        settle();
        const bool isUpdate = under(4) == 0;
        put(page, "txtQuoteDate", isUpdate ? freshDay() : day());
        put(page, "txtQuoteValue", number());
        if (isUpdate)
            send({isCompany ? static_cast<uint32>('CBUq') : 'RBUq'});
        else
            send({isCompany ? static_cast<uint32>('CBAq') : 'RBAq'});
        settle();
    }
    void removeOrSplitQuotes()
    {
        put("CompanyView", "txtSplitRangeNum", number());
        put("CompanyView", "txtSplitRangeDenum", number());
        send({'CBSq', 'CBRq', 'RBRq', 'CCWs'});
    }
    void changeEvent()
    {
        put("CompanyView", "txtCompanyEventDate", day());
        put("CompanyView", "txtCompanyEventTitle", name());
        put("CompanyView", "txtEventSplitRangeNum", number());
        send({'CMSp', 'CMNo'});
        send({'CBEa', 'CBEa', 'CBEu', 'CBEr'});
    }
    /// A purchase of what is selected, from an account in any currency.
    void buy()
    {
        settle();
        auto* rows = window().getCompanyListView();
        const auto& currencies = window().catalogue().getCurrencies();
        if (rows->CountSelected() == 0 || currencies.empty())
            return;
        const auto markets = window().catalogue().getMarkets();
        const std::vector<Company*> companies = all(*markets[under(markets.size())], &Market::getAllCompanies);
        if (companies.empty())
            return;
        Account* account = addAccount(wallet(), "Cash", currencies[under(currencies.size())]);
        trade(new Share(&wallet(), companies[under(companies.size())]), account, 10, 5, 2);
        window().UpdateState();
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
        for (const char* page : {"CompanyView", "CurrencyView", "OperationView"}) {
            for (const char* name :
                 {"lstMarkets", "lstCompanies", "lstQuotes", "lstCompanyEvents", "lstCurrencies", "lstOperations"}) {
                auto* rows = dynamic_cast<BListView*>(window().FindView(page)->FindView(name));
                for (int32 i = 0; rows != nullptr && i < rows->CountItems(); ++i)
                    EXPECT_NE(rows->ItemAt(i)->Text(), "\n"); // reads the object of the row
            }
        }
        const auto& currencies = window().catalogue().getCurrencies();
        const auto markets = window().catalogue().getMarkets();
        ASSERT_EQ(count("CompanyView", "lstMarkets"), markets.size());
        ASSERT_EQ(count("CurrencyView", "lstCurrencies"), currencies.size());
        for (std::size_t i = 0; i < currencies.size(); ++i) {
            EXPECT_TRUE(listOf("CurrencyView", "lstCurrencies")
                            .ItemAt(static_cast<int32>(i))
                            ->Text()
                            .starts_with(currencies[i]->getName().bytes()));
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
    }

private:
    std::mt19937 random_;
    unsigned nextSymbol_ = 0;
    unsigned nextDay_ = 0;
};

// An action stands here as often as it is to be likely.
const std::vector<RandomCommandsTest::Action> RandomCommandsTest::kActions = {
    {"select", &RandomCommandsTest::pickSomething},
    {"select", &RandomCommandsTest::pickSomething},
    {"select", &RandomCommandsTest::pickSomething},
    {"select", &RandomCommandsTest::pickSomething},
    {"currency", &RandomCommandsTest::addCurrency},
    {"reference", &RandomCommandsTest::changeReference},
    {"market", &RandomCommandsTest::addMarket},
    {"market", &RandomCommandsTest::addMarket},
    {"company", &RandomCommandsTest::addCompany},
    {"company", &RandomCommandsTest::addCompany},
    {"company", &RandomCommandsTest::addCompany},
    {"quote", &RandomCommandsTest::changeQuote},
    {"quote", &RandomCommandsTest::changeQuote},
    {"quote", &RandomCommandsTest::changeQuote},
    {"quote", &RandomCommandsTest::changeQuote},
    {"quotes", &RandomCommandsTest::removeOrSplitQuotes},
    {"event", &RandomCommandsTest::changeEvent},
    {"event", &RandomCommandsTest::changeEvent},
    {"buy", &RandomCommandsTest::buy},
    {"revalue", &RandomCommandsTest::revalue},
    {"remove company", &RandomCommandsTest::removeCompany},
};

TEST_P(RandomCommandsTest, LinksListsAndFileAgreeAfterEachCommand)
{
    constexpr int kSteps = 1200;
    constexpr unsigned kRarely = 40; // steps between the removals of much
    for (int step = 0; step < kSteps && !HasFailure(); ++step) {
        const Action& action = kActions[under(kActions.size())];
        SCOPED_TRACE("step " + std::to_string(step) + ": " + action.name);
        (this->*action.run)();
        if (under(kRarely) == 0)
            removeMarket();
        if (under(kRarely) == 0)
            removeCurrency();
        if (under(3) == 0)
            continue; // the next command comes before this one has been handled
        settle();
        expectLinks();
        expectListsShowTheModel();
        expectTheSameAfterSaveAndLoad();
    }
    const auto markets = window().catalogue().getMarkets();
    EXPECT_GT(markets.size(), 0U) << "else there was little to go wrong";
}

INSTANTIATE_TEST_SUITE_P(Seeds, RandomCommandsTest, testing::Range(1U, 5U));

} // namespace
