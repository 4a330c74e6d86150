#include "chart/GraphLine.h"
#include "chart/GraphPoint.h"
#include "chart/GraphPolygon.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <limits>
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
std::vector<GraphPoint*> pointsOf(const Poly& poly)
{
    unsigned count;
    GraphPoint* const* points = poly.getAllGraphPoints(&count);
    return {points, points + count};
}

template <class Poly>
std::vector<float> xsOf(const Poly& poly)
{
    std::vector<float> xs;
    for (const GraphPoint* point : pointsOf(poly))
        xs.push_back(point->getX());
    return xs;
}

TEST(GraphPolyElementTest, LineKeepsItsPointsByXAndPolygonAsTheyWereAdded)
{
    GraphLine line;
    GraphPolygon polygon;
    addAll(line, {3, 1, 2});
    addAll(polygon, {3, 1, 2});
    EXPECT_EQ(xsOf(line), (std::vector<float>{1, 2, 3}));
    pointsOf(line)[0]->setX(2.5F);
    pointsOf(polygon)[1]->setX(9);
    EXPECT_EQ(xsOf(line), (std::vector<float>{2, 2.5F, 3}));
    EXPECT_EQ(xsOf(polygon), (std::vector<float>{3, 9, 2}));
}

TEST(GraphLineTest, SortsByDatesThatCountOnlyAfterTheAddition)
{
    GraphLine line;
    std::vector<GraphPoint*> added;
    for (const short day : {short{30}, short{10}, short{20}}) {
        added.push_back(new GraphPoint(0, day));
        added.back()->setDateX(Date(day, 6, 2001));
        line.addGraphPoint(added.back());
    }
    for (GraphPoint* point : added)
        point->setDateBased(true);
    EXPECT_EQ(pointsOf(line)[0]->getY(), 10);
    EXPECT_EQ(pointsOf(line)[1]->getY(), 20);
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
    const std::vector<GraphPoint*> points = pointsOf(line);
    const auto dated = std::ranges::find_if(points, &GraphPoint::isDateBased);
    EXPECT_EQ(dated - points.begin(), 333) << "numbers come first";
    const auto unordered = std::find_if(points.begin(), dated, [](auto* point) { return std::isnan(point->getX()); });
    EXPECT_EQ(dated - unordered, 48) << "what is no number is last of them";
    const auto isBefore = [](GraphPoint* a, GraphPoint* b) { return a->getX() < b->getX(); };
    EXPECT_TRUE(std::is_sorted(points.begin(), unordered, isBefore));
    const auto isEarlier = [](GraphPoint* a, GraphPoint* b) { return a->getDateX() < b->getDateX(); };
    EXPECT_TRUE(std::is_sorted(dated, points.end(), isEarlier));
}

TEST(GraphPolyElementTest, FindsTheExtremesOfAllPoints)
{
    const auto check = [](auto&& poly, const char* what) {
        SCOPED_TRACE(what);
        EXPECT_EQ(poly.getMaxY(), 0) << "without points";
        EXPECT_EQ(poly.getMinDateX(), Date()) << "without points";
        for (const int day : {14, 3, 25, 9})
            poly.addGraphPoint(datedPoint(Date(static_cast<short>(day), 1, 2002), static_cast<float>(-day)));
        EXPECT_EQ(poly.getMinDateX(), Date(3, 1, 2002));
        EXPECT_EQ(poly.getMaxDateX(), Date(25, 1, 2002));
        EXPECT_EQ(poly.getMinY(), -25);
        EXPECT_EQ(poly.getMaxY(), -3);
        poly.clearAll();
        addAll(poly, {4, -2, 8, 1});
        EXPECT_EQ(poly.getMinX(), -2);
        EXPECT_EQ(poly.getMaxX(), 8);
    };
    check(GraphLine(), "line");
    check(GraphPolygon(), "polygon");
}

TEST(GraphPointTest, BelongsToOneElementWhichOwnsIt)
{
    auto* point = new GraphPoint(1, 1);
    GraphLine line;
    GraphPolygon polygon;
    GraphPolyElement* owner;
    line.addGraphPoint(point);
    point->setGraphPolyElement(&polygon);
    EXPECT_EQ(line.getNbrGraphPoints(), 0U) << "left for the polygon";
    ASSERT_EQ(polygon.getNbrGraphPoints(), 1U);
    EXPECT_EQ(polygon.removeGraphPoint(point), 0);
    EXPECT_EQ(point->getGraphPolyElement(&owner), -1);
    line.addGraphPoint(point); // a leak or a second destruction shows under AddressSanitizer
    EXPECT_EQ(point->getGraphPolyElement(&owner), 0);
    EXPECT_EQ(owner, &line);
}

} // namespace
