#include "chart/GraphLine.h"

#include "chart/GraphPoint.h"
#include "chart/PointExtremes.h"

GraphLine::GraphLine() : points_(this) {}

GraphLine::~GraphLine()
{
    points_.deleteAll();
}

bool GraphLine::isUndefined() const
{
    return getNbrGraphPoints() < 2;
}

int GraphLine::addGraphPoint(GraphPoint* point)
{
    const int failure = points_.add(point);
    // Whether a point stands behind the others may be known only when its date flag is set, which it does not report.
    points_.changeNotice();
    return failure;
}

int GraphLine::removeGraphPoint(GraphPoint* point)
{
    return points_.remove(point);
}

void GraphLine::graphPointChanged()
{
    points_.changeNotice();
}

void GraphLine::clearAll()
{
    points_.deleteAll();
}

float GraphLine::getMinX() const
{
    const GraphPoint* point = first();
    return point != nullptr ? point->getX() : 0;
}

float GraphLine::getMaxX() const
{
    const GraphPoint* point = last();
    return point != nullptr ? point->getX() : 0;
}

float GraphLine::getMinY() const
{
    return smallest(points_, &GraphPoint::getY);
}

float GraphLine::getMaxY() const
{
    return largest(points_, &GraphPoint::getY);
}

Date GraphLine::getMinDateX() const
{
    const GraphPoint* point = first();
    return point != nullptr ? point->getDateX() : Date();
}

Date GraphLine::getMaxDateX() const
{
    const GraphPoint* point = last();
    return point != nullptr ? point->getDateX() : Date();
}

int GraphLineToGraphPoints::compare(const void* a, const void* b)
{
    const GraphPoint* first = *static_cast<GraphPoint* const*>(a);
    const GraphPoint* second = *static_cast<GraphPoint* const*>(b);
    if (first->isDateBased() != second->isDateBased())
        return first->isDateBased() ? 1 : -1;
    return sortPointsByX(a, b);
}
