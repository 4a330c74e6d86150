#include "portfolio/Operation.h"

#include "portfolio/Account.h"

#include <cstring>

/// The lists of derived classes have been left before: their destructors ran first.
Operation::~Operation()
{
    setAccount(nullptr);
}

void Operation::setDate(const Date& date)
{
    // The lists are out of order now, and sort themselves before they are read again.
    date_ = date;
    notifyChange();
}

void Operation::notifyChange()
{
    if (account() != nullptr)
        account()->operationChanged();
}

const String& Operation::getCurrencyRepresentation() const
{
    return account() != nullptr ? account()->getCurrencyRepresentation() : String::none();
}

Account* Operation::getAccountByName(const String& name) const
{
    return account() != nullptr ? account()->getAccountByName(name) : nullptr;
}

int sortOperationByDate(const void* a, const void* b)
{
    // The arrays hold pointers to one of the operation classes; each begins with its Operation.
    // `qsort` knows no types: what it hands over are places, from which the pointers are copied.
    const Operation* left;
    const Operation* right;
    std::memcpy(&left, a, sizeof left);
    std::memcpy(&right, b, sizeof right);
    if (left->getDate() > right->getDate())
        return 1;
    return left->getDate() < right->getDate() ? -1 : 0;
}

int Operation::setAccount(Account* account)
{
    return account_.set(this, account);
}
