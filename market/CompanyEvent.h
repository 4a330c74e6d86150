#pragma once

#include "foundation/Date.h"
#include "foundation/Serializable.h"
#include "market/MarketLinks.h"

/// Something that happened to a company on a day; shown, but without effect on quotes or valuations.
class CompanyEvent : public Serializable {
public:
    virtual ~CompanyEvent();

    /// The code that stands before the event's record in the file: 1 split, 2 note.
    virtual short getType() const = 0;

    const Date& getDate() const { return date_; }
    /// Moves the event to another day of its company. @return 0; -1, with the old date, when the company would not
    /// let go of it; -1 when it would not take it back.
    int setDate(const Date& date);

    int getCompany(Company** out) const { return company_.get(out); }
    /// The same; null when there is none.
    Company* company() const { return company_.partner(); }
    int setCompany(Company* company);

protected:
    CompanyEvent() = default;
    CompanyEvent(Company* company, const Date& date);

private:
    friend class CompanyToEvents;

    CompanyEventsToCompany company_;
    Date date_;
};
