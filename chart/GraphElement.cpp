#include "chart/GraphElement.h"

#include "chart/GraphView.h"

GraphElement::~GraphElement()
{
    // The chart does not list the element any more; it shows at the next drawing.
    setGraphView(nullptr);
}

int GraphElement::setGraphView(GraphView* view)
{
    return view_.set(this, view);
}
