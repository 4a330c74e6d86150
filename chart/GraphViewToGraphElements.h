#pragma once

#include "foundation/OneToManyAssociation.h"

class GraphElement;
class GraphView;

/// The elements that a chart shows, in the order in which they were added.
class GraphViewToGraphElements final : public OneToManyAssociation<GraphView, GraphElement> {
public:
    using OneToManyAssociation::OneToManyAssociation;

private:
    ManyToOneAssociation<GraphElement, GraphView>& backLink(GraphElement& e) const override;
};

/// The element's link to the chart that shows it.
class GraphElementsToGraphView final : public ManyToOneAssociation<GraphElement, GraphView> {
public:
    using ManyToOneAssociation::ManyToOneAssociation;

private:
    int xAdd(GraphView* partner) override;
    int xRemove(GraphView* partner) override;
};
