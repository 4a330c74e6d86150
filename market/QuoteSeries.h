#pragma once

#include "foundation/PackedDate.h"
#include "market/Quote.h"
#include "market/RecordList.h"

#include <algorithm>
#include <cstdint>
#include <span>
#include <string>
#include <string_view>
#include <vector>

/// The next number for `QuoteSeries::revision`: one that no series of the program has had. 0 is never given.
inline std::uint64_t nextRevision()
{
    static std::uint64_t last = 0;
    return ++last;
}

/// The dated quotes of a `Company` or a `Currency`, at most one a day where `addQuote` has its way, with the answers
/// they give: the quote of a day, a value for any day, the extremes, and a least-squares trend line (the prevision).
///
/// `SeriesQuote` is the quote class, `ManyEnd` the sorted association that lists it; the owner derives from this class
/// and so owns the quotes. Look-ups are binary searches. The trend is computed when it is read.
template <class Owner, class SeriesQuote, class ManyEnd>
class QuoteSeries {
public:
    /// Links `q` to this series; a quote that stood on the same day is destroyed.
    int addQuote(SeriesQuote* q)
    {
        if (q == nullptr)
            return -1;
        if (quotes_.contains(q))
            return 0;
        if (SeriesQuote* existing = findQuote(q->getDate()))
            delete existing;
        const int result = quotes_.add(q);
        updatePrevisions();
        return result;
    }
    /// Adds a quote for each of `values`, with the outcome of one `addQuote` after the other, in whatever order they
    /// come.
    void addQuotes(std::span<const DatedValue> values);
    /// Unlinks `q`, which from then on belongs to the caller.
    int removeQuote(SeriesQuote* q)
    {
        const int result = quotes_.remove(q);
        updatePrevisions();
        return result;
    }
    /// To be called when a quote's date or value has changed.
    void quoteChanged()
    {
        quotes_.changeNotice();
        updatePrevisions();
    }

    /// The first quote of day `d`. @return 0; -1 and a null `*out` when there is none.
    int getQuote(const Date& d, SeriesQuote** out) const
    {
        *out = findQuote(d);
        return *out != nullptr ? 0 : -1;
    }
    /// The i-th quote by date, null out of range.
    SeriesQuote* getQuote(unsigned i) const { return quotes_.at(i); }
    unsigned getNbrQuotes() const { return quotes_.getNbr(); }
    /// The list's own array, by date.
    SeriesQuote** getAllQuotes(unsigned* n) const { return quotes_.getAll(n); }
    std::span<SeriesQuote* const> quotes() const { return quotes_.all(); }

    /// A value for any day: that of the last quote up to it; outside the series, the straight line through the first
    /// and the last quote. A single quote holds for ever; without quotes 0.
    ///
    /// Between two quotes the value is a step, not a slope. Intended: a portfolio is worth the last known price.
    float getRealQuote(const Date& d) const { return realQuote(d, firstOnOrAfter(d)); }

    /// Gives the real quotes of one day after the other, and searches only for a day that goes back.
    class Walk {
    public:
        /// `series` stays as it is while the walk lasts.
        explicit Walk(const QuoteSeries& series) : series_(&series), quotes_(series.quotes()) {}
        /// What `getRealQuote` gives.
        float realQuote(const PackedDate& day)
        {
            if (day < day_)
                next_ = series_->firstOnOrAfter(day);
            while (next_ < quotes_.size() && quotes_[next_]->getPackedDate() < day)
                ++next_;
            day_ = day;
            if (next_ == 0 || next_ == quotes_.size()) // on a line, perhaps
                return series_->realQuote(day, next_);
            return quotes_[quotes_[next_]->getPackedDate() == day ? next_ : next_ - 1]->getValue();
        }

    private:
        const QuoteSeries* series_;
        std::span<SeriesQuote* const> quotes_; // of the series, by date
        PackedDate day_;                       // asked for last
        std::size_t next_ = 0;                 // the first quote on or after it
    };

    /// The quotes as their records in the file, by date.
    std::string quoteRecords() const;
    /// Replaces all quotes by those of `records`, from `quoteRecords`: two of one day are two again.
    void setQuoteRecords(std::string_view records);

    /// Date of the earliest and of the latest quote; the undefined date without quotes.
    Date getFirstQuote() const { return quotes_.getNbr() > 0 ? quotes_.at(0)->getDate() : Date(); }
    Date getLastQuote() const { return quotes_.getNbr() > 0 ? quotes_.at(quotes_.getNbr() - 1)->getDate() : Date(); }
    /// Date of the latest quote on or before `d`; the undefined date when there is none.
    Date getLastQuoteUpTo(const Date& d) const
    {
        if (findQuote(d) != nullptr)
            return d;
        const std::size_t next = firstOnOrAfter(d);
        return next > 0 ? quotes()[next - 1]->getDate() : Date();
    }
    /// Largest and smallest value; 0 without quotes.
    float getHighestQuote() const
    {
        return getNbrQuotes() > 0 ? (*std::ranges::max_element(quotes(), {}, &SeriesQuote::getValue))->getValue() : 0;
    }
    float getLowestQuote() const
    {
        return getNbrQuotes() > 0 ? (*std::ranges::min_element(quotes(), {}, &SeriesQuote::getValue))->getValue() : 0;
    }

