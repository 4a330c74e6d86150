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
    // The account lists the deposit already. From here on it stands in its place by date, also when that was cut short:
    // then the reader destroys it.
    Date date;
    date.rd(file);
    setDate(date);
    return reachedEnd(file) ? -1 : 0;
}
