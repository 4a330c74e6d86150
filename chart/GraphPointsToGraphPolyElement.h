#pragma once

#include "foundation/ManyToOneAssociation.h"

class GraphPoint;
class GraphPolyElement;

/// The point's link to the line or polygon that owns it: the counterpart of `GraphLineToGraphPoints` and of
/// `GraphPolygonToGraphPoints`, which it reaches through the element's own operations.
class GraphPointsToGraphPolyElement final
    : public ManyToOneAssociation<GraphPointsToGraphPolyElement, GraphPoint, GraphPolyElement, true> {
public:
    static int enter(auto& element, GraphPoint* point) { return element.addGraphPoint(point); }
    static int leave(auto& element, GraphPoint* point) { return element.removeGraphPoint(point); }
};
