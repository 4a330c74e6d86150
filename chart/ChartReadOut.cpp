#include "chart/ChartReadOut.h"

#include "chart/ChartSeries.h"
#include "chart/GraphPoint.h"
#include "chart/GraphPolyElement.h"
#include "chart/ValueFormat.h"
#include "foundation/NumberText.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr float kPadding = 4;
constexpr float kDistance = 10; // from the point to the box
constexpr const char* kSpace = "   ";

/// Cents where they matter, and more digits of what is small.
std::string valueText(double value)
{
    constexpr double kCents = 10;
    return std::abs(value) >= kCents ? amountText(value) : ValueFormat::forValues({value, value})(value);
}

std::string textOf(const GraphPoint& point, const GraphElement& owner, bool isDateBased)
{
    std::string text = legendOf(owner);
    if (!text.empty())
        text += kSpace;
    text +=
        isDateBased ? std::string(point.getDateX().toString().bytes()) : valueText(static_cast<double>(point.getX()));
    return text + kSpace + valueText(static_cast<double>(point.getY()));
}

} // namespace

ChartReadOut layOutReadOut(const GraphPoint& point, bool isDateBased, const ChartScale& scale, const ChartFont& font,
                           const BRect& bounds)
{
    // A point on a line speaks for the line: it has that one's name and colour.
    const GraphPolyElement* line = point.polyElement();
    const GraphElement& owner = line != nullptr ? *line : static_cast<const GraphElement&>(point);
    const std::string text = fitText(textOf(point, owner, isDateBased), font.width, bounds.Width() - 2 * kPadding);
    const float width = font.width(text) + 2 * kPadding;
    const float height = std::ceil(font.height()) + 2 * kPadding;
    const BPoint where = scale.pixel(chartPointOf(point, isDateBased));
    // To the right above the point, unless the chart ends there.
    float left = where.x + kDistance;
    if (left + width > bounds.right)
        left = where.x - kDistance - width;
    float top = where.y - kDistance - height;
    if (top < bounds.top)
        top = where.y + kDistance;
    // On a chart smaller than the box the box begins at the left and ends at the bottom.
    left = std::floor(std::max(left, bounds.left));
    top = std::floor(std::min(top, bounds.bottom - height));
    return {where,
            owner.getColor(),
            {left, top, left + width, top + height},
            textAt(text, font, left + kPadding, top + kPadding)};
}
