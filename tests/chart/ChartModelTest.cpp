#include "chart/GraphLine.h"
#include "chart/GraphPoint.h"
#include "chart/GraphPolygon.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <initializer_list>
#include <limits>
#include <memory>
#include <vector>

namespace {

constexpr float kNaN = std::numeric_limits<float>::quiet_NaN();

GraphPoint* datedPoint(const Date& date, float y)
{
    auto* point = new GraphPoint(0, y);
    point->setDateBased(true);
    point->setDateX(date);
    return point;
}

template <class Poly>
void addAll(Poly& poly, const std::vector<float>& xs)
{
    for (const float x : xs)
        poly.addGraphPoint(new GraphPoint(x, 10 * x));
}

template <class Poly>
std::vector<float> xsOf(const Poly& poly)
{
    unsigned count;
    GraphPoint* const* points = poly.getAllGraphPoints(&count);
    std::vector<float> xs;
    for (unsigned i = 0; i < count; ++i)
        xs.push_back(points[i]->getX());
    return xs;
}

TEST(GraphElementTest, IsUndefinedUntilThereIsEnoughToDraw)
{
    GraphLine line;
    GraphPolygon polygon;
    for (unsigned count = 0; count < 4; ++count) {
        EXPECT_EQ(line.isUndefined(), count < 2) << count;
        EXPECT_EQ(polygon.isUndefined(), count < 3) << count;
        addAll(line, {1});
        addAll(polygon, {1});
    }
    EXPECT_FALSE(GraphPoint().isUndefined());
}

TEST(GraphLineTest, KeepsItsPointsByX)
{
    GraphLine line;
    addAll(line, {3, 1, 2});
    EXPECT_EQ(xsOf(line), (std::vector<float>{1, 2, 3}));
    unsigned count;
    line.getAllGraphPoints(&count)[0]->setX(2.5F);
    EXPECT_EQ(xsOf(line), (std::vector<float>{2, 2.5F, 3}));
}

TEST(GraphLineTest, SortsByDatesThatCountOnlyAfterTheAddition)
{
    GraphLine line;
    std::vector<GraphPoint*> added;
    for (const short day : std::initializer_list<short>{30, 10, 20}) {
        added.push_back(new GraphPoint(0, day));
        added.back()->setDateX(Date(day, 6, 2001));
        line.addGraphPoint(added.back());
    }
    for (GraphPoint* point : added)
        point->setDateBased(true);
    unsigned count;
    GraphPoint* const* points = line.getAllGraphPoints(&count);
    EXPECT_EQ(points[0]->getY(), 10);
    EXPECT_EQ(points[1]->getY(), 20);
    EXPECT_EQ(line.getMinDateX(), Date(10, 6, 2001));
    EXPECT_EQ(line.getMaxDateX(), Date(30, 6, 2001));
}

TEST(GraphLineTest, PutsPointsThatHaveNoOrderInOne)
{
    GraphLine line; // long enough for a sort that trusts its comparison to leave the array
    for (int i = 0; i < 500; ++i) {
        if (i % 3 == 0)
            line.addGraphPoint(datedPoint(Date(static_cast<short>(28 - i % 28), 2, 1999), 0));
        else
            line.addGraphPoint(new GraphPoint(i % 7 == 0 ? kNaN : static_cast<float>(-i), 0));
    }
    unsigned count;
    GraphPoint* const* points = line.getAllGraphPoints(&count);
    ASSERT_EQ(count, 500U);
    EXPECT_TRUE(
        std::is_sorted(points, points + count, [](GraphPoint* a, GraphPoint* b) { return sortPointsByX(&a, &b) < 0; }));
    const auto isDated = [](const GraphPoint* point) { return point->isDateBased(); };
    EXPECT_TRUE(std::none_of(points, points + 333, isDated)) << "numbers come first";
}

TEST(GraphPolygonTest, KeepsTheOrderOfAddition)
{
    GraphPolygon polygon;
    addAll(polygon, {3, 1, 2});
    unsigned count;
    polygon.getAllGraphPoints(&count)[1]->setX(9);
    EXPECT_EQ(xsOf(polygon), (std::vector<float>{3, 9, 2}));
}

TEST(GraphPolyElementTest, FindsTheExtremesOfAllPoints)
{
    const auto check = [](auto&& poly, const char* what) {
        EXPECT_EQ(poly.getMaxY(), 0) << what << " without points";
        EXPECT_EQ(poly.getMinY(), 0) << what << " without points";
        EXPECT_EQ(poly.getMinDateX(), Date()) << what << " without points";
        EXPECT_EQ(poly.getMaxDateX(), Date()) << what << " without points";
        for (const short day : std::initializer_list<short>{14, 3, 25, 9})
            poly.addGraphPoint(datedPoint(Date(day, 1, 2002), static_cast<float>(-day)));
        EXPECT_EQ(poly.getMinDateX(), Date(3, 1, 2002)) << what;
        EXPECT_EQ(poly.getMaxDateX(), Date(25, 1, 2002)) << what;
        EXPECT_EQ(poly.getMinY(), -25) << what;
        EXPECT_EQ(poly.getMaxY(), -3) << what;
        poly.clearAll();
        addAll(poly, {4, -2, 8, 1});
        EXPECT_EQ(poly.getMinX(), -2) << what;
        EXPECT_EQ(poly.getMaxX(), 8) << what;
    };
    check(GraphLine(), "line");
    check(GraphPolygon(), "polygon");
}

TEST(GraphPointTest, BelongsToOneElementWhichOwnsIt)
{
    auto* point = new GraphPoint(1, 1);
    GraphPolyElement* owner;
    {
        GraphLine line;
        GraphPolygon polygon;
        line.addGraphPoint(point);
        point->setGraphPolyElement(&polygon);
        EXPECT_EQ(line.getNbrGraphPoints(), 0U) << "left for the polygon";
        ASSERT_EQ(polygon.getNbrGraphPoints(), 1U);
        EXPECT_EQ(polygon.removeGraphPoint(point), 0);
        EXPECT_EQ(point->getGraphPolyElement(&owner), -1);
        line.addGraphPoint(point);
        EXPECT_EQ(point->getGraphPolyElement(&owner), 0);
        EXPECT_EQ(owner, &line);
        EXPECT_EQ(line.addGraphPoint(nullptr), -1);
        line.clearAll();
        EXPECT_EQ(line.getNbrGraphPoints(), 0U);
    } // a leak or a second destruction shows under AddressSanitizer
}

TEST(GraphPointTest, ComparesDatesWithDatesAndNumbersWithNumbers)
{
    const std::unique_ptr<GraphPoint> early(datedPoint(Date(31, 12, 1999), 0));
    const std::unique_ptr<GraphPoint> late(datedPoint(Date(1, 1, 2000), 0));
    const auto low = std::make_unique<GraphPoint>(-1.0F, 0.0F);
    const auto high = std::make_unique<GraphPoint>(1.0F, 0.0F);
    const auto none = std::make_unique<GraphPoint>(kNaN, 0.0F);
    const struct {
        GraphPoint* a;
        GraphPoint* b;
        int order;
        const char* why;
    } cases[] = {
        {early.get(), late.get(), -1, "earlier day"},
        {late.get(), early.get(), 1, "later day"},
        {late.get(), late.get(), 0, "same day"},
        {low.get(), high.get(), -1, "smaller number"},
        {high.get(), low.get(), 1, "greater number"},
        {early.get(), high.get(), 0, "date and number"},
        {high.get(), none.get(), -1, "not a number is last"},
        {none.get(), low.get(), 1, "not a number is last"},
    };
    for (const auto& c : cases)
        EXPECT_EQ(sortPointsByX(&c.a, &c.b), c.order) << c.why;
}

} // namespace
