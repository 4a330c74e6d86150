#pragma once

#include "market/Company.h"
#include "market/Currency.h"
#include "market/Market.h"
#include "platform/ListView.h"
#include "portfolio/Account.h"
#include "portfolio/Share.h"
#include "portfolio/ShareOperation.h"
#include "portfolio/Wallet.h"
#include "tests/gui/WindowFixture.h"

#include <QLineEdit>
#include <QTest>

/// A window in which a catalogue is kept by hand.
class CatalogueTest : public WindowTest {
protected:
    /// A click on a button, with what is typed before it and what the status line says then.
    struct Step {
        std::vector<std::pair<const char*, const char*>> fields;
        const char* button;
        const char* message;
    };
    void follow(const std::vector<Step>& steps)
    {
        for (const auto& step : steps) {
            for (const auto& [field, typed] : step.fields)
                type(field, typed);
            clearMessage();
            click(step.button);
            EXPECT_EQ(message(), step.message) << step.button;
        }
    }

    void addCurrency(const char* name, const char* symbol)
    {
        show(kCurrencyPage);
        follow({{{{"txtCurrencyName", name}, {"txtCurrencyRepresentation", symbol}}, "btnAddCurrency", ""}});
    }
    void addMarket(const char* name, const char* symbol)
    {
        show(kCompanyPage);
        follow({{{{"txtMarketName", name}, {"txtMarketCurrencyRepresentation", symbol}}, "btnAddMarket", ""}});
    }
    void addCompany(const char* ticker, const char* name)
    {
        follow({{{{"txtAbbreviation", ticker}, {"txtName", name}}, "btnAddCompany", ""}});
    }
    void addQuote(const char* date, const char* value)
    {
        follow({{{{"txtQuoteDate", date}, {"txtQuoteValue", value}}, "btnAddQuote", ""}});
    }
    /// Two currencies, a market in the first one, and a company with three quotes, which is selected.
    void addSmallCatalogue()
    {
        addCurrency("Euro", "EUR");
        addQuote("1/1/2024", "1");
        addCurrency("Dollar", "USD");
        addQuote("1/1/2024", "2");
        addMarket("Paris", "EUR");
        addCompany("AL", "Alpha");
        addQuote("1/3/2024", "10");
        addQuote("11/3/2024", "20");
        addQuote("6/3/2024", "12.5");
    }
    /// A purchase of ten shares of the company, on the operation page's list.
    Share* buy(Company* company)
    {
        auto* account = new Account("Cash");
        account->setWallet(&wallet());
        account->setCurrency(window().getReferenceCurrency());
        auto* share = new Share(&wallet(), company);
        (new ShareOperation(Date(2, 3, 2024), share, true, 10, 11, false, 0))->setAccount(account);
        window().UpdateState();
        return share;
    }
    Currency* currency(unsigned i) { return window().catalogue().getCurrencies()[i]; }
    Company* company()
    {
        Company* found = nullptr;
        window().catalogue().getMarkets()[0]->getCompany("AL", &found);
        return found;
    }
    void selectAll(const char* name)
    {
        select(name, 0);
        QTest::keyClick(list(name).widget(), Qt::Key_A, Qt::ControlModifier);
        settle();
    }
    /// Whether the field tells that it does not understand its text.
    bool isMarked(const char* field) { return !find<QLineEdit>(field).toolTip().isEmpty(); }
};
