#include "chart/GraphElement.h"

#include "chart/GraphView.h"

GraphElement::~GraphElement()
{
    setGraphView(nullptr);
}

ManyToOneAssociation<GraphElement, GraphView>& GraphViewToGraphElements::backLink(GraphElement& e) const
{
    return e.view_;
}

int GraphElementsToGraphView::xAdd(GraphView* partner)
{
    return partner->addGraphElement(owner());
}

int GraphElementsToGraphView::xRemove(GraphView* partner)
{
    return partner->removeGraphElement(owner());
}
