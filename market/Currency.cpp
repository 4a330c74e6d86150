#include "market/Currency.h"

#include "market/Market.h"
#include "market/RecordList.h"

#include <memory>

Currency::Currency() : QuoteSeries(this), accounts_(this), markets_(this) {}

Currency::Currency(const String& name, const String& representation, Currency* reference) : Currency()
{
    name_ = name;
    representation_ = representation;
    reference_ = reference;
}

Currency::~Currency()
{
    // Accounts belong to the wallet and stay, without a currency. Rates and markets are the currency's own and go.
    accounts_.unlinkAll();
    deleteQuotes();
    markets_.deleteAll();
}

int Currency::wrt(FILE* file, const Date& stamp) const
{
    // Only the last line asks whether the writes have come about: a field that fails leaves its mark on the file.
    stamp.wrt(file);
    name_.wrt(file);
    representation_.wrt(file);
    return writeRecords(file, markets()) == 0 && writeQuotes(file) == 0 && std::ferror(file) == 0 ? 0 : -1;
}

int Currency::rd(FILE* file, Date* stamp)
{
    Date date;
    date.rd(file);
    // A date that is cut short needs no check of its own, since the name behind it cannot be read then.
    if (stamp != nullptr)
        *stamp = date;
    // The rates come last: a record that ends before them leaves a currency with names and markets.
    if (name_.rd(file) != 0 || representation_.rd(file) != 0 || readMarkets(file) != 0)
        return -1;
    return readQuotes(file);
}

int Currency::readMarkets(FILE* file)
{
    return readRecords(file, [&] {
        auto market = std::make_unique<Market>();
        const int result = market->rd(file);
        // A market cut short stays for the sake of the companies in it that are whole.
        if (result == 0 || market->getNbrCompanies() > 0)
            market.release()->setCurrency(this);
        return result;
    });
}

int Currency::setReferenceCurrency(Currency* reference)
{
    // The rates stay as they are: `Catalogue::rebaseOn` divides them, where they are to mean something else.
    reference_ = reference;
    return 0;
}

int Currency::getReferenceCurrency(Currency** out)
{
    // A currency that was given no reference is its own.
    *out = reference_ != nullptr ? reference_ : this;
    return 0;
}
