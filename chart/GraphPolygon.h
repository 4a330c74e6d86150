#pragma once

#include "chart/GraphPolyElement.h"

/// A filled shape, its points in the order in which they are added; the last one is joined to the first.
class GraphPolygon final : public GraphPointOwner<GraphPolygonToGraphPoints> {
public:
    static constexpr short kType = 2;

    short getType() const override { return kType; }
    /// True with fewer than three points.
    bool isUndefined() const override { return getNbrGraphPoints() < 3; }

    float getMinX() const { return extreme(&GraphPoint::getX, std::less<>()); }
    float getMaxX() const { return extreme(&GraphPoint::getX, std::greater<>()); }
    Date getMinDateX() const { return extreme(&GraphPoint::getDateX, std::less<>()); }
    Date getMaxDateX() const { return extreme(&GraphPoint::getDateX, std::greater<>()); }
};
