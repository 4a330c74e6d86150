#pragma once

#include "chart/GraphPoint.h"
#include "chart/GraphPolyElement.h"
#include "chart/GraphPolygonToGraphPoints.h"
#include "foundation/Date.h"

/// A filled shape, its points in the order in which they are added; the last one is joined to the first.
class GraphPolygon final : public GraphPolyElement {
public:
    static constexpr short kType = 2;

    GraphPolygon();
    ~GraphPolygon() override;

    short getType() const override { return kType; }
    /// True with fewer than three points.
    bool isUndefined() const override;
    int addGraphPoint(GraphPoint* point) override;
    int removeGraphPoint(GraphPoint* point) override;
    void graphPointChanged() override;
    void clearAll() override;

    /// The points in their order; the array is the polygon's own and valid until its next change.
    GraphPoint** getAllGraphPoints(unsigned* count) const { return points_.getAll(count); }
    std::span<GraphPoint* const> points() const { return points_.all(); }
    unsigned getNbrGraphPoints() const { return points_.getNbr(); }

    // The extremes; 0, or the undefined date, of a polygon without points.
    float getMinX() const;
    float getMaxX() const;
    float getMinY() const;
    float getMaxY() const;
    Date getMinDateX() const;
    Date getMaxDateX() const;

private:
    GraphPolygonToGraphPoints points_;
};
