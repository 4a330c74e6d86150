#pragma once

#include "foundation/OneToManyAssociation.h"

class GraphPoint;
class GraphPolyElement;

/// A line's points, by x. The other end is `GraphPointsToGraphPolyElement`.
class GraphLineToGraphPoints final
    : public OneToManyAssociation<GraphLineToGraphPoints, GraphPolyElement, GraphPoint, true> {
public:
    using OneToManyAssociation::OneToManyAssociation;
    static auto& link(auto& point) { return point.polyElement_; }
    /// `sortPointsByX` for a list that may hold dates and numbers, which that takes for equal: then nothing would come
    /// before or behind anything for sure. Here the numbers come first.
    static int compare(const void* a, const void* b);
};
