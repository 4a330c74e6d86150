#include "chart/GraphLine.h"
#include "chart/GraphPoint.h"
#include "chart/GraphPolygon.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <limits>
#include <vector>

namespace {

GraphPoint* datedPoint(const Date& date, float y)
{
    auto* point = new GraphPoint(0, y);
    point->setDateBased(true);
    point->setDateX(date);
    return point;
}

template <class Poly>
std::vector<GraphPoint*> pointsOf(const Poly& poly)
{
    unsigned count;
    GraphPoint* const* points = poly.getAllGraphPoints(&count);
    return {points, points + count};
}

TEST(GraphPolyElementTest, LineKeepsItsPointsByXAndPolygonAsTheyWereAddedAndBothKnowTheirExtremes)
{
    const auto check = [](auto&& poly, const std::vector<float>& first, const std::vector<float>& then) {
        const auto xs = [&poly] {
            std::vector<float> found;
            for (const GraphPoint* point : pointsOf(poly))
                found.push_back(point->getX());
            return found;
        };
        EXPECT_EQ(poly.getMaxY(), 0) << "without points";
        EXPECT_EQ(poly.getMinDateX(), Date()) << "without points";
        std::vector<GraphPoint*> added;
        for (const float x : {3.0F, 1.0F, 2.0F}) {
            added.push_back(new GraphPoint(x, -10 * x));
            poly.addGraphPoint(added.back());
        }
        EXPECT_EQ(xs(), first);
        added[1]->setX(2.5F);
        EXPECT_EQ(xs(), then);
        EXPECT_TRUE(poly.getMinX() == 2 && poly.getMaxX() == 3 && poly.getMinY() == -30 && poly.getMaxY() == -10);
        poly.clearAll();
        for (const int day : {14, 3, 25, 9})
            poly.addGraphPoint(datedPoint(Date(static_cast<short>(day), 1, 2002), 0));
        EXPECT_EQ(poly.getMinDateX(), Date(3, 1, 2002));
        EXPECT_EQ(poly.getMaxDateX(), Date(25, 1, 2002));
    };
    check(GraphLine(), {1, 2, 3}, {2, 2.5F, 3});
    check(GraphPolygon(), {3, 1, 2}, {3, 2.5F, 2});
}

TEST(GraphLineTest, PutsPointsThatHaveNoOrderInOne)
{
    GraphLine line; // long enough for a sort that trusts its comparison to leave the array
    for (int i = 0; i < 500; ++i) {
        if (i % 3 == 0) { // dates count only after the addition
            auto* point = new GraphPoint(0, 0);
            line.addGraphPoint(point);
            point->setDateX(Date(static_cast<short>(28 - i % 28), 2, 1999));
            point->setDateBased(true);
        } else
            line.addGraphPoint(
                new GraphPoint(i % 7 == 0 ? std::numeric_limits<float>::quiet_NaN() : static_cast<float>(-i), 0));
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
