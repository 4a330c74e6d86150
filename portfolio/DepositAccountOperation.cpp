#include "portfolio/DepositAccountOperation.h"

#include "foundation/FieldIO.h"

int DepositAccountOperation::wrt(FILE* file) const
{
    fwritefloat(file, getAmount());
    return getDate().wrt(file);
}

int DepositAccountOperation::rd(FILE* file)
{
    setAmount(freadfloat(file));
    Date date;
    date.rd(file);
    setDate(date);
    return reachedEnd(file) ? -1 : 0;
}
