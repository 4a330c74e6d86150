#include "chart/GraphPolygon.h"

#include "chart/GraphPoint.h"
#include "chart/PointExtremes.h"

GraphPolygon::GraphPolygon() : points_(this) {}

GraphPolygon::~GraphPolygon()
{
    points_.deleteAll();
}

bool GraphPolygon::isUndefined() const
{
    return getNbrGraphPoints() < 3;
}

int GraphPolygon::addGraphPoint(GraphPoint* point)
{
    return points_.add(point);
}

int GraphPolygon::removeGraphPoint(GraphPoint* point)
{
    return points_.remove(point);
}

void GraphPolygon::graphPointChanged()
{
    points_.changeNotice();
}

void GraphPolygon::clearAll()
{
    points_.deleteAll();
}

float GraphPolygon::getMinX() const
{
    return smallest(points_, &GraphPoint::getX);
}

float GraphPolygon::getMaxX() const
{
    return largest(points_, &GraphPoint::getX);
}

float GraphPolygon::getMinY() const
{
    return smallest(points_, &GraphPoint::getY);
}

float GraphPolygon::getMaxY() const
{
    return largest(points_, &GraphPoint::getY);
}

Date GraphPolygon::getMinDateX() const
{
    return smallest(points_, &GraphPoint::getDateX);
}

Date GraphPolygon::getMaxDateX() const
{
    return largest(points_, &GraphPoint::getDateX);
}
