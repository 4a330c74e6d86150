#pragma once

#include "chart/GraphPoint.h"
#include "foundation/OneToManyAssociation.h"

#include <type_traits>

class GraphPolyElement;

/// The first of the least values, in the order of `points`, that `get` gives; a default value without points.
template <class Get>
auto smallest(const OneToManyAssociation<GraphPolyElement, GraphPoint>& points, Get get)
{
    using Value = std::decay_t<std::invoke_result_t<Get, const GraphPoint&>>;
    unsigned count;
    GraphPoint* const* all = points.getAll(&count);
    Value found = count > 0 ? (all[0]->*get)() : Value();
    for (unsigned i = 1; i < count; ++i)
        if (const Value value = (all[i]->*get)(); value < found)
            found = value;
    return found;
}

/// The same for the greatest value.
template <class Get>
auto largest(const OneToManyAssociation<GraphPolyElement, GraphPoint>& points, Get get)
{
    using Value = std::decay_t<std::invoke_result_t<Get, const GraphPoint&>>;
    unsigned count;
    GraphPoint* const* all = points.getAll(&count);
    Value found = count > 0 ? (all[0]->*get)() : Value();
    for (unsigned i = 1; i < count; ++i)
        if (const Value value = (all[i]->*get)(); value > found)
            found = value;
    return found;
}
