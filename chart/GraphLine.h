#pragma once

#include "chart/GraphLineToGraphPoints.h"
#include "chart/GraphPoint.h"
#include "chart/GraphPolyElement.h"
#include "foundation/Date.h"

/// A line from point to point, in ascending x whatever the order in which they are added.
class GraphLine final : public GraphPolyElement {
public:
    static constexpr short kType = 1;

    GraphLine();
    ~GraphLine() override;

    short getType() const override { return kType; }
    /// True with fewer than two points.
    bool isUndefined() const override;
    int addGraphPoint(GraphPoint* point) override;
    int removeGraphPoint(GraphPoint* point) override;
    void graphPointChanged() override;
    void clearAll() override;

    /// The points by x; the array is the line's own and valid until its next change.
    GraphPoint** getAllGraphPoints(unsigned* count) const { return points_.getAll(count); }
    std::span<GraphPoint* const> points() const { return points_.all(); }
    unsigned getNbrGraphPoints() const { return points_.getNbr(); }

    // The extremes; 0, or the undefined date, of a line without points.
    float getMinX() const;
    float getMaxX() const;
    float getMinY() const;
    float getMaxY() const;
    Date getMinDateX() const;
    Date getMaxDateX() const;

private:
    const GraphPoint* first() const { return points_.at(0); }
    const GraphPoint* last() const { return points_.at(points_.getNbr() - 1); }

    GraphLineToGraphPoints points_;
};
