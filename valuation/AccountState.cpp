#include "valuation/AccountState.h"

#include "market/Currency.h"
#include "portfolio/Account.h"
#include "portfolio/TransferAccountOperation.h"
#include "valuation/CashMoves.h"
#include "valuation/State.h"

AccountState::AccountState(Account* account, State* state, float cash) : cash_(cash)
{
    setAccount(account);
    setState(state);
}

AccountState::AccountState(Account* account, State* state, const Date& date, bool) : AccountState(nullptr, nullptr, 0)
{
    if (account == nullptr)
        return;
    // The links first: the replay reads the account and writes the state's deposits.
    setAccount(account);
    setState(state);
    replay(date, false);
}

AccountState::~AccountState()
{
    setAccount(nullptr);
    setState(nullptr);
}

void AccountState::processAutomaticOperations(const Date& date)
{
    // The manual operations are in the balance already, and so are the moves of the holdings. Intended: automatic ones
    // are added behind all of these whatever their dates, and the evolution adds them up in the same order.
    replay(date, true);
}

void AccountState::replay(const Date& date, bool automatic)
{
    const Currency* currency = account() != nullptr ? account()->currency() : nullptr;
    if (state() == nullptr || currency == nullptr)
        return;
    State& whole = *state();
    for (const Operation* operation : account()->operations()) {
        whole.noteOperationDate(operation->getDate()); // before the test: a later operation counts as the first, too
        if (operation->getDate() > date)
            break;
        if (operation->isAutomatic() != automatic)
            continue;
        if (operation->getType() == Operation::kDeposit)
            whole.setTotalDeposit(addRounded(whole.getTotalDeposit(), depositInReference(*operation, *currency)));
        cash_ = addRounded(cash_, ownCashMove(*operation));
    }
    // The received transfers come after all moves of the account's own: the roundings depend on the order.
    for (const TransferAccountOperation* transfer : account()->transferOperations()) {
        whole.noteOperationDate(transfer->getDate());
        if (transfer->getDate() > date)
            break;
        if (transfer->isAutomatic() == automatic)
            cash_ = addRounded(cash_, receivedCash(*transfer));
    }
}

Date AccountState::getDate() const
{
    return state() != nullptr ? state()->getDate() : Date();
}

const String& AccountState::getAccountName() const
{
    return account() != nullptr ? account()->getName() : String::none();
}

const String& AccountState::getCurrencyRepresentation() const
{
    return account() != nullptr ? account()->getCurrencyRepresentation() : String::none();
}

void AccountToAccountStates::deleteAll()
{
    OneToManyAssociation::deleteAll();
}

int AccountState::setState(State* state)
{
    return state_.set(this, state);
}

int Account::addAccountState(AccountState* state)
{
    return states_.add(state);
}

int Account::removeAccountState(AccountState* state)
{
    return states_.remove(state);
}
