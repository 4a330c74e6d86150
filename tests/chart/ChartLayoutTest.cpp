#include "chart/ChartLayout.h"
#include "chart/ChartReadOut.h"
#include "chart/ColumnReduction.h"
#include "chart/DateTicks.h"
#include "chart/GraphLine.h"
#include "chart/GraphPoint.h"
#include "chart/GraphPolygon.h"
#include "chart/ValueFormat.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <sstream>

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

TEST(ChartSeriesTest, LinesStepsAndOutlinesAreCutAtTheRange)
{
    GraphLine line, steps;
    GraphPolygon band;
    steps.setStepped(true);
    for (const BPoint p : {BPoint(0, 0), BPoint(10, 10), BPoint(20, 10), BPoint(30, 40)}) {
        line.addGraphPoint(new GraphPoint(p.x, p.y));
        steps.addGraphPoint(new GraphPoint(p.x, p.y));
    }
    for (const BPoint p : {BPoint(0, 0), BPoint(30, 0), BPoint(30, 3), BPoint(0, 3)})
        band.addGraphPoint(new GraphPoint(p.x, p.y));
    GraphElement* elements[] = {&line, &steps, &band};
    const struct {
        ChartRange range;
        const char* points; // of each series, and how many of these are the first line's own
    } cases[] = {
        {{0, 30}, "0,0 10,10 20,10 30,40 | 0,0 10,0 10,10 20,10 30,10 30,40 | 0,0 30,0 30,3 0,3 | 4"},
        {{5, 25}, "5,5 10,10 20,10 25,25 | 5,0 10,0 10,10 20,10 25,10 | 5,0 25,0 25,3 5,3 | 2"},
        {{12, 14}, "12,10 14,10 | 12,10 14,10 | 12,0 14,0 14,3 12,3 | 0"},
        {{10, 20}, "10,10 20,10 | 10,0 10,10 20,10 | 10,0 20,0 20,3 10,3 | 2"},
        {{31, 40}, ""},
    };
    for (const auto& c : cases) {
        std::ostringstream text;
        const std::vector<ChartSeries> part = cropped(seriesOf(elements, false), c.range);
        for (const ChartSeries& series : part) {
            for (const ChartPoint& point : series.points)
                text << point.x << ',' << point.y << ' ';
            text << "| ";
        }
        if (!part.empty())
            text << part[0].ownPoints().size();
        EXPECT_EQ(text.str(), c.points) << c.range.min;
    }
    const std::vector<ChartSeries> all = seriesOf(elements, false);
    EXPECT_EQ(valueAt(all[0], 25), 25);
    EXPECT_EQ(valueAt(all[1], 25), 10);
    EXPECT_EQ(valueAt(all[1], 30), 40) << "from its day on";
    EXPECT_EQ(valueAt(all[0], 31), std::nullopt);
}

TEST(ChartReadOutTest, SaysDayValuesAndFlagsWithinTheChart)
{
    ChartContents contents = contentsOf({0, 0, 400, 200}, {{0, 0.0125}, {50, 49.99}, {100, 127129.3}}, true);
    contents.series.pop_back();
    contents.series.push_back({ChartSeries::Shape::kLine, {}, 2, "Trend", {{0, 10}, {100, 20}}});
    const ChartFlag flags[] = {{ChartFlag::Shape::kDiamond, {24, 4, 2000}, "after the end"},
                               {ChartFlag::Shape::kUp, {22, 2, 2000}, "Bought"},
                               {ChartFlag::Shape::kUp, {22, 2, 2000}, "more"},
                               {ChartFlag::Shape::kUp, {1, 1, 1999}, "too far away"}};
    contents.flags = placeFlags(flags, contents.series[0]);
    ASSERT_EQ(contents.flags.size(), 3U);
    EXPECT_EQ(contents.flags.back().where.y, 127129.3);
    contents.x = {0, 114};
    const ChartLayout layout = layOutChart(contents);
    const struct {
        double pointer;
        const char* texts;
    } cases[] = {
        {-90, "01/01/2000 Quotes 0.0125 Trend 10.00"},
        {47, "20/02/2000 Quotes 49.99 Trend 15.00"},
        {54, "22/02/2000 Quotes 5,133.16 Trend 15.20 Bought more"}, // a flag is near
        {100, "10/04/2000 Quotes 127,129.30 Trend 20.00"},
        {115, "24/04/2000 after the end"},
    };
    for (const auto& c : cases) {
        const auto x = readOutPlace(contents, c.pointer, 3);
        ASSERT_TRUE(x);
        const ChartReadOut shown = layOutReadOut(contents, layout, *x, readOutRows(contents, *x));
        std::string all;
        for (const ChartText& text : shown.texts) {
            all += (all.empty() ? "" : " ") + text.text;
            EXPECT_TRUE(isWithin(text.box, shown.box)) << text.text;
        }
        EXPECT_EQ(all, c.texts);
        EXPECT_TRUE(isWithin(shown.box, contents.bounds)) << all;
        EXPECT_TRUE(shown.x < shown.box.left || shown.x > shown.box.right) << all;
    }
    EXPECT_EQ(nextReadOutPlace(contents, 50, false), 52) << "flags have their turn";
    EXPECT_EQ(nextReadOutPlace(contents, 0, true), 0);
}

} // namespace
