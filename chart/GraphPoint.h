#pragma once

#include "chart/GraphElement.h"
#include "foundation/PackedDate.h"

class GraphPolyElement;

/// A value at a number or at a day: a corner of a line or polygon, or a disc that stands alone on a chart.
class GraphPoint final : public GraphElement {
public:
    static constexpr short kType = 3;

    GraphPoint() = default;
    GraphPoint(float x, float y) : x_(x), y_(y) {}
    /// Goes by the date.
    GraphPoint(const Date& x, float y) : y_(y), dateX_(x) { setDateBased(true); }
    ~GraphPoint() override;

    short getType() const override { return kType; }
    bool isUndefined() const override { return false; }

    float getX() const { return x_; }
    void setX(float x) { change(x_, x); }
    Date getDateX() const { return dateX_.date(); }
    void setDateX(const Date& date) { change(dateX_, PackedDate(date)); }
    float getY() const { return y_; }
    void setY(float y) { change(y_, y); }

    int setGraphPolyElement(GraphPolyElement* element);
    /// @return 0; -1 and a null `*out` when the point belongs to no line or polygon.
    int getGraphPolyElement(GraphPolyElement** out) const { return polyElement_.get(out); }
    /// The same; null when there is none.
    GraphPolyElement* polyElement() const { return polyElement_.partner(); }

private:
    friend class GraphLineToGraphPoints;
    friend class GraphPolygonToGraphPoints;
    /// The line that the point is on sorts its points again before the next read.
    template <class Coordinate>
    void change(Coordinate& coordinate, Coordinate value)
    {
        coordinate = value;
        notifyChange();
    }
    void notifyChange();

    float x_ = 0;
    float y_ = 0;
    PackedDate dateX_;
    GraphPointsToGraphPolyElement polyElement_;
};

/// Orders two places of an array of point pointers by x, ascending, for `qsort`: dates if both points are date based,
/// numbers if neither is, where one that is not a number comes last. A date based point and another compare equal.
int sortPointsByX(const void* a, const void* b);
