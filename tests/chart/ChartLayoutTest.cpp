#include "chart/ChartLayout.h"
#include "chart/ChartReadOut.h"
#include "chart/ColumnReduction.h"
#include "chart/DateTicks.h"
#include "chart/GraphLine.h"
#include "chart/GraphPoint.h"
#include "chart/ValueFormat.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <sstream>
#include <tuple>

namespace {

constexpr float kCharacter = 6;

float widthOf(const std::string& text)
{
    return kCharacter * static_cast<float>(text.size());
}

const ChartFont kFont{10, 9, 3, widthOf};
const ChartFont kLargeFont{24, 22, 6, [](const std::string& text) { return 2.3F * widthOf(text); }};

std::string joined(const std::vector<AxisTick>& ticks)
{
    std::string all;
    for (const AxisTick& tick : ticks)
        all += (all.empty() ? "" : " ") + tick.label;
    return all;
}

TEST(AxisTicksTest, NumbersAreMultiplesOfOneTwoOrFive)
{
    const struct {
        ChartRange range;
        double minStep;
        const char* labels;
    } cases[] = {
        {{0, 10}, 3, "0 5 10"},
        {{-0.25, 0.25}, 0.2, "-0.2 0.0 0.2"},
        {{0.001, 0.0042}, 0.0007, "0.001 0.002 0.003 0.004"},
        {{-130, 70}, 60, "-100 0"},
        {{2.1e-7, 4.2e-7}, 0.9e-7, "3e-07 4e-07"},
        {{1e15, 3.1e15}, 1e15, "1e+15 2e+15 3e+15"},
        {{12.345, 12.3452}, 0.0001, "12.3450 12.3451 12.3452"},
        {{3.1, 3.9}, 1, ""},
    };
    for (const auto& c : cases)
        EXPECT_EQ(joined(numberTicks(c.range, c.minStep)), c.labels) << c.range.min << ".." << c.range.max;
}

TEST(DateTicksTest, GoByTheFinestStepThatHasRoom)
{
    const struct {
        Date first, last;
        double pixels;
        const char* labels;
    } cases[] = {
        {{1, 3, 2004}, {3, 3, 2004}, 300, "1/3/2004 2/3/2004 3/3/2004"},
        {{27, 2, 2004}, {6, 3, 2004}, 350, "27/2/2004 29/2/2004 2/3/2004 4/3/2004 6/3/2004"},
        {{1, 3, 2004}, {31, 3, 2004}, 400, "1/3/2004 8/3/2004 15/3/2004 22/3/2004 29/3/2004"}, // Mondays
        {{2, 11, 2003}, {5, 3, 2004}, 300, "12/2003 1/2004 2/2004 3/2004"},
        {{2, 11, 2003}, {5, 3, 2005}, 350, "1/2004 4/2004 7/2004 10/2004 1/2005"},
        {{15, 6, 1996}, {15, 6, 2016}, 300, "2000 2005 2010 2015"},
        {{1, 1, 1}, {1, 1, 32767}, 400, "5000 10000 15000 20000 25000 30000"},
        {{5, 3, 2004}, {7, 3, 2004}, 60, "5/3/2004"},             // no round day in it
        {{5, 3, 2004}, {19, 3, 2004}, 120, "5/3/2004 19/3/2004"}, // Mondays would touch
    };
    for (const auto& c : cases) {
        const ChartRange range{dayNumber(c.first), dayNumber(c.last)};
        EXPECT_EQ(joined(levelDateTicks(range, c.pixels / range.length(), widthOf, 18)), c.labels)
            << c.first.toString().getCharacterArray() << ", " << c.pixels << " pixels";
    }
}

TEST(ValueFormatTest, ShowsAsManyDecimalsAsTellValuesApart)
{
    const struct {
        ChartRange range;
        double value;
        const char* text;
    } cases[] = {
        {{0.9, 1.35}, 1.2345, "1.234"},        {{38, 60}, 38.98, "38.98"},
        {{2000, 9000}, 8651.4, "8651.4"},      {{8651, 233840}, 233840.2, "233840"},
        {{0.0051, 0.0062}, 0.0062, "0.00620"}, {{2e-5, 4e-5}, 2e-5, "2.00e-05"},
        {{100, 100.01}, 100.005, "100.0050"},  {{0, 0}, 0, "0"},
        {{2e15, 4e15}, 4e15, "4.00e+15"},
    };
    for (const auto& c : cases)
        EXPECT_EQ(ValueFormat::forValues(c.range)(c.value), c.text) << c.range.min << ".." << c.range.max;
}

TEST(ColumnReductionTest, KeepsWhatCanBeSeenOfEachColumn)
{
    constexpr int kColumns = 50, kPoints = 100000;
    std::vector<ChartPoint> points;
    for (int i = 0; i < kPoints; ++i)
        points.push_back({i / double{kPoints}, std::sin(i * 0.7)});
    points[40321].y = 7; // one that a thinned out line would lose
    points[70001].y = -9;
    const ChartScale scale({0, 1}, {-10, 10}, {0, 0, kColumns, 100});
    const std::vector<BPoint> pixels = reduceByColumn(points, scale);
    EXPECT_LE(pixels.size(), std::size_t{4} * kColumns);
    EXPECT_EQ(pixels.front(), scale.pixel(points.front()));
    EXPECT_EQ(pixels.back(), scale.pixel(points.back()));
    for (const int i : {40321, 70001})
        EXPECT_NE(std::find(pixels.begin(), pixels.end(), scale.pixel(points[static_cast<std::size_t>(i)])),
                  pixels.end())
            << i;
    EXPECT_TRUE(std::is_sorted(pixels.begin(), pixels.end(), [](BPoint a, BPoint b) { return a.x < b.x; }));

    const std::vector<ChartPoint> few{{0, 0}, {0.001, 5}, {0.5, 1}, {0.9, 2}};
    EXPECT_EQ(reduceByColumn(few, scale).size(), few.size()) << "nothing to leave out";
}

TEST(ChartTextTest, IsShortenedByWholeCharacters)
{
    const std::string euros = "10 \xE2\x82\xAC\xE2\x82\xAC\xE2\x82\xAC";
    EXPECT_EQ(fitText(euros, kFont.width, widthOf(euros)), euros);
    EXPECT_EQ(fitText(euros, kFont.width, widthOf(euros) - 1), "10 \xE2\x82\xAC\xE2\x80\xA6");
    EXPECT_EQ(fitText(euros, kFont.width, kCharacter), "");
}

TEST(ChartSeriesTest, LeavesOutPointsWithoutPlace)
{
    GraphLine dated;
    const Date dates[] = {{1, 1, 2000}, {31, 4, 2000}, {}, {3, 1, 2000}, {2, 1, 2000}};
    for (const Date& date : dates) {
        auto* point = new GraphPoint(0, date.getDay() == 2 ? std::numeric_limits<float>::infinity() : 1.0F);
        point->setDateBased(true);
        point->setDateX(date);
        dated.addGraphPoint(point);
    }
    GraphLine tooShort;
    tooShort.addGraphPoint(new GraphPoint(1, 1));
    GraphElement* elements[] = {&tooShort, &dated};
    const std::vector<ChartSeries> series = seriesOf(elements, true);
    ASSERT_EQ(series.size(), 1U);
    ASSERT_EQ(series[0].points.size(), 2U);
    EXPECT_EQ(series[0].points[0].x, 0);
    EXPECT_EQ(series[0].points[1].x, 2);
    EXPECT_EQ(dateOfDay(2), Date(3, 1, 2000));
    EXPECT_EQ(dateOfDay(-1.5), Date(30, 12, 1999));
}

ChartContents contentsOf(const BRect& bounds, const std::vector<ChartPoint>& points, bool isDateBased)
{
    ChartContents contents;
    contents.bounds = bounds;
    contents.series.push_back({ChartSeries::Shape::kLine, {}, 2, "Quotes", points});
    contents.series.push_back({ChartSeries::Shape::kPolygon, {}, 2, "One standard deviation", points});
    contents.isDateBased = isDateBased;
    contents.xLegend = "Value in EUR";
    contents.yLegend = isDateBased ? "" : "Something of a long name, which may not fit";
    contents.labelFont = contents.legendFont = kFont;
    return contents;
}

std::vector<ChartText> textsOf(const ChartLayout& layout)
{
    std::vector<ChartText> texts = layout.labels;
    texts.insert(texts.end(), layout.legends.begin(), layout.legends.end());
    for (const ChartKeyEntry& entry : layout.key)
        texts.push_back(entry.name);
    for (const ChartMark& mark : layout.marks)
        if (!mark.label.text.empty())
            texts.push_back(mark.label);
    return texts;
}

bool isWithin(const BRect& inner, const BRect& outer)
{
    return inner.left >= outer.left && inner.top >= outer.top && inner.right <= outer.right &&
           inner.bottom <= outer.bottom;
}

bool isWithin(BPoint place, const BRect& outer)
{
    return isWithin(BRect(place.x, place.y, place.x, place.y), outer);
}

bool overlap(const BRect& a, const BRect& b)
{
    return a.left < b.right && b.left < a.right && a.top < b.bottom && b.top < a.bottom;
}

void expectReadable(const ChartContents& contents, const std::string& what)
{
    const ChartLayout layout = layOutChart(contents);
    const std::vector<ChartText> texts = textsOf(layout);
    for (std::size_t i = 0; i < texts.size(); ++i) {
        EXPECT_TRUE(isWithin(texts[i].box, contents.bounds)) << what << ": cut: " << texts[i].text;
        for (std::size_t k = 0; k < i; ++k)
            EXPECT_FALSE(overlap(texts[i].box, texts[k].box))
                << what << ": " << texts[i].text << " on " << texts[k].text;
    }
    EXPECT_TRUE(isWithin(layout.plot, contents.bounds)) << what;
    for (const ChartPoint& point : contents.series[0].points)
        EXPECT_TRUE(isWithin(layout.scale.pixel(point), layout.plot)) << what << ": " << point.x << ", " << point.y;
    for (const float x : layout.columns)
        EXPECT_TRUE(x >= layout.plot.left && x <= layout.plot.right) << what;
    if (contents.bounds.Width() >= 400 && contents.bounds.Height() >= 230 && contents.labelFont.size <= 12) {
        EXPECT_GE(layout.rows.size(), 2U) << what;
        EXPECT_GE(layout.columns.size(), 1U) << what;
        EXPECT_FALSE(layout.marks.at(0).label.text.empty()) << what;
    }
}

TEST(ChartLayoutTest, NoTextIsCutOrLiesOnAnother)
{
    constexpr double kFloatMax = std::numeric_limits<float>::max();
    const struct {
        const char* what;
        std::vector<ChartPoint> points;
    } data[] = {
        {"rise", {{0, 10}, {3, 12}, {30, 57}}},
        {"one value", {{0, 5}, {400, 5}}},
        {"one point", {{12, 0}}},
        {"below 0", {{0, -3e5}, {7000, -1e5}}},
        {"around 0", {{-20, -130}, {5000, 70}}},
        {"tiny", {{0, 1e-45}, {1, 3e-38}}},
        {"huge", {{-7e8, -kFloatMax}, {7e8, kFloatMax}}},
        {"close together", {{0, 16777216}, {1, 16777217}}},
        {"high and close", {{0, 1e30}, {3, 1e30 * (1 + 1e-7)}}},
        {"all days", {{-2147483648.0, 1}, {2147483647.0, 2}}},
    };
    const BRect sizes[] = {{0, 0, 780, 230}, {0, 0, 780, 360}, {0, 0, 400, 300}, {0, 0, 250, 150},
                           {0, 0, 160, 90},  {0, 0, 90, 200},  {0, 0, 60, 40},   {0, 0, 1, 1}};
    for (const auto& d : data)
        for (const BRect& size : sizes)
            for (const bool isDateBased : {true, false})
                for (const ChartFont& font : {kFont, kLargeFont}) {
                    ChartContents contents = contentsOf(size, d.points, isDateBased);
                    contents.labelFont = font;
                    std::ostringstream what;
                    what << d.what << (isDateBased ? ", dates, " : ", numbers, ") << size.right << 'x' << size.bottom
                         << ", labels " << font.size;
                    expectReadable(contents, what.str());
                }
}

TEST(ChartLayoutTest, MarksTheExtremesOfTheFirstLine)
{
    ChartContents contents = contentsOf({0, 0, 780, 230}, {{0, 30}, {1, 20}, {2, 40}}, true);
    contents.series[1].points = {{0, 5}, {1, 90}, {2, 5}};
    const ChartLayout layout = layOutChart(contents);
    ASSERT_EQ(layout.marks.size(), 2U);
    EXPECT_EQ(layout.marks[0].label.text, "40.00");
    EXPECT_LT(layout.marks[0].label.box.bottom, layout.marks[0].where.y);
    EXPECT_EQ(layout.marks[1].label.text, "20.00");
    EXPECT_GT(layout.marks[1].label.box.top, layout.marks[1].where.y);
}

TEST(ChartReadOutTest, SaysNameDateAndValueWithinTheChart)
{
    const BRect bounds(0, 0, 400, 200);
    const ChartScale scale({0, 100}, {0, 50}, {20, 20, 380, 180});
    GraphLine line;
    line.setLegend("Trend");
    const std::tuple<Date, float, const char*> cases[] = {
        {{1, 1, 2000}, 0.0125F, "Trend   01/01/2000   0.0125"},
        {{20, 2, 2000}, 49.99F, "Trend   20/02/2000   49.99"},
        {{20, 2, 2000}, 127129.3F, "Trend   20/02/2000   127,129.30"},
    };
    for (const auto& [date, value, text] : cases) {
        auto* point = new GraphPoint(7, value);
        point->setDateX(date);
        line.addGraphPoint(point);
        const ChartReadOut shown = layOutReadOut(*point, true, scale, kFont, bounds);
        EXPECT_EQ(shown.text.text, text);
        EXPECT_TRUE(isWithin({shown.box.left, 0, shown.box.right, 0}, bounds)) << text;
        EXPECT_FALSE(isWithin(shown.where, shown.box)) << "the point itself can be seen";
    }
    EXPECT_EQ(layOutReadOut(GraphPoint(3, 20), false, scale, kFont, bounds).text.text, "3.000   20.00");
}

} // namespace
