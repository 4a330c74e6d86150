#include "market/SplitCompanyEvent.h"

#include "foundation/FieldIO.h"

SplitCompanyEvent::SplitCompanyEvent(Company* company, const Date& date, short numerator, short divider)
    : CompanyEvent(company, date), numerator_(numerator), divider_(divider)
{}

int SplitCompanyEvent::wrt(FILE* file) const
{
    getDate().wrt(file);
    // A write that fails leaves its mark on the file, which the currency around all this looks at.
    fwriteshort(file, static_cast<unsigned short>(numerator_));
    fwriteshort(file, static_cast<unsigned short>(divider_));
    return 0;
}

int SplitCompanyEvent::rd(FILE* file)
{
    Date date;
    date.rd(file);
    setDate(date);
    // The file has unsigned numbers; those above 32767 stand for negative ones, as they were written.
    numerator_ = static_cast<short>(freadshort(file));
    divider_ = static_cast<short>(freadshort(file));
    return reachedEnd(file) ? -1 : 0;
}
