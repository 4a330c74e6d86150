#include "foundation/FieldIO.h"
#include "tests/support/Bytes.h"
#include "tests/support/SmallPortfolio.h"

#include <functional>
#include <gtest/gtest.h>
#include <set>

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

template <class AnyQuote>
std::vector<AnyQuote*> byDate(std::vector<AnyQuote*> quotes)
{
    std::ranges::stable_sort(quotes, {}, &AnyQuote::getDate);
    return quotes;
}

template <class Owner>
std::vector<float> answers(const Owner& owner, const Date& day)
{
    return {owner.getRealQuote(day), owner.getPrevisionQuote(day), owner.getPente(), owner.getHighestQuote(),
            owner.getLowestQuote()};
}

/// Whatever has happened to a series, it answers like one that has been filled in date order.
template <class Owner, class AnyQuote>
void changeASeriesAtRandom()
{
    Owner owner;
    std::vector<AnyQuote*> added; // in the order of their addition
    std::mt19937 random(3);
    const auto anyDay = [&random] { return march(static_cast<int>(below(random, 60))); };
    const auto anyValue = [&random] { return static_cast<float>(below(random, 1000)) / 8 - 20; };
    for (int turn = 0; turn < 4000; ++turn) {
        const std::size_t i = added.empty() ? 0 : below(random, added.size());
        const unsigned change = added.size() < below(random, 40) || added.empty() ? 0 : below(random, 4);
        const Date day = anyDay();
        if (change == 0) {
            const auto sorted = byDate(added);
            const auto first = std::ranges::find(sorted, day, &AnyQuote::getDate);
            if (first != sorted.end())
                std::erase(added, *first);
            added.push_back(new AnyQuote(&owner, day, anyValue()));
        } else if (change == 1) {
            delete added[i];
            added.erase(added.begin() + static_cast<std::ptrdiff_t>(i));
        } else if (change == 2)
            added[i]->setDate(day); // often one that is taken
        else
            added[i]->setValue(anyValue());
        if (turn % 2 == 0)
            continue;
        Owner fresh;
        const auto sorted = byDate(added);
        for (const AnyQuote* q : sorted) // each from a day of its own, so that it replaces none
            (new AnyQuote(&fresh, march(1000), q->getValue()))->setDate(q->getDate());
        ASSERT_EQ(all(owner, &Owner::getAllQuotes), sorted) << "turn " << turn;
        ASSERT_EQ(answers(owner, day), answers(fresh, day)) << "turn " << turn;
        AnyQuote* found;
        const auto expected = std::ranges::find(sorted, day, &AnyQuote::getDate);
        ASSERT_EQ(owner.getQuote(day, &found), expected != sorted.end() ? 0 : -1) << "turn " << turn;
        ASSERT_EQ(found, expected != sorted.end() ? *expected : nullptr) << "turn " << turn;
    }
    // Many at once give what one after the other does.
    Owner atOnce;
    Owner oneByOne;
    for (int batch = 0; batch < 5; ++batch) {
        std::vector<DatedValue> values(40);
        for (DatedValue& value : values) {
            value = {anyDay(), anyValue()};
            new AnyQuote(&oneByOne, value.day.date(), value.value);
        }
        atOnce.addQuotes(values);
        ASSERT_EQ(atOnce.quoteRecords(), oneByOne.quoteRecords()) << "batch " << batch;
    }
}

} // namespace

TEST(QuoteSeriesTest, ADayBetweenQuotesKeepsTheLastValueAndOneOutsideExtendsTheLine)
{
    Company company;
    EXPECT_EQ(answers(company, march(1)), std::vector<float>(5, 0.0F));
    EXPECT_TRUE(company.getFirstQuote().isUndefined() && company.getLastQuote().isUndefined());
    new CompanyQuote(&company, march(11), 20);
    for (const int day : {-100, 11, 5000})
        EXPECT_EQ(company.getRealQuote(march(day)), 20) << "a single quote holds for ever";
    new CompanyQuote(&company, march(1), 10);
    new CompanyQuote(&company, march(4), -7);
    const std::pair<int, float> cases[] = {{1, 10},  {2, 10},  {4, -7}, {10, -7},
                                           {11, 20}, {21, 30}, {-9, 0}, {-19, -10}};
    for (const auto& [day, value] : cases)
        EXPECT_EQ(company.getRealQuote(march(day)), value) << "day " << day;
    EXPECT_EQ(company.getHighestQuote(), 20);
    EXPECT_EQ(company.getLowestQuote(), -7);
    EXPECT_TRUE(company.getFirstQuote() == march(1) && company.getLastQuote() == march(11));
    // About the means, day 16/3 and 23/3, xx is 158/3 and xy 238/3.
    EXPECT_FLOAT_EQ(company.getPente(), 238.0F / 158);
    EXPECT_NEAR(company.getPrevisionQuote(march(21)), 23.0 / 3 + 238.0 / 158 * (21 - 16.0 / 3), 1e-5);
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
}

TEST(QuoteSeriesTest, NoTwoStatesOfAnySeriesHaveTheSameRevision)
{
    Company company;
    Currency currency;
    auto* quote = new CompanyQuote(&company, march(1), 1);
    auto* rate = new CurrencyQuote(&currency, march(1), 1);
    std::set<std::uint64_t> seen{Company().revision(), company.revision(), currency.revision()};
    ASSERT_EQ(seen.size(), 3U) << "nor a series that is gone";
    const std::pair<const char*, std::function<void()>> changes[] = {
        {"value", [&] { quote->setValue(2); }},
        {"date", [&] { quote->setDate(march(2)); }},
        {"addition", [&] { new CompanyQuote(&company, march(3), 1); }},
        {"replacement", [&] { new CompanyQuote(&company, march(3), 2); }},
        {"removal", [&] { delete quote; }},
        {"file", [&] { company.rd(BytesFile(written([](FILE* f) { Company().wrt(f); }))); }},
        {"rate", [&] { rate->setValue(2); }},
    };
    for (const auto& [name, change] : changes) {
        change();
        EXPECT_EQ(seen.insert(company.revision()).second, name != std::string("rate")) << name;
        EXPECT_EQ(seen.insert(currency.revision()).second, name == std::string("rate")) << name;
        answers(company, march(5));
        EXPECT_TRUE(seen.contains(company.revision())) << "reading changes nothing: " << name;
    }
}

TEST(QuoteSeriesTest, ChangesLeaveNoTrace)
{
    changeASeriesAtRandom<Company, CompanyQuote>();
    changeASeriesAtRandom<Currency, CurrencyQuote>();
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
        for (Company* company : {&read, &added})
            for (CompanyQuote* quote : all(*company, &Company::getAllQuotes))
                quote->setDate(march(1));
        EXPECT_EQ(dump(read), dump(added)) << count << ", all moved to one day: in the order of addition";
    }
}