    /// Another number after every change of the quotes, their days or their values, and never that of another series,
    /// be it gone or of another kind: who has seen this number before has seen these quotes.
    std::uint64_t revision() const { return revision_; }
    /// Notes that the quotes have changed: the next reader of the trend line computes it again.
    void updatePrevisions()
    {
        trendIsStale_ = true;
        revision_ = nextRevision();
    }
    /// Slope of the trend line, in value units per day; 0 for quotes of a single day, or none.
    float getPente() const
    {
        fitTrend();
        return slope_;
    }
    /// Value of the trend line on day `d`: slope * (d - first quote's day) + intercept.
    float getPrevisionQuote(const Date& d) const
    {
        fitTrend();
        return static_cast<float>(static_cast<double>(slope_) * (d - getFirstQuote()) + intercept_);
    }

protected:
    explicit QuoteSeries(Owner* owner) : quotes_(owner) {}
    ~QuoteSeries() = default;

    void deleteQuotes() { quotes_.deleteAll(); }
    /// File: count (i32), then the quotes by date. @return 0; -1 when a write failed.
    int writeQuotes(FILE* file) const { return writeRecords(file, quotes()); }
    /// Reads a count and as many quotes as there are up to it. @return 0; -1 when the file ended before the last.
    int readQuotes(FILE* file);

private:
    /// A quote read behind one of a later or the same day, with the turn of its addition.
    struct LateQuote {
        SeriesQuote* quote;
        std::uint32_t turn;
    };

    SeriesQuote* findQuote(const Date& d) const
    {
        const PackedDate day = d;
        const std::size_t next = firstOnOrAfter(day);
        return next < getNbrQuotes() && quotes()[next]->getPackedDate() == day ? quotes()[next] : nullptr;
    }
    std::size_t firstOnOrAfter(const PackedDate& day) const
    {
        const auto all = quotes();
        // Most often asked for: the place of a new quote, or a day after the last one.
        if (all.empty() || all.back()->getPackedDate() < day)
            return all.size();
        const auto isBefore = [&day](const SeriesQuote* q) { return q->getPackedDate() < day; };
        return static_cast<std::size_t>(std::ranges::partition_point(all, isBefore) - all.begin());
    }
    /// `next` is `firstOnOrAfter(day)`.
    float realQuote(const PackedDate& day, std::size_t next) const
    {
        const auto all = quotes();
        if (next == all.size())
            return all.empty() ? 0 : lineValue(day.date(), false);
        if (all[next]->getPackedDate() == day)
            return all[next]->getValue();
        return next > 0 ? all[next - 1]->getValue() : lineValue(day.date(), true);
    }
    /// The value of day `d`, before the first quote or behind the last one, on the straight line through both.
    float lineValue(const Date& d, bool isBefore) const
    {
        const SeriesQuote& first = *quotes().front();
        const SeriesQuote& last = *quotes().back();
        const int span = last.getDate() - first.getDate();
        if (getNbrQuotes() == 1 || span == 0) // quotes of one and the same day have no direction
            return isBefore ? first.getValue() : last.getValue();
        const double rise = static_cast<double>(last.getValue()) - first.getValue();
        if (isBefore)
            return static_cast<float>(first.getValue() - static_cast<double>(first.getDate() - d) / span * rise);
        return static_cast<float>(last.getValue() + static_cast<double>(d - last.getDate()) / span * rise);
    }
    void fitTrend() const;
    /// Adds `q`, a new quote, if its day is behind all others; else puts it into `late`, for `replaceWith`.
    void addBehindOrLater(SeriesQuote* q, std::vector<LateQuote>& late)
    {
        if (firstOnOrAfter(q->getPackedDate()) == quotes_.getNbr())
            quotes_.addNew(q); // nothing of its day to replace
        else
            late.push_back({q, quotes_.reserveTurn()});
    }
    void replaceWith(std::vector<LateQuote>& late);

    ManyEnd quotes_;
    mutable float slope_ = 0;
    mutable float intercept_ = 0; // of the trend line, on the day of the first quote
    mutable bool trendIsStale_ = false;
    std::uint64_t revision_ = nextRevision();
};

