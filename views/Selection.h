#pragma once

#include <algorithm>
#include <vector>

/// What is selected in a list, each of which is an `Object`, as a new array that the caller deletes. `*n` becomes their
/// number.
template <class Object, class Listed>
Object** newArrayOf(const std::vector<Listed*>& selected, int* n)
{
    auto** array = new Object*[selected.size()];
    std::ranges::transform(selected, array, [](Listed* object) { return static_cast<Object*>(object); });
    *n = static_cast<int>(selected.size());
    return array;
}
