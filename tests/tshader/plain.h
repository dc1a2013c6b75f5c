// The velocity kernels as the plainest loops over one texel at a time, to hold the grouped passes against.
#pragma once

#include <algorithm>
#include <cmath>
#include <random>
#include <span>
#include <vector>

#include "tshader/AddVelocityTShaderImpl.h"
#include "tshader/AdvectVelocityTShaderImpl.h"
#include "tshader/ComputeDivergenceTShaderImpl.h"
#include "tshader/JacobiTShaderImpl.h"
#include "tshader/SubtractGradientTShaderImpl.h"

// A texture with memory of its own, between NaNs that no pass may overwrite and that show wherever one is read.
template <class T>
struct Image : Texture<T> {
    static constexpr std::size_t kGuard = 400;
    std::size_t size;
    std::vector<float> memory;

    Image(int w, int h)
        : size(static_cast<std::size_t>(w * h) * (sizeof(T) / 4)), memory(size + 2 * kGuard, std::nanf("")) {
        *static_cast<Texture<T>*>(this) = {reinterpret_cast<T*>(memory.data() + kGuard), w, h};
        fill(0.0f);
    }
    Image(const Image&) = delete;
    std::span<float> floats() { return std::span(memory).subspan(kGuard, size); }
    T& at(int i, int j) { return this->row(j)[i]; }
    void fill(float value) { std::ranges::fill(floats(), value); }
    void randomize(unsigned seed) {
        std::mt19937 bits(seed);
        std::ranges::generate(floats(), [&] { return std::uniform_real_distribution<float>(-20.0f, 20.0f)(bits); });
    }
    bool guardsIntact() const {
        return std::ranges::count_if(memory, [](float f) { return std::isnan(f); }) == 2 * kGuard;
    }
};

namespace plain {

template <class T>
inline T at(const Texture<T>& t, int i, int j) {
    return t.data[std::clamp(j, 0, t.height - 1) * t.width + std::clamp(i, 0, t.width - 1)];
}

inline float squared(vec2 v) {
    return v.x * v.x + v.y * v.y;
}

inline vec2 linear(const Texture<vec2>& t, vec2 c) {
    const auto place = [](float x, int size) {
        return static_cast<float>((size - 1) * static_cast<double>(x > 0.0f ? std::min(x, 1.0f) : 0.0f));
    };
    const vec2 f = {place(c.x, t.width), place(c.y, t.height)};
    const int x = static_cast<int>(f.x), y = static_cast<int>(f.y);
    const float tx = f.x - static_cast<float>(x), ty = f.y - static_cast<float>(y);
    return (1 - tx) * (1 - ty) * at(t, x, y) + tx * (1 - ty) * at(t, x + 1, y) + (1 - tx) * ty * at(t, x, y + 1) +
           tx * ty * at(t, x + 1, y + 1);
}

template <class T, class Formula>
inline void everyTexel(const Texture<T>& output, T* out, Formula formula) {
    for (int j = 0; j < output.height; ++j)
        for (int i = 0; i < output.width; ++i)
            out[j * output.width + i] = formula(i, j, Vec2(static_cast<float>(i), static_cast<float>(j)));
}

inline void run(const AdvectVelocityTShaderImpl& k, vec2* out) {
    everyTexel(k.output, out, [&](int i, int j, vec2 texel) {
        const vec2 u = at(k.VelocityTexture, i, j);
        vec2 s = linear(k.SourceTexture, ((texel - k.TimeStep * u) + Vec2(0.5f)) * k.InverseSize);
        if (k.drag > 0 && squared(k.center - k.Scale * texel) < 625.0f) {
            s = s + (static_cast<float>(k.drag) - 1.5f) * k.delta;
        }
        return s * k.Dissipation;
    });
}

inline void run(const AddVelocityTShaderImpl& k, vec2* out) {
    everyTexel(k.output, out, [&](int i, int j, vec2 texel) {
        const vec2 u = at(k.Velocity, i, j);
        const vec2 p = (texel + Vec2(0.5f)) * k.Scale;
        const vec2 ahead = k.normal * (p - k.previous);
        const float t = ahead.x + ahead.y;
        const vec2 q = k.previous + t * k.normal;
        const float d = std::sqrt(squared(p - q));
        return t > 0.0f && t < k.len && d < k.Radius ? u + d * (0.1f * (p - q) + 0.1f * (k.current - q)) : u;
    });
}

inline void run(const ComputeDivergenceTShaderImpl& k, float* out) {
    everyTexel(k.output, out, [&](int i, int j, vec2 texel) {
        const Texture<vec2>& v = k.Velocity;
        const float x = at(v, i + 1, j).x - at(v, i - 1, j).x;
        const float div = ((x + at(v, i, j + 1).y) - at(v, i, j - 1).y) * k.HalfInvCellSize;
        const bool inside = squared(k.center - k.Scale * texel) < k.SourceRadius * k.SourceRadius;
        return inside ? div - k.SourceStrength : div;
    });
}

inline void run(const JacobiTShaderImpl& k, float* out) {
    everyTexel(k.output, out, [&](int i, int j, vec2) {
        if (i == 0 || j == 0 || i == k.output.width - 1 || j == k.output.height - 1) return 0.0f;
        const Texture<float>& p = k.Pressure;
        const float sum = ((at(p, i - 1, j) + at(p, i + 1, j)) + at(p, i, j - 1)) + at(p, i, j + 1);
        return (sum + k.Alpha * at(k.Divergence, i, j)) * k.InverseBeta;
    });
}

inline void run(const SubtractGradientTShaderImpl& k, vec2* out) {
    everyTexel(k.output, out, [&](int i, int j, vec2) {
        const Texture<float>& p = k.Pressure;
        const vec2 gradient = {at(p, i + 1, j) - at(p, i - 1, j), at(p, i, j + 1) - at(p, i, j - 1)};
        return at(k.Velocity, i, j) - gradient * k.GradientScale;
    });
}

}  // namespace plain
