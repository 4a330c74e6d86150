#pragma once

#include "foundation/OneToManyAssociation.h"

class GraphPoint;
class GraphPolyElement;
class GraphPolygon;

/// A polygon's points, in the order in which they were added. The other end is `GraphPointsToGraphPolyElement`.
class GraphPolygonToGraphPoints final : public OneToManyAssociation<GraphPolyElement, GraphPoint> {
public:
    explicit GraphPolygonToGraphPoints(GraphPolygon* owner);

private:
    ManyToOneAssociation<GraphPoint, GraphPolyElement>& backLink(GraphPoint& e) const override;
};
