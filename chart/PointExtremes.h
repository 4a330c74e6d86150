#pragma once

#include "chart/GraphPoint.h"

#include <type_traits>

/// The first of the least values, in the order of the list `points`, that `get` gives; a default value without points.
template <class Points, class Get>
auto smallest(const Points& points, Get get)
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
template <class Points, class Get>
auto largest(const Points& points, Get get)
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
