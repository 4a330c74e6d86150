#pragma once

#include "foundation/OneToManyAssociation.h"

class GraphElement;
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
