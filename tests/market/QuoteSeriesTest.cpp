#include "foundation/FieldIO.h"
#include "market/Company.h"
#include "market/Currency.h"
#include "tests/support/Bytes.h"

#include <gtest/gtest.h>
#include <random>

namespace {

/// The day of March 1999, or so many days before or after that month.
Date march(int day)
{
    return Date(1, 3, 1999).moveBy(day - 1);
}

template <class Owner>
std::string dump(const Owner& owner)
{
    std::string result;
    for (unsigned i = 0; i < owner.getNbrQuotes(); ++i)
        result += std::to_string(owner.getQuote(i)->getDate() - march(0)) + ":" +
                  std::to_string(static_cast<int>(owner.getQuote(i)->getValue())) + " ";
    return result;
}

/// Quotes in the order of their addition; the answers are found by walking over them.
template <class AnyQuote>
struct PlainSeries {
    std::vector<AnyQuote*> added;

    std::vector<AnyQuote*> byDate() const
    {
        std::vector<AnyQuote*> sorted(added);
        std::stable_sort(sorted.begin(), sorted.end(),
                         [](const AnyQuote* a, const AnyQuote* b) { return a->getDate() < b->getDate(); });
        return sorted;
    }

    AnyQuote* at(const Date& d) const
    {
        for (AnyQuote* q : byDate())
            if (q->getDate() == d)
                return q;
        return nullptr;
    }

    float realQuote(const Date& d) const
    {
        if (added.empty() || at(d) != nullptr)
            return added.empty() ? 0 : at(d)->getValue();
        const std::vector<AnyQuote*> quotes = byDate();
        const AnyQuote *first = quotes.front(), *last = quotes.back(), *before = nullptr;
        for (const AnyQuote* q : quotes)
            if (q->getDate() < d)
                before = q;
        const AnyQuote* nearest = before == nullptr ? first : before;
        const int span = last->getDate() - first->getDate();
        if ((before != nullptr && before != last) || span == 0)
            return nearest->getValue();
        const double rise = static_cast<double>(last->getValue()) - first->getValue();
        return static_cast<float>(nearest->getValue() + static_cast<double>(d - nearest->getDate()) / span * rise);
    }

    /// The least-squares line's value on day `d`, from sums about the means.
    double trend(const Date& d) const
    {
        double meanX = 0, meanY = 0, sumXX = 0, sumXY = 0;
        for (const AnyQuote* q : added) {
            meanX += (q->getDate() - d) / static_cast<double>(added.size());
            meanY += q->getValue() / static_cast<double>(added.size());
        }
        for (const AnyQuote* q : added) {
            const double x = q->getDate() - d - meanX;
            sumXX += x * x;
            sumXY += x * (q->getValue() - meanY);
        }
        return sumXX < 1e-6 ? 0 : meanY - sumXY / sumXX * meanX; // a single day has no trend
    }
};

template <class Owner, class AnyQuote>
void compareRandomSeriesWithAPlainOne()
{
    Owner owner;
    PlainSeries<AnyQuote> plain;
    std::mt19937 random(3);
    const auto below = [&random](std::size_t n) { return random() % n; };
    const auto anyDay = [&below] { return march(static_cast<int>(below(60))); };
    const auto anyValue = [&below] { return static_cast<float>(below(1000)) / 8 - 20; };
    for (int turn = 0; turn < 4000; ++turn) {
        const std::size_t i = plain.added.empty() ? 0 : below(plain.added.size());
        const std::size_t change = plain.added.size() < below(40) ? 0 : below(4);
        if (change == 0 || plain.added.empty()) {
            const Date day = anyDay();
            std::erase(plain.added, plain.at(day));
            plain.added.push_back(new AnyQuote(&owner, day, anyValue()));
        } else if (change == 1) {
            delete plain.added[i];
            plain.added.erase(plain.added.begin() + static_cast<std::ptrdiff_t>(i));
        } else if (change == 2)
            plain.added[i]->setDate(anyDay()); // often one that is taken
        else
            plain.added[i]->setValue(anyValue());
        if (turn % 2 == 0)
            continue;
        unsigned n;
        AnyQuote** quotes = owner.getAllQuotes(&n);
        ASSERT_EQ(std::vector<AnyQuote*>(quotes, quotes + n), plain.byDate()) << "turn " << turn;
        const Date day = anyDay();
        AnyQuote* found;
        ASSERT_EQ(owner.getQuote(day, &found), plain.at(day) != nullptr ? 0 : -1) << "turn " << turn;
        ASSERT_EQ(found, plain.at(day)) << "turn " << turn;
        ASSERT_EQ(owner.getRealQuote(day), plain.realQuote(day)) << "turn " << turn;
        ASSERT_NEAR(owner.getPrevisionQuote(day), plain.trend(day), 1e-3) << "turn " << turn;
        ASSERT_NEAR(owner.getPente(), plain.trend(march(1)) - plain.trend(march(0)), 1e-4) << "turn " << turn;
    }
}

} // namespace

