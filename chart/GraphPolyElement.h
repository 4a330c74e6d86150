#pragma once

#include "chart/GraphElement.h"
#include "foundation/String.h"

class GraphPoint;

/// An element made of points, which it owns.
class GraphPolyElement : public GraphElement {
public:
    /// Takes ownership of `point`, which leaves its former line or polygon.
    virtual int addGraphPoint(GraphPoint* point) = 0;
    /// Gives `point` back to the caller.
    virtual int removeGraphPoint(GraphPoint* point) = 0;
    /// To be called when the coordinates of a point have changed; points do so themselves.
    virtual void graphPointChanged() = 0;
    /// Destroys all points.
    virtual void clearAll() = 0;

    /// The name of the element in the chart's key. An element without one, as at first, does not appear there.
    void setLegend(const String& legend) { legend_ = legend; }
    const String& getLegend() const { return legend_; }

private:
    String legend_;
};
