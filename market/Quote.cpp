#include "market/Quote.h"

#include "foundation/FieldIO.h"

int Quote::wrt(FILE* file) const
{
    unsigned char bytes[kFileSize];
    encode(bytes);
    return std::fwrite(bytes, sizeof bytes, 1, file) == 1 ? 0 : -1;
}

int Quote::rd(FILE* file)
{
    unsigned char bytes[kFileSize];
    freadbytes(file, bytes, sizeof bytes);
    decode(bytes);
    // The series is told even when the file has ended: date and value have changed.
    notifyChange();
    return reachedEnd(file) ? -1 : 0;
}

void Quote::decode(const unsigned char* bytes)
{
    // Nobody is told: a quote is decoded before it is linked, or by `rd`, which tells.
    date_.decode(bytes);
    value_ = decodeFloat(bytes + Date::kFileSize);
}

void Quote::encode(unsigned char* bytes) const
{
    getDate().encode(bytes);
    encodeFloat(bytes + Date::kFileSize, value_);
}

void Quote::setDate(const Date& date)
{
    date_ = date;
    notifyChange();
}

void Quote::setValue(float value)
{
    value_ = value;
    notifyChange();
}
