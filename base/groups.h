#pragma once

#include "base/float4.h"

// Walks the elements first <= x < end in groups of four and the rest one by one: calls body(lanes, x), where the type
// of `lanes`, float4 or float, says how many elements to work on.
template <class Body>
inline void forGroups(int first, int end, Body body) {
    if (first >= end) return;
    const int groupsEnd = end - (end - first) % 4;
    int x = first;
    for (; x < groupsEnd; x += 4) body(float4{}, x);
    for (; x < end; ++x) body(0.0f, x);
}
