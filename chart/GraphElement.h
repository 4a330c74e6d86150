#pragma once

#include "chart/GraphLinks.h"
#include "platform/GraphicsDefs.h"

/// Something that a chart shows: a line, a polygon or a point.
///
/// Belongs to at most one chart, and leaves it when it dies. A chart does not notice changes of its elements: whoever
/// makes them has it drawn again.
class GraphElement {
public:
    GraphElement(const GraphElement&) = delete;
    GraphElement& operator=(const GraphElement&) = delete;
    virtual ~GraphElement();

    /// 1 line, 2 polygon, 3 point.
    virtual short getType() const = 0;
    /// True when there is too little to be drawn.
    virtual bool isUndefined() const = 0;

    /// Whether the element's points go by their date instead of their number. Each point has a flag of its own, to be
    /// set like that of its line or polygon.
    void setDateBased(bool dateBased) { dateBased_ = dateBased; }
    bool isDateBased() const { return dateBased_; }
    /// The colour to draw in. Alpha 1 to 254 lets shine through what lies behind the area of a polygon; 0 and 255 both
    /// cover. Lines and points always cover.
    void setColor(rgb_color color) { color_ = color; }
    rgb_color getColor() const { return color_; }
    /// The width of the line, in pixels; a point is drawn as a disc in proportion to it.
    void setPenSize(short penSize) { penSize_ = penSize; }
    short getPenSize() const { return penSize_; }
    int setGraphView(GraphView* view);
    /// @return 0; -1 and a null `*out` when no chart shows the element.
    int getGraphView(GraphView** out) const { return view_.get(out); }

protected:
    GraphElement() = default;

private:
    friend class GraphViewToGraphElements;

    rgb_color color_;
    short penSize_ = 2;
    bool dateBased_ = false;
    GraphElementsToGraphView view_;
};
