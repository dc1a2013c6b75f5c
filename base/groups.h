#pragma once

#include "base/float4.h"

// Calls body(lanes, x) for the elements first <= x < end, four at a time, then one at a time for the remainder. The
// type of `lanes` is float4 or float and selects the width; its value is unused.
template <class Body>
inline void forGroups(int first, int end, Body body) {
    if (first >= end) return;
    const int groupsEnd = end - (end - first) % 4;
    int x = first;
    for (; x < groupsEnd; x += 4) body(float4{}, x);
    for (; x < end; ++x) body(0.0f, x);
}
