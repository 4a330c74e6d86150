#pragma once

#include "foundation/ManyToOneAssociation.h"

class GraphPoint;
class GraphPolyElement;

/// The point's link to the line or polygon that owns it: the counterpart of `GraphLineToGraphPoints` and of
/// `GraphPolygonToGraphPoints`, which it reaches through the element's own operations.
class GraphPointsToGraphPolyElement final : public ManyToOneAssociation<GraphPoint, GraphPolyElement> {
public:
    using ManyToOneAssociation::ManyToOneAssociation;

private:
    int xAdd(GraphPolyElement* partner) override;
    int xRemove(GraphPolyElement* partner) override;
};
