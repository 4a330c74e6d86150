#pragma once

#include "foundation/DateText.h"
#include "market/Company.h"
#include "market/Currency.h"
#include "market/Market.h"
#include "platform/Button.h"
#include "platform/DialogAnswers.h"
#include "platform/TextControl.h"
#include "tests/gui/WindowFixture.h"
#include "tests/support/Links.h"
#include "views/OperationView.h"

#include <algorithm>
#include <cstdlib>
#include <random>

/// The seed to begin with. For longer runs, which take other seeds each time: see CONTRIBUTING.md.
inline unsigned firstSeed()
{
    const char* text = std::getenv("PELORIN_FIRST_SEED");
    return text != nullptr ? static_cast<unsigned>(std::strtoul(text, nullptr, 10)) : 1;
}

/// Gives the window commands in any order, as a person may.
class RandomCommands : public WindowTest {
protected:
    /// In half of the runs no two things have one name.
    explicit RandomCommands(unsigned seed) : random_(seed), areNamesUnique_(seed % 2 == 0)
    {
        DialogAnswers::current().alert = [this](const char*, const char*) { return static_cast<int32>(under(4) > 0); };
    }
    ~RandomCommands() override
    {
        settle(); // what waits may ask
        DialogAnswers::current().alert = nullptr;
    }

    /// One thing that a person may do.
    struct Action {
        const char* name;
        std::size_t weight; // how likely it is
        void (RandomCommands::*run)();
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
    void applySplit()
    {
        ensureSelection("CompanyView", "lstCompanyEvents");
        send({'CBAs'});
        settle();
        BWindow* asked = BWindow::newest();
        if (asked == &window())
            return;
        dynamic_cast<BButton&>(*asked->FindView(under(3) > 0 ? "btnApply" : "btnCancel")).Invoke();
        settle();
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
        static const char* const kTypes[] = {"DEPOSIT", "TRANSFER", "BUY", "SELL", "INCOME", "CHARGE"};
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
        send({'WTDa', 'WTDa', 'WCCe', 'OCPr', 'WBGd'});
    }
    bool areNamesUnique() const { return areNamesUnique_; }

private:
    std::mt19937 random_;
    bool areNamesUnique_;
    unsigned nextSymbol_ = 0;
    unsigned nextDay_ = 0;
    unsigned nextName_ = 0;
};

inline const std::vector<RandomCommands::Action> RandomCommands::kActions = {
    {"select", 4, &RandomCommands::pickSomething},
    {"currency", 1, &RandomCommands::addCurrency},
    {"reference", 1, &RandomCommands::changeReference},
    {"market", 2, &RandomCommands::addMarket},
    {"company", 3, &RandomCommands::addCompany},
    {"quote", 4, &RandomCommands::changeQuotes},
    {"quotes", 1, &RandomCommands::removeOrSplitQuotes},
    {"event", 2, &RandomCommands::changeEvent},
    {"split", 1, &RandomCommands::applySplit},
    {"account", 2, &RandomCommands::changeAccount},
    {"operation", 6, &RandomCommands::changeOperation},
    {"look", 1, &RandomCommands::lookAround},
    {"revalue", 1, &RandomCommands::revalue},
};
