#include "tshader/ComputeDivergenceTShaderImpl.h"

#include <algorithm>

#include "base/groups.h"
#include "tshader/pairs.h"

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

        // By contract the distance to the touch is measured from the texel's corner: texel (0, 0) is at screen (0, 0).
        const float dy = touch.y - scale.y * static_cast<float>(j);
        const bool reached = dy * dy < radiusSquared;
        const auto write = [=]<class F>(F divergence, int x) {
            if (reached) {
                const F dx = touch.x - scale.x * countUp<F>(x);
                divergence = dx * dx + dy * dy < radiusSquared ? divergence - strength : divergence;
            }
            store(divergence, out + x);
        };
        const vec2* velocity = Velocity.row(j);
        const vec2* below = Velocity.row(std::max(j - 1, 0));
        const vec2* above = Velocity.row(std::min(j + 1, height - 1));
        const auto texels = [=]<class F>(F, int left, int x, int right) {
            write(
                centralDifferences(
                    loadPairs<F>(velocity + left).x, loadPairs<F>(velocity + right).x, loadPairs<F>(below + x).y,
                    loadPairs<F>(above + x).y, halfInvCellSize),
                x);
        };
        texels(0.0f, 0, 0, std::min(1, width - 1));
        forGroups(1, width - 1, [=](auto lanes, int x) { texels(lanes, x - 1, x, x + 1); });
        if (width > 1) texels(0.0f, width - 2, width - 1, width - 1);
    }
}
