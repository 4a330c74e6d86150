// The commands that have nothing to work on, or are given what they cannot take: what they say, in the order of their
// checks, and that they change nothing.

#include "tests/gui/CatalogueFixture.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

using RefusalTest = CatalogueTest;

constexpr const char* kNoDate = "Please specify a date.";
constexpr const char* kNoFactor = "Please specify a factor (ex: 1:2)";
constexpr const char* kIncompleteCurrency = "Please specify a currency name and representation.";
constexpr const char* kIncompleteAccount = "Please specify an account name and a currency.";
constexpr const char* kNoQuantity = "Quantity must be higher than 0.";

TEST_F(RefusalTest, EmptyWindow)
{
    show(kCompanyPage);
    follow({
        {{}, "btnAddMarket", "Please specify a market name."},
        {{{"txtMarketName", "Paris"}}, "btnAddMarket", "Please specify a currency representation."},
        {{{"txtMarketCurrencyRepresentation", "EUR"}}, "btnAddMarket", "Unknown currency..."},
        {{}, "btnUpdateMarket", ""},
        {{}, "btnAddCompany", "Please first create a market."},
        {{}, "btnUpdateCompany", ""},
        {{}, "btnSetLastThreeMonths", ""},
        {{}, "btnAddQuote", kNoDate},
        {{{"txtQuoteDate", "1/1/2024"}}, "btnAddQuote", "You must first select a company"},
        {{{"txtQuoteDate", ""}}, "btnUpdateQuote", "You must first select a quote"},
        {{}, "btnRemoveQuote", ""},
        {{}, "btnSplitQuotes", kNoFactor},
        {{{"txtSplitRangeNum", "1"}, {"txtSplitRangeDenum", "0"}}, "btnSplitQuotes", kNoFactor},
        {{{"txtSplitRangeDenum", "2"}}, "btnSplitQuotes", ""},
        {{}, "btnAddCompanyEvent", "You must first select a company"},
        {{}, "btnUpdateCompanyEvent", kNoDate},
        {{{"txtCompanyEventDate", "1/1/2024"}},
         "btnUpdateCompanyEvent",
         "Please select a company event if you want to update."},
        {{}, "btnRemoveCompanyEvent", ""},
    });
    show(kCurrencyPage);
    follow({
        {{}, "btnAddCurrency", kIncompleteCurrency},
        {{{"txtCurrencyName", "Euro"}}, "btnAddCurrency", kIncompleteCurrency},
        {{{"txtCurrencyName", ""}, {"txtCurrencyRepresentation", "EUR"}}, "btnAddCurrency", kIncompleteCurrency},
        {{}, "btnUpdateCurrency", ""},
        {{}, "btnSetReferenceCurrency", "Please select a currency."},
        {{}, "btnAddQuote", kNoDate},
        {{{"txtQuoteDate", "1.1.2024"}}, "btnAddQuote", "You must first select a currency"},
        {{}, "btnUpdateQuote", "You must first select a quote"},
        {{}, "btnRemoveQuote", ""},
    });
    show(kPortoFolioPage);
    follow({
        {{}, "btnAddAccount", kIncompleteAccount},
        {{{"txtAccountName", "Cash"}}, "btnAddAccount", kIncompleteAccount},
        {{{"txtAccountCurrency", "GBP"}}, "btnAddAccount", "Unknown currency."},
        {{{"txtAccountCurrency", ""}}, "btnUpdateQuote", kIncompleteAccount},
        {{{"txtAccountCurrency", "GBP"}}, "btnUpdateQuote", "You must select an account to update."},
        {{}, "btnRemoveQuote", "You must select an account to update."},
    });
    show(kOperationPage);
    follow({{{{"txtDate", ""}}, "btnAddOperation", ""},
            {{{"txtDate", "31/02/2024"}}, "btnAddOperation", ""},
            {{{"txtDate", "01/11/2024"}}, "btnAddOperation", "Undefined account."},
            {{}, "btnRemoveOperation", ""}});
    EXPECT_EQ(window().catalogue().getNbrCurrencies(), 0U);
    EXPECT_EQ(wallet().getNbrAccounts(), 0U);
}

TEST_F(RefusalTest, SelectedCompanyAndCurrency)
{
    addCurrency("Euro", "EUR");
    follow({{{}, "btnRemoveCurrency", "You may not remove the last currency..."}});
    addQuote("1/1/2024", "1");
    select("lstQuotes", 0);
    follow({{{{"txtQuoteDate", ""}}, "btnUpdateQuote", kNoDate}});
    EXPECT_THAT(rows("lstQuotes"), ElementsAre("01/01/2024\t1.00"));
    addMarket("Paris", "EUR");
    follow({{{{"txtAbbreviation", ""}}, "btnAddCompany", "Please specify an abbreviation for your company"}});
    addCompany("AL", "Alpha");
    follow({{{{"txtCompanyEventDate", "31/2/2024"}}, "btnAddCompanyEvent", kNoDate}});
    addQuote("1/3/2024", "10");
    select("lstQuotes", 0);
    follow({{{{"txtQuoteDate", "99"}}, "btnUpdateQuote", kNoDate}});
    EXPECT_THAT(rows("lstQuotes"), ElementsAre("01/03/2024\t10.00"));
    EXPECT_THAT(rows("lstCompanies"), SizeIs(1));
    EXPECT_THAT(rows("lstCompanyEvents"), IsEmpty());
}

TEST_F(RefusalTest, Operations)
{
    addTwoMarkets();
    show(kPortoFolioPage);
    follow({{{{"txtAccountName", "Cash"}, {"txtAccountCurrency", "EUR"}}, "btnAddAccount", ""}});
    show(kOperationPage);
    for (const char* button : {"btnAddOperation", "btnUpdateOperation"}) {
        wallet().getAccount(0)->setName("Purse");
        follow({{{{"baseAccount", "Cash"}}, button, "Unknown account."}});
        wallet().getAccount(0)->setName("Cash");
        follow({
            {{{"operationType", "Transfer"}}, button, ""}, // to nowhere
            {{{"operationType", "Sell"}, {"txtMarketName", "London"}, {"txtCompanyAbbreviation", "BBB"}},
             button,
             "Unknown company."},
            {{{"txtMarketName", "Paris"}, {"txtCompanyAbbreviation", "CCC"}}, button, "Unknown company."},
            // Which is seen before the quantity.
            {{{"txtCompanyAbbreviation", "AAA"}, {"txtQuantity", "0"}}, button, "Not the same currencies."},
            {{{"txtCompanyAbbreviation", "BBB"}}, button, kNoQuantity},
            {{{"operationType", "Buy"}, {"txtQuantity", "-3"}}, button, kNoQuantity},
        });
    }
    EXPECT_EQ(wallet().getAccount(0)->getNbrOperations(), 0U);
    EXPECT_EQ(wallet().getNbrShares(), 1U) << "a holding is made before the quantity is looked at";
}

} // namespace
