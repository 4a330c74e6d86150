#pragma once

#include "tests/support/SmallPortfolio.h"
#include "valuation/AccountState.h"
#include "valuation/ShareState.h"
#include "valuation/State.h"

#include <algorithm>
#include <functional>
#include <gtest/gtest.h>
#include <typeinfo>
#include <utility>

/// Everything that can be reached from some currencies and wallets, by whichever end of a link, in a fixed order.
struct Links {
    Links(const std::vector<Currency*>& someCurrencies, const std::vector<Wallet*>& someWallets)
        : currencies(someCurrencies), wallets(someWallets)
    {
        relate(currencies, &Currency::getAllMarkets, markets, &Market::getCurrency);
        relate(markets, &Market::getAllCompanies, companies, &Company::getMarket);
        relate(companies, &Company::getAllShares, shares, &Share::getCompany);
        relate(wallets, &Wallet::getAllShares, shares, &Share::getWallet);
        relate(currencies, &Currency::getAllAccounts, accounts, &Account::getCurrency);
        relate(wallets, &Wallet::getAllAccounts, accounts, &Account::getWallet);
        relate(wallets, &Wallet::getAllStates, states, &State::getWallet);
        relate(shares, &Share::getAllShareOperations, trades, &ShareOperation::getShare);
        relate(accounts, &Account::getAllTransferOperations, transfers, &TransferAccountOperation::getRecepientAccount);
        operations.assign(trades.begin(), trades.end());
        for (TransferAccountOperation* received : transfers)
            operations.push_back(received);
        relate(accounts, &Account::getAllOperations, operations, &Operation::getAccount);
        relate(accounts, &Account::getAllAccountStates, accountStates, &AccountState::getAccount);
        relate(states, &State::getAllAccountStates, accountStates, &AccountState::getState);
        relate(shares, &Share::getAllShareStates, shareStates, &ShareState::getShare);
        relate(states, &State::getAllShareStates, shareStates, &ShareState::getState);
    }
    Links(const Links&) = delete;
    Links& operator=(const Links&) = delete;

    /// Every element of a list points back to the list's owner, and whatever points to an owner is listed there once;
    /// operations are listed by date.
    void expectConsistent() const
    {
        for (const auto& check : checks_)
            check();
    }

    std::vector<Currency*> currencies;
    std::vector<Market*> markets;
    std::vector<Company*> companies;
    std::vector<Wallet*> wallets;
    std::vector<Share*> shares;
    std::vector<Account*> accounts;
    std::vector<State*> states;
    std::vector<Operation*> operations;
    std::vector<TransferAccountOperation*> transfers; // those with a recipient
    std::vector<ShareOperation*> trades;              // those with a holding
    std::vector<AccountState*> accountStates;
    std::vector<ShareState*> shareStates;

private:
    /// Takes in the elements that the owners list; the check waits until all elements are known.
    template <class Owner, class Element>
    void relate(const std::vector<Owner*>& owners, Element** (Owner::*getAll)(unsigned*) const,
                std::vector<Element*>& elements, int (Element::*get)(Owner**) const)
    {
        for (const Owner* owner : owners)
            for (Element* element : all(*owner, getAll))
                if (std::ranges::find(elements, element) == elements.end())
                    elements.push_back(element);
        checks_.push_back([&owners, &elements, getAll, get] { expectBothEnds(owners, getAll, elements, get); });
    }

    template <class Owner, class Element>
    static void expectBothEnds(const std::vector<Owner*>& owners, Element** (Owner::*getAll)(unsigned*) const,
                               const std::vector<Element*>& elements, int (Element::*get)(Owner**) const)
    {
        std::vector<std::pair<Owner*, Element*>> listed, linked;
        for (Owner* owner : owners) {
            for (Element* element : all(*owner, getAll))
                listed.emplace_back(owner, element);
            if constexpr (std::is_base_of_v<Operation, Element>) {
                EXPECT_TRUE(std::ranges::is_sorted(all(*owner, getAll), {}, [](auto* o) { return o->getDate(); }));
            }
        }
        for (Element* element : elements) {
            Owner* owner;
            if ((element->*get)(&owner) == 0)
                linked.emplace_back(owner, element);
        }
        std::ranges::sort(listed);
        std::ranges::sort(linked);
        EXPECT_EQ(listed, linked) << typeid(Owner).name() << ' ' << typeid(Element).name();
    }

    std::vector<std::function<void()>> checks_;
};
