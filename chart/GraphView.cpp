#include "chart/GraphView.h"

#include "chart/ChartLayout.h"
#include "chart/ChartPainter.h"
#include "chart/GraphElement.h"
#include "chart/GraphPoint.h"

#include <algorithm>
#include <cmath>

namespace {

const BPoint kNoDataPlace(10, 20);

ChartFont fontOf(short size)
{
    BFont font = *be_plain_font;
    font.SetSize(std::max<short>(size, 1));
    font_height height;
    font.GetHeight(&height);
    return {font.Size(), height.ascent, height.descent,
            [font](const std::string& text) { return font.StringWidth(text.c_str()); }};
}

} // namespace

GraphView::GraphView(BRect frame, const char* name)
    : BView(frame, name, B_FOLLOW_ALL_SIDES, B_WILL_DRAW | B_FULL_UPDATE_ON_RESIZE), elements_(this)
{}

GraphView::~GraphView()
{
    removeAllGraphPoints();
    elements_.unlinkAll();
}

void GraphView::removeAllGraphPoints()
{
    for (unsigned i = 0; i < elements_.getNbr();) {
        GraphElement* element = elements_.at(i);
        if (element->getType() == GraphPoint::kType)
            delete element; // takes itself out, and another element takes its place
        else
            ++i;
    }
}

void GraphView::Draw(BRect)
{
    ChartPainter painter(*this, backgroundColor_);
    painter.fillBackground();
    const ChartContents contents = readContents();
    if (contents.series.empty()) {
        scale_.reset();
        painter.drawNotice("No data", kNoDataPlace, contents.legendFont.size);
        return;
    }
    const ChartLayout layout = layOutChart(contents);
    scale_ = layout.scale;
    painter.drawChart(layout, contents.series);
}

ChartContents GraphView::readContents() const
{
    unsigned count;
    GraphElement* const* elements = elements_.getAll(&count);
    return {Bounds(),
            seriesOf(elements, count, xDateBased_),
            xDateBased_,
            std::string(xLegend_.bytes()),
            std::string(yLegend_.bytes()),
            fontOf(minMaxSize_),
            fontOf(legendSize_)};
}

GraphPoint* GraphView::nearestPoint(BPoint where, float reach) const
{
    if (!scale_)
        return nullptr;
    GraphPoint* nearest = nullptr;
    unsigned count;
    GraphElement* const* elements = elements_.getAll(&count);
    for (unsigned i = 0; i < count; ++i) {
        unsigned n;
        GraphPoint* single;
        GraphPoint* const* points = pointsOf(*elements[i], &n, &single);
        for (unsigned k = 0; k < n && !elements[i]->isUndefined(); ++k) {
            const ChartPoint point = chartPointOf(*points[k], xDateBased_);
            const BPoint away = scale_->pixel(point) - where;
            const float distance = std::hypot(away.x, away.y);
            if (hasPlace(point) && distance <= reach && (nearest == nullptr || distance < reach)) {
                nearest = points[k];
                reach = distance;
            }
        }
    }
    return nearest;
}
