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
    replay(date, true);
}

void AccountState::replay(const Date& date, bool automatic)
{
    const Account* account = account_.partner();
    State* state = state_.partner();
    Currency* currency = nullptr;
    if (account == nullptr || state == nullptr || account->getCurrency(&currency) != 0)
        return;
    unsigned n;
    Operation** operations = account->getAllOperations(&n);
    for (unsigned i = 0; i < n; ++i) {
        const Operation& operation = *operations[i];
        state->noteOperationDate(operation.getDate()); // before the test: a later operation counts as the first, too
        if (operation.getDate() > date)
            break;
        if (operation.isAutomatic() != automatic)
            continue;
        if (operation.getType() == Operation::kDeposit)
            state->setTotalDeposit(addRounded(state->getTotalDeposit(), depositInReference(operation, *currency)));
        cash_ = addRounded(cash_, ownCashMove(operation));
    }
    TransferAccountOperation** transfers = account->getAllTransferOperations(&n);
    for (unsigned i = 0; i < n; ++i) {
        state->noteOperationDate(transfers[i]->getDate());
        if (transfers[i]->getDate() > date)
            break;
        if (transfers[i]->isAutomatic() == automatic)
            cash_ = addRounded(cash_, receivedCash(*transfers[i]));
    }
}

Date AccountState::getDate() const
{
    return state_.partner() != nullptr ? state_.partner()->getDate() : Date();
}

const String& AccountState::getAccountName() const
{
    return account_.partner() != nullptr ? account_.partner()->getName() : String::none();
}

const String& AccountState::getCurrencyRepresentation() const
{
    return account_.partner() != nullptr ? account_.partner()->getCurrencyRepresentation() : String::none();
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
