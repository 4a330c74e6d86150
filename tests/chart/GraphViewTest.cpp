// Run by the program of tests that have an application object, on the platform without a screen.

#include "chart/GraphView.h"
#include "chart/GraphLine.h"
#include "chart/GraphPoint.h"
#include "chart/GraphPolygon.h"

#include <gtest/gtest.h>

#include <QImage>
#include <QWidget>

#include <limits>
#include <vector>

namespace {

constexpr rgb_color kBackground{10, 120, 30, 0};
constexpr rgb_color kColor{200, 20, 60, 0};

class GraphViewTest : public testing::Test {
protected:
    GraphViewTest()
    {
        view_.setBackgroundColor(kBackground);
        line_.setColor(kColor);
        band_.setColor({kColor.red, kColor.green, kColor.blue, 127});
        view_.addGraphElement(&band_);
        view_.addGraphElement(&line_);
    }

    static void fill(GraphPolyElement& element, std::initializer_list<BPoint> points)
    {
        for (const BPoint& p : points)
            element.addGraphPoint(new GraphPoint(p.x, p.y));
    }

    QImage image() { return view_.widget()->grab().toImage(); }

    /// The colour at a place of the chart's data.
    QColor colorAt(const QImage& image, double x, double y) const
    {
        const BPoint p = view_.scale()->pixel({x, y});
        return image.pixelColor(static_cast<int>(p.x), static_cast<int>(p.y));
    }

    GraphLine line_;
    GraphPolygon band_;
    GraphView view_{BRect(0, 0, 300, 200), "chart"};
};

TEST_F(GraphViewTest, OwnsAndRemovesOnlyPointsThatStandAlone)
{
    for (int i = 0; i < 3; ++i)
        view_.addGraphElement(new GraphPoint(1, 1)); // a leak shows under AddressSanitizer
    {
        GraphLine behind;
        view_.addGraphElement(&behind);
        view_.removeAllGraphPoints();
        unsigned count;
        GraphElement* const* elements = view_.getAllGraphElements(&count);
        EXPECT_EQ(std::vector(elements, elements + count), (std::vector<GraphElement*>{&band_, &line_, &behind}));
    }
    EXPECT_EQ(view_.getNbrGraphElements(), 2U);
    GraphView* shownBy;
    {
        GraphView other(BRect(0, 0, 10, 10), "other");
        line_.setGraphView(&other);
        EXPECT_EQ(view_.getNbrGraphElements(), 1U) << "left for the other chart";
        other.addGraphElement(new GraphPoint(1, 1));
    }
    EXPECT_EQ(line_.getGraphView(&shownBy), -1);
}

TEST_F(GraphViewTest, SaysThatThereIsNoDataAndNothingElse)
{
    constexpr float kInfinite = std::numeric_limits<float>::infinity();
    const struct {
        std::initializer_list<BPoint> points;
        const char* why;
    } cases[] = {{{}, "nothing"}, {{{1, 1}}, "too few points"}, {{{1, kInfinite}, {2, kInfinite}}, "no place"}};
    view_.setXLegend("Value in EUR");
    for (const auto& c : cases) {
        line_.clearAll();
        fill(line_, c.points);
        view_.Invalidate();
        const QImage drawn = image();
        const QRect text(10, 5, 70, 20);
        const QColor background(kBackground.red, kBackground.green, kBackground.blue);
        int drawnPixels = 0;
        for (int y = 0; y < drawn.height(); ++y)
            for (int x = 0; x < drawn.width(); ++x) {
                if (drawn.pixelColor(x, y) == background)
                    continue;
                ++drawnPixels;
                ASSERT_TRUE(text.contains(x, y)) << c.why << ": " << x << ", " << y;
            }
        EXPECT_GT(drawnPixels, 0) << c.why;
        EXPECT_EQ(view_.scale(), nullptr) << c.why;
    }
}

TEST_F(GraphViewTest, CoversWithAlpha0AndLetsShineThroughBetween)
{
    fill(line_, {{0, 1}, {10, 1}});
    fill(band_, {{0, 0}, {10, 0}, {10, 3}, {0, 3}});
    const QImage drawn = image();
    EXPECT_EQ(colorAt(drawn, 6.5, 1), QColor(kColor.red, kColor.green, kColor.blue)) << "the line is in front";
    const QColor mixed = colorAt(drawn, 6.5, 2.2);
    EXPECT_NEAR(mixed.red(), (kColor.red + kBackground.red) / 2, 2);
    EXPECT_NEAR(mixed.green(), (kColor.green + kBackground.green) / 2, 2);
    band_.setColor(kColor);
    view_.Invalidate();
    EXPECT_EQ(colorAt(image(), 6.5, 2.2), QColor(kColor.red, kColor.green, kColor.blue));
}

TEST_F(GraphViewTest, LaterElementsCoverEarlierOnesWhateverTheyAre)
{
    GraphPolygon cover;
    cover.setColor({0, 255, 0, 255});
    view_.addGraphElement(&cover);
    auto* point = new GraphPoint(8, 1);
    point->setColor(kColor);
    view_.addGraphElement(point);
    fill(line_, {{0, 0}, {2, 1}, {10, 1}});
    fill(cover, {{5, 0.5}, {10, 0.5}, {10, 3}, {5, 3}});
    const QImage drawn = image();
    const QColor color(kColor.red, kColor.green, kColor.blue);
    EXPECT_EQ(colorAt(drawn, 4, 1), color);
    EXPECT_EQ(colorAt(drawn, 6.5, 1), QColor(0, 255, 0)) << "the polygon came after the line";
    EXPECT_EQ(colorAt(drawn, 8, 1), color) << "and the point after the polygon";
}

} // namespace
