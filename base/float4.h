// float4 is a SIMD vector of four floats. The compiler provides + - * /, comparisons and the lane-wise ternary for it
// on SSE, NEON and WebAssembly SIMD, and broadcasts a plain float operand. A formula that is a template over `float`
// and `float4` therefore computes one texel or four with the same source text.
#pragma once

#include <cmath>
#include <cstring>

#if defined(__SSE__)
#include <xmmintrin.h>
#endif

#if defined(__FINITE_MATH_ONLY__) && __FINITE_MATH_ONLY__
#error "The kernels rely on NaN failing comparisons; with -ffinite-math-only a NaN would become a texel index."
#endif

typedef float float4 __attribute__((vector_size(16)));
typedef int int4 __attribute__((vector_size(16)));

// memcpy, because rows have no alignment guarantee.
template <class F>
inline F load(const float* from) {
    F value;
    std::memcpy(&value, from, sizeof value);
    return value;
}

template <class F>
inline void store(F value, float* to) {
    std::memcpy(to, &value, sizeof value);
}

// a < b ? a : b and a > b ? a : b: the result is b if either operand is NaN. g++ does not compile the ternary to
// minps and maxps, hence the intrinsics.
inline float lesser(float a, float b) {
    return a < b ? a : b;
}

inline float greater(float a, float b) {
    return a > b ? a : b;
}

inline float4 lesser(float4 a, float4 b) {
#if defined(__SSE__)
    return _mm_min_ps(a, b);
#else
    return a < b ? a : b;
#endif
}

inline float4 greater(float4 a, float4 b) {
#if defined(__SSE__)
    return _mm_max_ps(a, b);
#else
    return a > b ? a : b;
#endif
}

inline float4 evenLanes(float4 a, float4 b) {
    return __builtin_shufflevector(a, b, 0, 2, 4, 6);
}

inline float4 oddLanes(float4 a, float4 b) {
    return __builtin_shufflevector(a, b, 1, 3, 5, 7);
}

// Returns first, first + 1, ... in the lanes. Exact below 2^24.
template <class F>
inline F countUp(int first);

template <>
inline float countUp<float>(int first) {
    return static_cast<float>(first);
}

template <>
inline float4 countUp<float4>(int first) {
    return static_cast<float>(first) + float4{0.0f, 1.0f, 2.0f, 3.0f};
}

// Rounds toward zero. Undefined for values outside the range of int.
inline int toInt(float value) {
    return static_cast<int>(value);
}

inline int4 toInt(float4 value) {
    return __builtin_convertvector(value, int4);
}

inline float toFloat(int value) {
    return static_cast<float>(value);
}

inline float4 toFloat(int4 value) {
    return __builtin_convertvector(value, float4);
}

inline float squareRoot(float value) {
    return std::sqrt(value);
}

inline float4 squareRoot(float4 value) {
    return float4{std::sqrt(value[0]), std::sqrt(value[1]), std::sqrt(value[2]), std::sqrt(value[3])};
}
