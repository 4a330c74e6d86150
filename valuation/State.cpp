#include "valuation/State.h"

#include "portfolio/Account.h"
#include "portfolio/Wallet.h"
#include "valuation/AccountState.h"
#include "valuation/ShareState.h"

namespace {

/// Lets go of the parts of all `states` at once, those of the `items`: holdings, or accounts. For each part to leave
/// its two lists by itself would take as long as making it.
/// @return false when there are parts elsewhere, too; nothing is done then.
template <class Part, class ToState, class ToItem>
bool dropParts(auto states, auto items)
{
    std::size_t inStates = 0, ofItems = 0;
    for (State* state : states)
        inStates += ToState::list(*state).getNbr();
    for (auto* item : items)
        ofItems += ToItem::list(*item).getNbr();
    // When no more parts exist than these states have, no others do. When the items have as many, they have all of
    // them.
    if (inStates != ofItems || !Part::takeBackAll(inStates))
        return false;
    // The parts are gone. Afterwards nothing refers to them any more.
    for (State* state : states)
        ToState::list(*state).forgetAll();
    for (auto* item : items)
        ToItem::list(*item).forgetAll();
    return true;
}

} // namespace

State::State(Wallet* wallet, const Date& date) : shareStates_(this), accountStates_(this), date_(date)
{
    setWallet(wallet);
}

State::State(Wallet* wallet, const Date& date, bool automatic) : State(wallet, date)
{
    automatic_ = automatic;
    if (wallet == nullptr || date.isUndefined())
        return;
    // What an earlier valuation has made up is no part of this one.
    wallet->removeAutomaticOperations();
    firstOperationDate_ = afterAllOperations();

    // Accounts first: the replay of the holdings moves their cash. The states link themselves in and are owned here.
    for (Account* account : wallet->accounts())
        new AccountState(account, this, date, automatic);
    for (Share* share : wallet->shares())
        new ShareState(share, this, date, automatic);
    // The transfers that the automatic sales have just made, and whatever else is automatic.
    for (AccountState* state : accountStates())
        state->processAutomaticOperations(date);
}

State::~State()
{
    // Each state unlinks itself from its account or holding, whose list of states shrinks with it.
    accountStates_.deleteAll();
    shareStates_.deleteAll();
    setWallet(nullptr);
}

void State::noteOperationDate(const Date& date)
{
    if (date < firstOperationDate_)
        firstOperationDate_ = date;
}

AccountState* State::findAccountState(Account* account) const
{
    // A trade without account, such as an automatic sale, moves no cash.
    if (account == nullptr)
        return nullptr;
    // A state lists the accounts in the order of the wallet: only when that has changed since is there a search.
    unsigned place;
    if (wallet() != nullptr && wallet()->getAccountPlace(account, &place) == 0) {
        AccountState* state = getAccountState(place);
        if (state != nullptr && state->account() == account)
            return state;
    }
    for (AccountState* state : accountStates())
        if (state->account() == account)
            return state;
    return nullptr;
}

void State::BuyShares(Account* account, float amount)
{
    if (AccountState* state = findAccountState(account))
        state->setCash(state->getCash() - amount);
}

void State::SellShares(Account* account, float amount)
{
    if (AccountState* state = findAccountState(account))
        state->setCash(state->getCash() + amount);
}

void Wallet::removeAllStates()
{
    if (dropParts<ShareState, ShareStatesToState, ShareStatesToShare>(states(), shares()))
        SharedHolding::forgetAll(); // only they had any
    dropParts<AccountState, AccountStatesToState, AccountStatesToAccount>(states(), accounts());
    // Each state destroys what it still has: where there are states elsewhere, too, all its parts.
    states_.deleteAll();
}

int Wallet::addState(State* state)
{
    return states_.add(state);
}

int Wallet::removeState(State* state)
{
    return states_.remove(state);
}
