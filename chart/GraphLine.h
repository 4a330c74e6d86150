#pragma once

#include "chart/GraphPolyElement.h"

/// A line from point to point, in ascending x whatever the order in which they are added.
class GraphLine final : public GraphPointOwner<GraphLineToGraphPoints> {
public:
    static constexpr short kType = 1;

    short getType() const override { return kType; }
    /// True with fewer than two points.
    bool isUndefined() const override { return getNbrGraphPoints() < 2; }

    /// Whether a value stays the same up to the x of the next one, instead of going there in a straight line.
    void setStepped(bool isStepped) { isStepped_ = isStepped; }
    bool isStepped() const { return isStepped_; }

    float getMinX() const { return points().empty() ? 0 : points().front()->getX(); }
    float getMaxX() const { return points().empty() ? 0 : points().back()->getX(); }
    Date getMinDateX() const { return points().empty() ? Date() : points().front()->getDateX(); }
    Date getMaxDateX() const { return points().empty() ? Date() : points().back()->getDateX(); }

private:
    bool isStepped_ = false;
};