TEST(QuoteSeriesTest, ADayBetweenQuotesKeepsTheLastValueAndOneOutsideExtendsTheLine)
{
    Company company;
    EXPECT_EQ(company.getRealQuote(march(1)), 0);
    EXPECT_TRUE(company.getFirstQuote().isUndefined() && company.getLastQuote().isUndefined());
    EXPECT_EQ(company.getHighestQuote(), 0);
    EXPECT_EQ(company.getLowestQuote(), 0);
    EXPECT_EQ(company.getPrevisionQuote(march(1)), 0);

    new CompanyQuote(&company, march(11), 20);
    for (const int day : {-100, 11, 5000})
        EXPECT_EQ(company.getRealQuote(march(day)), 20) << "a single quote holds for ever";
    new CompanyQuote(&company, march(1), 10);
    const std::pair<int, float> cases[] = {{1, 10},  {2, 10},  {6, 10}, {10, 10},
                                           {11, 20}, {21, 30}, {-9, 0}, {-19, -10}};
    for (const auto& [day, value] : cases)
        EXPECT_EQ(company.getRealQuote(march(day)), value) << "day " << day;
    new CompanyQuote(&company, march(4), -7);
    EXPECT_EQ(company.getRealQuote(march(5)), -7);
    EXPECT_EQ(company.getRealQuote(march(21)), 30) << "still through the first and the last";
    EXPECT_EQ(company.getHighestQuote(), 20);
    EXPECT_EQ(company.getLowestQuote(), -7);
    EXPECT_TRUE(company.getFirstQuote() == march(1) && company.getLastQuote() == march(11));
}

TEST(QuoteSeriesTest, AnAddedQuoteReplacesTheFirstOneOfItsDay)
{
    Company company, other;
    auto* a = new CompanyQuote(&company, march(1), 1);
    EXPECT_EQ(company.addQuote(a), 0) << "itself it does not replace";
    new CompanyQuote(&company, march(1), 2);
    EXPECT_EQ(dump(company), "1:2 ");
    auto* c = new CompanyQuote(&other, march(1), 3);
    EXPECT_EQ(company.addQuote(c), 0) << "from another company";
    auto* d = new CompanyQuote(&company, march(2), 4);
    EXPECT_EQ(dump(company) + "| " + dump(other), "1:3 2:4 | ");
    d->setDate(march(1));
    EXPECT_EQ(dump(company), "1:3 1:4 ") << "a changed date replaces nothing";
    for (const auto& [day, value] : {std::pair(0, 3), {1, 3}, {2, 4}})
        EXPECT_EQ(company.getRealQuote(march(day)), static_cast<float>(value)) << "no line in one day: " << day;
    auto* e = new CompanyQuote(&other, march(1), 5);
    EXPECT_EQ(e->setCompany(&company), 0);
    EXPECT_EQ(dump(company) + "| " + dump(other), "1:4 1:5 | ");
    EXPECT_EQ(company.removeQuote(d), 0);
    EXPECT_EQ(dump(company), "1:5 ");
    delete d;
}

TEST(QuoteSeriesTest, RandomSeriesAnswerLikePlainOnes)
{
    compareRandomSeriesWithAPlainOne<Company, CompanyQuote>();
    compareRandomSeriesWithAPlainOne<Currency, CurrencyQuote>();
}

TEST(QuoteSeriesTest, AFileInAnyOrderReadsLikeOneAdditionAfterTheOther)
{
    std::mt19937 random(7);
    const std::pair<unsigned, unsigned> sizes[] = {{0, 1}, {2, 1}, {40, 15}, {40, 400}, {5000, 900}, {5000, 90'000}};
    for (const auto& [count, days] : sizes) {
        Company read, added;
        const std::string quotes = written([&, n = count, range = days](FILE* file) {
            for (unsigned i = 0; i < n; ++i) { // runs in order, with quotes between that come late
                const Date day = march(static_cast<int>(random() % 3 == 0 ? random() % range : i * range / n));
                (new CompanyQuote(&added, day, static_cast<float>(i)))->wrt(file);
            }
        });
        const std::string number = written([n = count](FILE* file) { fwriteint(file, static_cast<int>(n)); });
        EXPECT_EQ(read.rd(BytesFile(std::string(8, '\0') + number + quotes + std::string(4, '\0'))), 0) << count;
        EXPECT_EQ(dump(read), dump(added)) << count;
        EXPECT_EQ(read.getPente(), added.getPente()) << count;
        for (Company* company : {&read, &added}) {
            unsigned n;
            CompanyQuote** all = company->getAllQuotes(&n);
            for (unsigned i = 0; i < n; ++i)
                all[i]->setDate(march(1));
        }
        EXPECT_EQ(dump(read), dump(added)) << count << ", all moved to one day: in the order of addition";
    }
}
