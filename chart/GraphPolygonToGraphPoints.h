#pragma once

#include "foundation/OneToManyAssociation.h"

class GraphPoint;
class GraphPolyElement;

/// A polygon's points, in the order in which they were added. The other end is `GraphPointsToGraphPolyElement`.
class GraphPolygonToGraphPoints final
    : public OneToManyAssociation<GraphPolygonToGraphPoints, GraphPolyElement, GraphPoint> {
public:
    using OneToManyAssociation::OneToManyAssociation;
    static auto& link(auto& point) { return point.polyElement_; }
};