/// Ordinary least squares of value y against day number x, counted from the first quote:
///     slope = (mean(xy) - mean(x) mean(y)) / (mean(x^2) - mean(x)^2)
///     intercept = (mean(y) mean(x^2) - mean(x) mean(xy)) / (mean(x^2) - mean(x)^2)
/// Source: Draper and Smith, Applied Regression Analysis, chapter 1. Sums are taken in double.
template <class Owner, class SeriesQuote, class ManyEnd>
void QuoteSeries<Owner, SeriesQuote, ManyEnd>::fitTrend() const
{
    if (!trendIsStale_)
        return;
    trendIsStale_ = false;
    slope_ = intercept_ = 0;
    const auto all = quotes();
    if (all.empty())
        return;
    double sumX = 0, sumY = 0, sumXX = 0, sumXY = 0;
    for (const SeriesQuote* quote : all) {
        const double x = quote->getDate() - all.front()->getDate();
        const double y = quote->getValue();
        sumX += x;
        sumY += y;
        sumXX += x * x;
        sumXY += x * y;
    }
    const auto n = static_cast<double>(all.size());
    const double meanX = sumX / n, meanY = sumY / n, meanXX = sumXX / n, meanXY = sumXY / n;
    const double variance = meanXX - meanX * meanX;
    if (variance == 0) // a single day
        return;
    intercept_ = static_cast<float>((meanY * meanXX - meanX * meanXY) / variance);
    slope_ = static_cast<float>((meanXY - meanX * meanY) / variance);
}

template <class Owner, class SeriesQuote, class ManyEnd>
int QuoteSeries<Owner, SeriesQuote, ManyEnd>::readQuotes(FILE* file)
{
    constexpr unsigned kQuotesInBlock = 2048;
    unsigned char block[kQuotesInBlock * SeriesQuote::kFileSize];
    std::vector<LateQuote> late;
    auto missing = static_cast<unsigned>(freadint(file));
    while (missing > 0 && !reachedEnd(file)) {
        const unsigned wanted = std::min(missing, kQuotesInBlock);
        const auto whole = static_cast<unsigned>(std::fread(block, SeriesQuote::kFileSize, wanted, file));
        quotes_.reserve(quotes_.getNbr() + whole);
        for (unsigned i = 0; i < whole; ++i) {
            auto* q = new SeriesQuote;
            q->decode(block + i * SeriesQuote::kFileSize);
            addBehindOrLater(q, late);
        }
        missing -= whole;
    }
    replaceWith(late);
    return missing == 0 && !reachedEnd(file) ? 0 : -1;
}

template <class Owner, class SeriesQuote, class ManyEnd>
void QuoteSeries<Owner, SeriesQuote, ManyEnd>::addQuotes(std::span<const DatedValue> values)
{
    std::vector<LateQuote> late;
    quotes_.reserve(quotes_.getNbr() + static_cast<std::uint32_t>(values.size()));
    for (const DatedValue& value : values) {
        auto* q = new SeriesQuote(nullptr, value.day.date(), value.value);
        addBehindOrLater(q, late);
    }
    replaceWith(late);
}

template <class Owner, class SeriesQuote, class ManyEnd>
std::string QuoteSeries<Owner, SeriesQuote, ManyEnd>::quoteRecords() const
{
    std::string records(std::size_t{getNbrQuotes()} * SeriesQuote::kFileSize, '\0');
    auto* bytes = reinterpret_cast<unsigned char*>(records.data());
    for (const SeriesQuote* quote : quotes()) {
        quote->encode(bytes);
        bytes += SeriesQuote::kFileSize;
    }
    return records;
}

template <class Owner, class SeriesQuote, class ManyEnd>
void QuoteSeries<Owner, SeriesQuote, ManyEnd>::setQuoteRecords(std::string_view records)
{
    deleteQuotes();
    const auto* bytes = reinterpret_cast<const unsigned char*>(records.data());
    const auto* end = bytes + records.size();
    quotes_.reserve(static_cast<std::uint32_t>(records.size() / SeriesQuote::kFileSize));
    for (; bytes != end; bytes += SeriesQuote::kFileSize) {
        auto* quote = new SeriesQuote;
        quote->decode(bytes);
        quotes_.addNew(quote); // past `addQuote`, which keeps one a day
    }
    updatePrevisions();
}

/// Adds quotes that did not come in date order, with the outcome of one `addQuote` after the other: of each day the
/// last one stays. Looking up all of them before the first is added keeps the list from being sorted again each time.
template <class Owner, class SeriesQuote, class ManyEnd>
void QuoteSeries<Owner, SeriesQuote, ManyEnd>::replaceWith(std::vector<LateQuote>& late)
{
    std::stable_sort(late.begin(), late.end(), [](const LateQuote& a, const LateQuote& b) {
        return a.quote->getPackedDate() < b.quote->getPackedDate();
    });
    std::vector<LateQuote> added;
    std::vector<SeriesQuote*> replaced;
    for (std::size_t i = 0; i < late.size(); ++i) {
        if (i + 1 < late.size() && late[i + 1].quote->getDate() == late[i].quote->getDate()) {
            replaced.push_back(late[i].quote);
            continue;
        }
        if (SeriesQuote* existing = findQuote(late[i].quote->getDate()))
            replaced.push_back(existing);
        added.push_back(late[i]);
    }
    for (const LateQuote& l : added) {
        quotes_.add(l.quote);
        quotes_.setTurn(l.quote, l.turn);
    }
    for (SeriesQuote* q : replaced)
        delete q;
    updatePrevisions();
}
