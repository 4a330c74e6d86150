#include "portfolio/ShareOperation.h"

#include "foundation/FieldIO.h"
#include "portfolio/Account.h"
#include "portfolio/Share.h"
#include "portfolio/Wallet.h"

ShareOperation::ShareOperation(const Date& date, Share* share, bool buy, int quantity, float quote, bool automatic,
                               float operationCost)
    : Operation(date, automatic), buy_(buy), quantity_(quantity), quote_(quote), operationCost_(operationCost)
{
    setShare(share);
}

ShareOperation::~ShareOperation()
{
    setShare(nullptr);
}

int ShareOperation::wrt(FILE* file) const
{
    // There would be no names that a reader could find the holding by.
    if (share() == nullptr)
        return -1;
    fwritechar(file, buy_ ? 'Y' : 'N');
    share()->getMarketName().wrt(file);
    share()->getCompanyAbbreviation().wrt(file);
    fwriteint(file, quantity_);
    fwritefloat(file, quote_);
    getDate().wrt(file);
    fwritefloat(file, operationCost_);
    return 0;
}

int ShareOperation::rd(FILE* file)
{
    buy_ = freadchar(file) == 'Y';
    String market;
    String abbreviation;
    // Market and ticker stand for the holding: the wallet finds it by them.
    if (market.rd(file) != 0 || abbreviation.rd(file) != 0)
        return -1;
    Share* held;
    // The account is linked before the record is read, and its wallet has read all holdings before any account.
    if (account() == nullptr || account()->getShare(market, abbreviation, &held) != 0)
        return -1;
    // The holding lists the operation from here on. Its date, which follows, puts it in its place there.
    setShare(held);
    quantity_ = freadint(file);
    quote_ = freadfloat(file);
    Date date;
    date.rd(file);
    setDate(date);
    operationCost_ = freadfloat(file);
    return reachedEnd(file) ? -1 : 0;
}

float ShareOperation::getOperationRateCost() const
{
    const Wallet* wallet = share() != nullptr ? share()->wallet() : nullptr;
    if (wallet == nullptr)
        return 0;
    return buy_ ? wallet->getBuyRateCost() : wallet->getSellRateCost();
}

void ShareOperation::notifyChange()
{
    // Both lists that hold the operation go by its date.
    Operation::notifyChange();
    if (share() != nullptr)
        share()->shareOperationChanged();
}

int ShareOperation::setShare(Share* share)
{
    return share_.set(this, share);
}
