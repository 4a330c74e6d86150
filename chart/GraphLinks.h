#pragma once

#include "foundation/OneToManyAssociation.h"

// The relations of a chart: both ends of each.

class GraphElement;
class GraphPoint;
class GraphPolyElement;
class GraphView;

/// The elements that a chart shows, in the order in which they were added.
class GraphViewToGraphElements final : public OneToManyAssociation<GraphViewToGraphElements, GraphView, GraphElement> {
public:
    using OneToManyAssociation::OneToManyAssociation;
    static auto& link(auto& element) { return element.view_; }
};

/// The element's link to the chart that shows it.
class GraphElementsToGraphView final : public ManyToOneAssociation<GraphElementsToGraphView, GraphElement, GraphView> {
public:
    static auto& list(auto& view) { return view.elements_; }
};

/// A line's points, by x.
class GraphLineToGraphPoints final
    : public OneToManyAssociation<GraphLineToGraphPoints, GraphPolyElement, GraphPoint, true> {
public:
    using OneToManyAssociation::OneToManyAssociation;
    static auto& link(auto& point) { return point.polyElement_; }
    /// `sortPointsByX` for a list that may hold dates and numbers, which that takes for equal: then nothing would come
    /// before or behind anything for sure. Here the numbers come first.
    static int compare(const void* a, const void* b);
};

/// A polygon's points, in the order in which they were added.
class GraphPolygonToGraphPoints final
    : public OneToManyAssociation<GraphPolygonToGraphPoints, GraphPolyElement, GraphPoint> {
public:
    using OneToManyAssociation::OneToManyAssociation;
    static auto& link(auto& point) { return point.polyElement_; }
};

/// The point's link to the line or polygon that owns it, which it reaches through the element's own operations.
class GraphPointsToGraphPolyElement final
    : public ManyToOneAssociation<GraphPointsToGraphPolyElement, GraphPoint, GraphPolyElement, true> {
public:
    static int enter(auto& element, GraphPoint* point) { return element.addGraphPoint(point); }
    static int leave(auto& element, GraphPoint* point) { return element.removeGraphPoint(point); }
};
