#include "exchange/MarketFile.h"

#include "foundation/FieldIO.h"
#include "foundation/PrintableText.h"
#include "market/MarketDiagnosis.h"
#include "market/NoteCompanyEvent.h"
#include "market/RecordList.h"
#include "market/SplitCompanyEvent.h"
#include "storage/DurableSave.h"

#include <algorithm>
#include <functional>
#include <map>
#include <stdexcept>
#include <string_view>

namespace {

/// The records of a series that an import has changed. The model has one quote a day, by date; the file may have two of
/// a day, of which the last counts, and days out of order. Those stay as they stand there.
template <class Series>
class Merge {
public:
    /// Both outlive this.
    Merge(const std::string& former, const Series& series) : former_(former), series_(series)
    {
        for (std::size_t at = 0; at < former.size(); at += Quote::kFileSize)
            days_.emplace_back().decode(reinterpret_cast<const unsigned char*>(former.data()) + at);
    }

    std::string records() const
    {
        if (std::ranges::adjacent_find(days_, std::greater_equal<>()) == days_.end())
            return series_.quoteRecords();
        std::map<PackedDate, std::string_view> last; // of each day the value that counted
        for (std::size_t i = 0; i < days_.size(); ++i)
            last[days_[i]] = valueIn(record(i));
        std::string result;
        const auto quotes = series_.quotes();
        auto next = quotes.begin();
        // A new day comes before the first record that is later.
        const auto addNewWhile = [&](const auto& isMeant) {
            for (; next != quotes.end() && isMeant((*next)->getPackedDate()); ++next)
                if (!last.contains((*next)->getPackedDate()))
                    result += recordOf(**next);
        };
        for (std::size_t i = 0; i < days_.size(); ++i) {
            addNewWhile([&](const PackedDate& day) { return day < days_[i]; });
            auto* quote = *std::ranges::lower_bound(quotes, days_[i], {}, [](auto* q) { return q->getPackedDate(); });
            const std::string now = recordOf(*quote);
            result += valueIn(now) == last.at(days_[i]) ? record(i) : std::string_view(now);
        }
        addNewWhile([](const PackedDate&) { return true; });
        return result;
    }

private:
    std::string_view record(std::size_t i) const
    {
        return std::string_view(former_).substr(i * Quote::kFileSize, Quote::kFileSize);
    }
    static std::string recordOf(const Quote& quote)
    {
        unsigned char bytes[Quote::kFileSize];
        quote.encode(bytes);
        return {std::begin(bytes), std::end(bytes)};
    }
    static std::string_view valueIn(std::string_view record) { return record.substr(Date::kFileSize); }

    const std::string& former_;
    const Series& series_;
    std::vector<PackedDate> days_; // of the former records
};

/// Goes over the former file and the catalogue side by side. The catalogue has all that the file has, in its order, and
/// behind that what is new.
class Copy {
public:
    Copy(FILE* from, FILE* to, const MarketPlan::Owners& changed, const Date& stamp)
        : from_(from), to_(to), changed_(changed), stamp_(stamp)
    {}

    /// From the count of the currencies on. @return whether all has been read and written.
    bool run(const std::vector<Currency*>& currencies)
    {
        copyRecords(
            currencies, [this](const Currency& currency) { copyCurrency(currency); },
            [this](const Currency& currency) { currency.wrt(to_, stamp_); });
        // What stands behind the last record is nothing that a reader asks for, but it is the user's.
        copyRest();
        return !hasFailed_ && std::ferror(from_) == 0 && std::ferror(to_) == 0;
    }

private:
    /// A list of which the first records are in the file, and the others are new.
    template <class Records, class CopyRecord, class WriteRecord>
    void copyRecords(const Records& records, const CopyRecord& copyRecord, const WriteRecord& writeRecord)
    {
        const auto known = std::min(static_cast<std::size_t>(static_cast<unsigned>(freadint(from_))), records.size());
        fwriteint(to_, static_cast<int>(records.size()));
        for (std::size_t i = 0; i < records.size(); ++i)
            if (i < known)
                copyRecord(*records[i]);
            else
                writeRecord(*records[i]);
    }

    void copyCurrency(const Currency& currency)
    {
        Date former;
        former.rd(from_);
        stamp_.wrt(to_);
        copyString();
        copyString();
        copyRecords(
            currency.markets(), [this](const Market& market) { copyMarket(market); },
            [this](const Market& market) { market.wrt(to_); });
        copyQuotes(currency);
    }

    void copyMarket(const Market& market)
    {
        copyString();
        copyRecords(
            market.companies(), [this](const Company& company) { copyCompany(company); },
            [this](const Company& company) { company.wrt(to_); });
    }

