// Commands in any order: whatever a person does, both ends of every link agree, the lists show what there is, and what
// is saved comes back the same.

#include "tests/gui/RandomCommands.h"
#include "market/CompanyEvent.h"
#include "platform/ListItem.h"
#include "platform/Menu.h"
#include "platform/MenuField.h"
#include "platform/MenuItem.h"
#include "tests/support/Bytes.h"
#include "valuation/Evolution.h"
#include "valuation/Totals.h"

#include <cmath>

namespace {

const Date kDay(21, 11, 2024);

class RandomCommandsTest : public RandomCommands, public testing::WithParamInterface<unsigned> {
protected:
    RandomCommandsTest() : RandomCommands(GetParam()) {}

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
        if (!canBeSaved || !areNamesUnique() || reference == nullptr || reference->getRepresentation().isUndefined())
            return; // it does not come back, or as something else
        Wallet loaded;
        loaded.setCatalogue(catalogue);
        EXPECT_EQ(loaded.rd(BytesFile(saved), nullptr), 0);
        const Date day = window().getState()->getDate();
        const Totals expected(*refreshStates(loaded, day, false, nullptr), catalogue);
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

    int valuesCompared_ = 0;
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
        EXPECT_GT(valuesCompared_, 4);
    }
}

INSTANTIATE_TEST_SUITE_P(Seeds, RandomCommandsTest, testing::Range(firstSeed(), firstSeed() + 4));

} // namespace
