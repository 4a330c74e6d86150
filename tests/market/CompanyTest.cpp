#include "market/Company.h"
#include "market/SplitCompanyEvent.h"

#include <gtest/gtest.h>

TEST(CompanyTest, AnEventThatChangesItsDayStaysWithItsCompanyAndComesLast)
{
    Company company;
    auto* first = new SplitCompanyEvent(&company, Date(3, 5, 1999), 2, 1);
    auto* second = new SplitCompanyEvent(&company, Date(4, 5, 1999), 3, 1);
    SplitCompanyEvent alone(nullptr, Date(3, 5, 1999), 2, 1);
    for (SplitCompanyEvent* event : {first, &alone}) {
        EXPECT_EQ(event->setDate(Date(5, 5, 1999)), 0);
        EXPECT_EQ(event->getDate(), Date(5, 5, 1999));
    }
    unsigned n;
    CompanyEvent** events = company.getAllEvents(&n);
    EXPECT_EQ(std::vector<CompanyEvent*>(events, events + n), (std::vector<CompanyEvent*>{second, first}));
    Company* linked;
    EXPECT_EQ(first->getCompany(&linked), 0);
    EXPECT_EQ(alone.getCompany(&linked), -1);
}
