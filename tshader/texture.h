// Texture is a non-owning view of a CPU image; row 0 is the bottom row. Two samplers read it.
#pragma once

#include <cstddef>

#include "base/float4.h"
#include "tshader/vec.h"

template <class T>
struct Texture {
    T* data = nullptr;  // texel (i, j) is data[j * width + i]
    int width = 0;
    int height = 0;

    T* row(int j) const { return data + static_cast<std::ptrdiff_t>(j) * width; }

    bool empty() const { return data == nullptr || width <= 0 || height <= 0; }
};

// NaN fails the first comparison and gives 0, so it never becomes an index.
template <class F>
inline F clampToUnit(F c) {
    return lesser(greater(c, F{}), F{} + 1.0f);
}

template <class F, class T>
inline T bilinear(T t00, T t10, T t01, T t11, F tx, F ty) {
    return (1.0f - tx) * (1.0f - ty) * t00 + tx * (1.0f - ty) * t10 + (1.0f - tx) * ty * t01 + tx * ty * t11;
}

// By contract coordinate 0 is the centre of the first texel and 1 the centre of the last. A sample at (i + 0.5) / width
// therefore blends texel i with a neighbour.
template <class T>
inline T texture2DLinear(Texture<T> t, vec2 c) {
    if (t.empty()) return T{};
    const float fx = static_cast<float>(static_cast<double>(t.width - 1) * clampToUnit(c.x));
    const float fy = static_cast<float>(static_cast<double>(t.height - 1) * clampToUnit(c.y));
    const int x0 = static_cast<int>(fx);
    const int y0 = static_cast<int>(fy);
    const int x1 = x0 < t.width - 1 ? x0 + 1 : t.width - 1;
    const int y1 = y0 < t.height - 1 ? y0 + 1 : t.height - 1;
    const float tx = fx - static_cast<float>(x0);
    const float ty = fy - static_cast<float>(y0);
    return bilinear(t.row(y0)[x0], t.row(y0)[x1], t.row(y1)[x0], t.row(y1)[x1], tx, ty);
}

template <class T>
inline T texture2D(Texture<T> t, vec2 c) {
    if (t.empty()) return T{};
    const float fx = static_cast<float>(t.width - 1) * clampToUnit(c.x);
    const float fy = static_cast<float>(t.height - 1) * clampToUnit(c.y);
    const int i = static_cast<int>(static_cast<double>(fx) + 0.5);
    const int j = static_cast<int>(static_cast<double>(fy) + 0.5);
    return t.row(j)[i];
}
