#include "chart/GraphElement.h"

#include "chart/GraphView.h"

GraphElement::~GraphElement()
{
    setGraphView(nullptr);
}

int GraphElement::setGraphView(GraphView* view)
{
    return view_.set(this, view);
}
