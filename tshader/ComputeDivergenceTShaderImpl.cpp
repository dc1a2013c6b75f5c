#include "tshader/ComputeDivergenceTShaderImpl.h"

#include <algorithm>

#include "tshader/groups.h"

namespace {

template <class F>
F centralDifferences(F left, F right, F below, F above, float halfInvCellSize) {
    return (((right - left) + above) - below) * halfInvCellSize;
}

}  // namespace

void ComputeDivergenceTShaderImpl::shaderMain(const vec4& fragCoord, float& out) {
    const vec2 fragment = Vec2(fragCoord.x, fragCoord.y);
    const vec2 uv = fragment * InverseSize;
    const vec2 right = Vec2(InverseSize.x, 0.0f);
    const vec2 up = Vec2(0.0f, InverseSize.y);
    vec2 p = Scale * fragment;
    out = centralDifferences(
        texture2D(Velocity, uv - right).x, texture2D(Velocity, uv + right).x, texture2D(Velocity, uv - up).y,
        texture2D(Velocity, uv + up).y, HalfInvCellSize);
    if (distanceNoSqrt(center, p) < SourceRadius * SourceRadius) out = out - SourceStrength;
}

void ComputeDivergenceTShaderImpl::run() {
    if (output.empty()) return;
    const int width = output.width;
    const int height = output.height;
    const vec2 scale = Scale;
    const vec2 touch = center;
    const float halfInvCellSize = HalfInvCellSize;
    const float strength = SourceStrength;
    const float radiusSquared = SourceRadius * SourceRadius;

    for (int j = 0; j < height; ++j) {
        float* out = output.row(j);

        // By contract the disc is laid over texel corners: texel (0, 0) stands at screen (0, 0).
        const float dy = touch.y - scale.y * static_cast<float>(j);
        const bool reached = dy * dy < radiusSquared;
        const auto write = [=]<class F>(F divergence, int x) {
            if (reached) {
                const F dx = touch.x - scale.x * countUp<F>(x);
                divergence = dx * dx + dy * dy < radiusSquared ? divergence - strength : divergence;
            }
            store(divergence, out + x);
        };
        const auto border = [&](int i) {
            write(
                centralDifferences(
                    Velocity.clamped(i - 1, j).x, Velocity.clamped(i + 1, j).x, Velocity.clamped(i, j - 1).y,
                    Velocity.clamped(i, j + 1).y, halfInvCellSize),
                i);
        };
        int i = 0;
        if (j > 0 && j < height - 1) {
            const vec2* velocity = Velocity.row(j);
            const vec2* below = Velocity.row(j - 1);
            const vec2* above = Velocity.row(j + 1);
            border(i++);
            forGroups(1, width - 1, [=]<class F>(F, int x) {
                write(
                    centralDifferences(
                        loadPairs<F>(velocity + x - 1).x, loadPairs<F>(velocity + x + 1).x, loadPairs<F>(below + x).y,
                        loadPairs<F>(above + x).y, halfInvCellSize),
                    x);
            });
            i = std::max(i, width - 1);
        }
        for (; i < width; ++i) border(i);
    }
}
