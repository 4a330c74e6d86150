#include "chart/ChartZoom.h"
#include "chart/ChartDrag.h"
#include "chart/DateTicks.h"

#include <gtest/gtest.h>

namespace {

constexpr ChartRange kData{100, 200};
constexpr double kLeast = 4;

TEST(ChartZoomTest, StaysWithinTheDataAndAboveTheLeastLength)
{
    const struct {
        const char* what;
        ChartRange asked;
        double around, factor; // of a zoom; 0 for none
        double pan;
        ChartRange shown;
    } cases[] = {
        {"nothing", kData, 0, 0, 0, kData},
        {"in, around a point", kData, 120, 0.5, 0, {110, 160}},
        {"and out again", {110, 160}, 120, 2, 0, kData},
        {"out at an end", {100, 120}, 110, 2, 0, {100, 130}},
        {"in, too far", kData, 150, 1e-9, 0, {148, 152}},
        {"in, outside", kData, 999, 0.5, 0, {150, 200}},
        {"a part that is too short", {120, 121}, 0, 0, 0, {118.5, 122.5}},
        {"one at the end", {200, 200}, 0, 0, 0, {196, 200}},
        {"pan", {110, 120}, 0, 0, 30, {140, 150}},
        {"pan too far", {110, 120}, 0, 0, -30, {100, 110}},
    };
    for (const auto& c : cases) {
        ChartZoom zoom;
        zoom.setBounds(kData, kLeast);
        zoom.show(c.asked);
        if (c.factor > 0)
            zoom.zoom(c.around, c.factor);
        zoom.pan(c.pan);
        EXPECT_DOUBLE_EQ(zoom.shown().min, c.shown.min) << c.what;
        EXPECT_DOUBLE_EQ(zoom.shown().max, c.shown.max) << c.what;
        zoom.showAll();
        EXPECT_EQ(zoom.shown(), kData) << c.what << ", and all again";
    }
}

TEST(ChartZoomTest, KeepsItsRangeWhileTheDataChanges)
{
    const struct {
        const char* what;
        ChartRange asked, bounds, shown;
    } cases[] = {
        {"days in the middle stay", {120, 150}, {90, 250}, {120, 150}},
        {"an end of the data goes on being the end", {150, 200}, {100, 201}, {150, 201}},
        {"so does the beginning", {100, 150}, {50, 200}, {50, 150}},
        {"as much as there is", {120, 150}, {130, 250}, {130, 150}},
        {"nothing of it: all", {120, 150}, {300, 400}, {300, 400}},
        {"next to nothing of it: all", {120, 150}, {149, 400}, {149, 400}},
    };
    for (const auto& c : cases) {
        ChartZoom zoom;
        zoom.setBounds(kData, kLeast);
        zoom.show(c.asked);
        zoom.setBounds(c.bounds, kLeast);
        EXPECT_EQ(zoom.shown(), c.shown) << c.what;
        zoom.setBounds(kData, kLeast);
        EXPECT_EQ(zoom.shown(), c.asked) << c.what << ", and it is back";
    }
}

TEST(ChartZoomTest, MonthsEndAtTheLastDay)
{
    const auto day = [](short d, short m, int y) { return dayNumber(Date(d, m, y)); };
    ChartZoom zoom;
    zoom.showLast(1);
    zoom.setBounds({day(1, 1, 2020), day(31, 3, 2024)}, kLeast);
    EXPECT_EQ(zoom.shown(), (ChartRange{day(29, 2, 2024), day(31, 3, 2024)})) << "a shorter month";
    zoom.setBounds({day(1, 1, 2020), day(2, 4, 2024)}, kLeast);
    EXPECT_EQ(zoom.shown(), (ChartRange{day(2, 3, 2024), day(2, 4, 2024)})) << "it moves along";
    zoom.showLast(60);
    EXPECT_TRUE(zoom.isAll());
    EXPECT_EQ(zoom.lastMonths(), 60);
    zoom.pan(-1);
    EXPECT_EQ(zoom.lastMonths(), 60) << "there is nowhere to go";
    zoom.setBounds({day(1, 1, 1), day(2, 4, 1)}, kLeast);
    EXPECT_TRUE(zoom.isAll()) << "the first year";
}

TEST(ChartDragTest, PansFromWhereItBegan)
{
    ChartZoom zoom;
    zoom.setBounds(kData, kLeast);
    zoom.show({120, 140});
    ChartDrag pan(ChartDrag::Kind::kPan, {50, 0}, ChartScale({120, 140}, {0, 1}, {0, 0, 100, 100}), zoom.shown());
    for (const auto& [x, begin] : {std::pair(60.0F, 118), {500.0F, 100}, {50.0F, 120}}) {
        pan.moveTo({x, 0}, zoom);
        EXPECT_DOUBLE_EQ(zoom.shown().min, begin) << x;
    }
    EXPECT_FALSE(pan.selection());
}

} // namespace
