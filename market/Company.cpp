#include "market/Company.h"

#include "foundation/FieldIO.h"
#include "market/CompanyEvent.h"
#include "market/Market.h"
#include "market/NoteCompanyEvent.h"
#include "market/SplitCompanyEvent.h"

#include <memory>

namespace {

/// An empty event of the file's type code; null for a code that no writer produces.
std::unique_ptr<CompanyEvent> makeEvent(unsigned short type)
{
    if (type == NoteCompanyEvent::kType)
        return std::make_unique<NoteCompanyEvent>();
    if (type == SplitCompanyEvent::kType)
        return std::make_unique<SplitCompanyEvent>();
    return nullptr;
}

} // namespace

Company::Company() : QuoteSeries(this), shares_(this), events_(this) {}

Company::Company(Market* market, const String& name, const String& abbreviation) : Company()
{
    name_ = name;
    abbreviation_ = abbreviation;
    setMarket(market);
}

Company::~Company()
{
    // Everything that the company owns unlinks itself from these lists, so they are emptied while the company is still
    // whole. The market lists the company until the last line.
    shares_.deleteAll();
    deleteQuotes();
    events_.deleteAll();
    setMarket(nullptr);
}

int Company::wrt(FILE* file) const
{
    name_.wrt(file);
    abbreviation_.wrt(file);
    return writeQuotes(file) == 0 ? writeEvents(file) : -1;
}

int Company::writeEvents(FILE* file) const
{
    fwriteint(file, static_cast<int>(getNbrEvents()));
    for (const CompanyEvent* event : events()) {
        fwriteshort(file, static_cast<unsigned short>(event->getType()));
        if (event->wrt(file) != 0)
            return -1;
    }
    return 0;
}

int Company::rd(FILE* file)
{
    // What was read before an error stays: the caller decides whether the company is worth keeping.
    if (name_.rd(file) != 0 || abbreviation_.rd(file) != 0 || readQuotes(file) != 0)
        return -1;
    return readEvents(file);
}

int Company::readEvents(FILE* file)
{
    auto missing = static_cast<unsigned>(freadint(file));
    for (; missing > 0 && !reachedEnd(file); --missing) {
        std::unique_ptr<CompanyEvent> event = makeEvent(freadshort(file));
        // Intended: the record behind an unknown type has no known length, so reading goes on right after the type.
        if (event == nullptr)
            continue;
        if (event->rd(file) != 0)
            return -1;
        // Only an event that was read whole is linked; the company owns it from here on.
        event.release()->setCompany(this);
    }
    return reachedEnd(file) ? -1 : 0;
}

const String& Company::getCurrencyRepresentation() const
{
    const Market* market = market_.partner();
    return market != nullptr ? market->getCurrencyRepresentation() : String::none();
}

int Company::setMarket(Market* market)
{
    return market_.set(this, market);
}
