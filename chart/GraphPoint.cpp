#include "chart/GraphPoint.h"

#include "chart/GraphPolyElement.h"

#include <cmath>

GraphPoint::~GraphPoint()
{
    // Leaves the line or polygon that owns it, which does not destroy it a second time.
    setGraphPolyElement(nullptr);
}

void GraphPoint::notifyChange()
{
    // The line sorts its points before the next read; a polygon and a point that stands alone keep no order.
    if (GraphPolyElement* element = polyElement_.partner())
        element->graphPointChanged();
}

int sortPointsByX(const void* a, const void* b)
{
    const GraphPoint& first = **static_cast<GraphPoint* const*>(a);
    const GraphPoint& second = **static_cast<GraphPoint* const*>(b);
    if (first.isDateBased() != second.isDateBased())
        return 0;
    if (first.isDateBased())
        return first.getDateX() > second.getDateX() ? 1 : first.getDateX() < second.getDateX() ? -1 : 0;
    // A number that is none is neither above nor below any other, and would leave the order open.
    if (std::isnan(first.getX()) || std::isnan(second.getX()))
        return static_cast<int>(std::isnan(first.getX())) - static_cast<int>(std::isnan(second.getX()));
    return first.getX() > second.getX() ? 1 : first.getX() < second.getX() ? -1 : 0;
}

int GraphLineToGraphPoints::compare(const void* a, const void* b)
{
    const GraphPoint& first = **static_cast<GraphPoint* const*>(a);
    const GraphPoint& second = **static_cast<GraphPoint* const*>(b);
    if (first.isDateBased() != second.isDateBased())
        return first.isDateBased() ? 1 : -1;
    return sortPointsByX(a, b);
}

int GraphPoint::setGraphPolyElement(GraphPolyElement* element)
{
    return polyElement_.set(this, element);
}
