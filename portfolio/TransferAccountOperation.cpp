#include "portfolio/TransferAccountOperation.h"

#include "foundation/FieldIO.h"
#include "portfolio/Account.h"

TransferAccountOperation::TransferAccountOperation(const Date& date, Account* from, Account* to, float amount,
                                                   bool automatic)
    : AccountOperation(date, from, amount, automatic)
{
    setRecepientAccount(to);
}

TransferAccountOperation::~TransferAccountOperation()
{
    setRecepientAccount(nullptr);
}

int TransferAccountOperation::wrt(FILE* file) const
{
    // A transfer without recipient has the undefined name, which no account has: a reader takes it for unknown again.
    const String name = recipient() != nullptr ? recipient()->getName() : String();
    name.wrt(file);
    fwritefloat(file, getAmount());
    fwritefloat(file, rateCost_);
    fwritefloat(file, cost_);
    fwritefloat(file, fromCurrencyQuote_);
    fwritefloat(file, toCurrencyQuote_);
    return getDate().wrt(file);
}

int TransferAccountOperation::rd(FILE* file)
{
    String name;
    if (name.rd(file) != 0)
        return -1;
    // By way of the sender, which the transfer has been given before: its wallet has read all accounts by now.
    Account* named = getAccountByName(name);
    if (named == nullptr)
        return -1;
    // Both accounts list the transfer from here on; what follows in the record changes it in place.
    setRecepientAccount(named);
    setAmount(freadfloat(file));
    rateCost_ = freadfloat(file);
    cost_ = freadfloat(file);
    fromCurrencyQuote_ = freadfloat(file);
    toCurrencyQuote_ = freadfloat(file);
    Date date;
    date.rd(file);
    setDate(date);
    return reachedEnd(file) ? -1 : 0;
}

float TransferAccountOperation::getTotalCost() const
{
    // In double, and rounded once at the end.
    return static_cast<float>(static_cast<double>(getAmount()) * rateCost_ + cost_);
}

void TransferAccountOperation::notifyChange()
{
    // Both lists that hold the transfer go by its date.
    AccountOperation::notifyChange();
    if (recipient() != nullptr)
        recipient()->transferOperationChanged();
}

int TransferAccountOperation::setRecepientAccount(Account* account)
{
    return recipient_.set(this, account);
}
