#pragma once

#include "foundation/PackedDate.h"
#include "foundation/Serializable.h"

#include <cstring>

/// A day and its value, apart from any series.
struct DatedValue {
    PackedDate day;
    float value = 0;
};

/// A dated value: the price of a share, or the rate of a currency in the reference currency.
///
/// The value is a 32-bit float, in memory and on file. The volume lives in memory only.
class Quote : public Serializable {
public:
    virtual ~Quote() = default;

    /// File: date (8 bytes), value (f32). `rd` returns -1 when the file ends inside the record.
    int wrt(FILE* file) const override;
    int rd(FILE* file) override;
    static constexpr int kFileSize = Date::kFileSize + 4;
    /// Takes date and value from the `kFileSize` bytes of a record, without notice to an owner.
    void decode(const unsigned char* bytes);
    void encode(unsigned char* bytes) const;

    Date getDate() const { return date_.date(); }
    /// The same, to compare.
    const PackedDate& getPackedDate() const { return date_; }
    void setDate(const Date& date)
    {
        date_ = date;
        notifyChange();
    }
    float getValue() const { return value_; }
    void setValue(float value)
    {
        value_ = value;
        notifyChange();
    }
    unsigned getVolume() const { return volume_; }
    void setVolume(unsigned volume) { volume_ = volume; }

protected:
    Quote() = default;
    Quote(const Date& date, float value) : date_(date), value_(value) {}

    /// Tells the owner of the series, when there is one, that date or value has changed.
    virtual void notifyChange() = 0;

private:
    PackedDate date_;
    float value_ = 0;
    unsigned volume_ = 0;
};

/// Orders two places of an array of quote pointers by date, ascending, for `qsort`.
inline int sortQuotesByDate(const void* a, const void* b)
{
    // The arrays hold pointers to one of the quote classes; each begins with its Quote.
    const Quote* left;
    const Quote* right;
    std::memcpy(&left, a, sizeof left);
    std::memcpy(&right, b, sizeof right);
    if (left->getPackedDate() > right->getPackedDate())
        return 1;
    return left->getPackedDate() < right->getPackedDate() ? -1 : 0;
}
