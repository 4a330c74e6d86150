#pragma once

#include "tests/gui/WindowFixture.h"
#include "tests/support/SmallPortfolio.h"

/// Tests of the commands, with their market data.
class CatalogueTest : public WindowTest {
protected:
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
    /// By hand: two currencies, a market in the first one, and a company with three quotes, which is selected.
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
    /// Not by hand: the euro, which is the reference, and the dollar at half of it; two markets of the name Paris, the
    /// first with AAA, in dollars, the second with BBB, in euros, at 10 on 01/11/2024.
    void addTwoMarkets()
    {
        auto* euro = new Currency("Euro", "EUR", nullptr);
        auto* dollar = new Currency("Dollar", "USD", euro);
        new CurrencyQuote(euro, Date(1, 1, 2020), 1);
        new CurrencyQuote(dollar, Date(1, 1, 2020), 0.5F);
        for (Currency* added : {dollar, euro}) {
            window().catalogue().addCurrency(added);
            (new Market("Paris"))->setCurrency(added);
        }
        window().setReferenceCurrency(euro);
        const auto markets = window().catalogue().getMarkets();
        new Company(markets[0], "Alpha", "AAA");
        new CompanyQuote(new Company(markets[1], "Beta", "BBB"), Date(1, 11, 2024), 10);
        window().UpdateState();
    }
    Company* beta() { return window().catalogue().getMarkets()[1]->companies().front(); }
    /// A purchase of ten shares of the company, on the operation page's list.
    void buy(Company* company)
    {
        Account* account = addAccount(wallet(), "Cash", window().getReferenceCurrency());
        auto* share = new Share(&wallet(), company);
        (new ShareOperation(Date(2, 3, 2024), share, true, 10, 11, false, 0))->setAccount(account);
        window().UpdateState();
    }
    /// Has the operation page's menus follow, as the account commands do, and shows it.
    void showAccounts()
    {
        show(kPortoFolioPage);
        window().UpdateState();
        select("lstAccounts", 0);
        click("btnUpdateQuote");
        show(kOperationPage);
    }
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

    /// The dialog that waits, its controls, what they say, and a click on them.
    static QWidget* dialog() { return QApplication::activeModalWidget(); }
    template <class Widget>
    static Widget* part(const char* name)
    {
        return dialog()->findChild<Widget*>(name);
    }
    static std::string line(const char* name) { return part<QWidget>(name)->accessibleName().toStdString(); }
    static std::vector<std::string> table(const char* name)
    {
        std::vector<std::string> texts;
        const QAbstractItemModel& rows = *part<QAbstractItemView>(name)->model();
        for (int i = 0; i < rows.rowCount(); ++i)
            texts.push_back(rows.data(rows.index(i, 0), Qt::AccessibleTextRole).toString().toStdString());
        return texts;
    }
    static void pressPart(const char* name)
    {
        QTest::mouseClick(part<QAbstractButton>(name), Qt::LeftButton, {}, {8, 8});
        settle();
        settle(); // the window goes behind its answer
    }
};
