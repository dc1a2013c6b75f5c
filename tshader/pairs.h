// Pair<F> holds one or four vec2 values as a structure of arrays: all x components in one F, all y components in
// another.
#pragma once

#include "base/float4.h"
#include "tshader/vec.h"

template <class F>
struct Pair {
    F x, y;
};

template <class F>
inline Pair<F> loadPairs(const vec2* from);

template <>
inline Pair<float> loadPairs<float>(const vec2* from) {
    return {from->x, from->y};
}

template <>
inline Pair<float4> loadPairs<float4>(const vec2* from) {
    const float4 first = load<float4>(&from[0].x);
    const float4 second = load<float4>(&from[2].x);
    return {evenLanes(first, second), oddLanes(first, second)};
}

inline float4 firstTwo(Pair<float4> value) {
    return __builtin_shufflevector(value.x, value.y, 0, 4, 1, 5);
}

inline float4 lastTwo(Pair<float4> value) {
    return __builtin_shufflevector(value.x, value.y, 2, 6, 3, 7);
}

inline void storePairs(Pair<float> value, vec2* to) {
    *to = vec2{value.x, value.y};
}

inline void storePairs(Pair<float4> value, vec2* to) {
    store(firstTwo(value), &to[0].x);
    store(lastTwo(value), &to[2].x);
}

// to = from - value, without deinterleaving `from`.
inline void subtractPairs(const vec2* from, Pair<float> value, vec2* to) {
    *to = vec2{from->x - value.x, from->y - value.y};
}

inline void subtractPairs(const vec2* from, Pair<float4> value, vec2* to) {
    store(load<float4>(&from[0].x) - firstTwo(value), &to[0].x);
    store(load<float4>(&from[2].x) - lastTwo(value), &to[2].x);
}
