#pragma once

#include "foundation/OneToManyAssociation.h"

class GraphLine;
class GraphPoint;
class GraphPolyElement;

/// A line's points, by x. The other end is `GraphPointsToGraphPolyElement`.
class GraphLineToGraphPoints final : public OneToManyAssociation<GraphPolyElement, GraphPoint> {
public:
    explicit GraphLineToGraphPoints(GraphLine* owner);

private:
    ManyToOneAssociation<GraphPoint, GraphPolyElement>& backLink(GraphPoint& e) const override;
};
