#pragma once

#include "chart/GraphPoint.h"
#include "foundation/String.h"

#include <functional>
#include <type_traits>

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

/// What lines and polygons have alike. `Points` is their list of points, which is empty again before it dies.
template <class Points>
class GraphPointOwner : public GraphPolyElement {
public:
    GraphPointOwner() : points_(this) {}
    ~GraphPointOwner() override { points_.deleteAll(); }

    int addGraphPoint(GraphPoint* point) override
    {
        const int failure = points_.add(point);
        // Whether a point stands behind the others may be known only when its date flag is set, which it does not
        // report.
        points_.changeNotice();
        return failure;
    }
    int removeGraphPoint(GraphPoint* point) override { return points_.remove(point); }
    void graphPointChanged() override { points_.changeNotice(); }
    void clearAll() override { points_.deleteAll(); }

    /// The points in their order; the array is the element's own and valid until its next change.
    GraphPoint** getAllGraphPoints(unsigned* count) const { return points_.getAll(count); }
    std::span<GraphPoint* const> points() const { return points_.all(); }
    unsigned getNbrGraphPoints() const { return points_.getNbr(); }

    /// 0 without points, as all extremes are; the undefined date where they are dates.
    float getMinY() const { return extreme(&GraphPoint::getY, std::less<>()); }
    float getMaxY() const { return extreme(&GraphPoint::getY, std::greater<>()); }

protected:
    /// The first of the values that `get` gives which no later one exceeds by `exceeds`; a default value without
    /// points.
    template <class Get, class Exceeds>
    auto extreme(Get get, Exceeds exceeds) const
    {
        std::decay_t<std::invoke_result_t<Get, const GraphPoint&>> found{};
        if (!points().empty())
            found = (points().front()->*get)();
        for (const GraphPoint* point : points())
            if (const auto value = (point->*get)(); exceeds(value, found))
                found = value;
        return found;
    }

private:
    Points points_;
};