    void copyCompany(const Company& company)
    {
        copyString();
        copyString();
        copyQuotes(company);
        for (auto events = copyCount(); events > 0 && !hasFailed_; --events)
            copyEvent();
    }

    template <class Series>
    void copyQuotes(const Series& series)
    {
        const auto former = std::uint64_t{static_cast<unsigned>(freadint(from_))} * Quote::kFileSize;
        if (changed_.contains(&series)) {
            std::string records(former, '\0');
            hasFailed_ = hasFailed_ || std::fread(records.data(), 1, former, from_) != former;
            records = Merge(records, series).records();
            fwriteint(to_, static_cast<int>(records.size() / Quote::kFileSize));
            std::fwrite(records.data(), 1, records.size(), to_);
            return;
        }
        fwriteint(to_, static_cast<int>(former / Quote::kFileSize));
        copyBytes(former);
    }

    void copyEvent()
    {
        const unsigned short type = freadshort(from_);
        fwriteshort(to_, type);
        // An event of any other type has no body.
        if (type == SplitCompanyEvent::kType)
            copyBytes(Date::kFileSize + 2 * sizeof(std::uint16_t));
        if (type == NoteCompanyEvent::kType) {
            copyBytes(Date::kFileSize);
            copyString();
            copyString();
        }
    }

    unsigned copyCount()
    {
        const int count = freadint(from_);
        fwriteint(to_, count);
        return static_cast<unsigned>(count);
    }

    void copyString() { copyBytes(copyCount()); }

    void copyBytes(std::uint64_t missing)
    {
        while (missing > 0 && !hasFailed_) {
            const std::size_t wanted = std::min<std::uint64_t>(missing, sizeof block_);
            const std::size_t got = std::fread(block_, 1, wanted, from_);
            hasFailed_ = got != wanted || std::fwrite(block_, 1, got, to_) != got;
            missing -= got;
        }
    }

    void copyRest()
    {
        while (const std::size_t got = std::fread(block_, 1, sizeof block_, from_))
            std::fwrite(block_, 1, got, to_);
    }

    FILE* from_;
    FILE* to_;
    const MarketPlan::Owners& changed_;
    const Date& stamp_;
    bool hasFailed_ = false; // the file is not the one that was read
    char block_[1 << 16];
};

} // namespace

MarketFile::MarketFile(const std::string& path) : file_(path), stamp_(FileStamp::of(fileno(file_.stream())))
{
    read();
}

/// Not by `Catalogue::rd`: of several currencies with the reference's symbol each would divide the rates of the others,
/// and these are to stay as they stand in the file. The first is the reference here.
void MarketFile::read()
{
    FILE* file = file_.stream();
    const auto readCurrency = [&] {
        auto currency = std::make_unique<Currency>();
        Date stamp;
        if (currency->rd(file, &stamp) != 0)
            return -1;
        if (stamp.isValid())
            latestStamp_ = std::max(latestStamp_, stamp);
        catalogue_.addCurrency(currency.release());
        return 0;
    };
    // A portfolio begins with a date, a market file with the length of a text. A large portfolio could be read a long
    // way before it did not fit.
    Date head;
    head.rd(file);
    std::rewind(file);
    if (head.isValid() || reference_.rd(file) != 0 || readRecords(file, readCurrency) != 0)
        throw std::runtime_error(file_.path() + ": " + faultOfMarketFile(file, printable));
    if (!reference_.isUndefined())
        catalogue_.setReferenceCurrency(catalogue_.getCurrencyByRepresentation(reference_));
}

void MarketFile::save(MarketPlan& plan, const Date& latestDay)
{
    const MarketPlan::Owners changed = plan.carryOut(catalogue_);
    // Values of former days leave the date that later ones have given.
    const Date stamp = std::max(latestDay, latestStamp_);
    const auto writeTo = [&](FILE* to) { return write(to, changed, stamp); };
    const auto result = DurableSave(DataFolder()).save(path(), writeTo, stamp_);
    if (result.outcome != DurableSave::Outcome::kSaved)
        throw std::runtime_error(result.reason);
}

int MarketFile::write(FILE* to, const MarketPlan::Owners& changed, const Date& stamp) const
{
    std::rewind(file_.stream());
    String head;
    head.rd(file_.stream());
    // A file that named no reference gets the one that the import was told of.
    const bool isNamed = !reference_.isUndefined() || catalogue_.getReferenceCurrency() == nullptr;
    (isNamed ? reference_ : catalogue_.getReferenceCurrency()->getRepresentation()).wrt(to);
    return Copy(file_.stream(), to, changed, stamp).run(catalogue_.getCurrencies()) ? 0 : -1;
}
