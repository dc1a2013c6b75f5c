#include "tshader/SubtractGradientTShaderImpl.h"

#include <algorithm>

#include "tshader/groups.h"

namespace {

template <class F>
Pair<F> gradient(F left, F right, F below, F above, float scale) {
    return {(right - left) * scale, (above - below) * scale};
}

}  // namespace

void SubtractGradientTShaderImpl::shaderMain(const vec4& fragCoord, vec2& out) {
    const vec2 uv = Vec2(fragCoord.x, fragCoord.y) * InverseSize;
    const vec2 right = Vec2(InverseSize.x, 0.0f);
    const vec2 up = Vec2(0.0f, InverseSize.y);
    const vec2 gradient = Vec2(
        texture2D(Pressure, uv + right) - texture2D(Pressure, uv - right),
        texture2D(Pressure, uv + up) - texture2D(Pressure, uv - up));
    out = texture2D(Velocity, uv) - gradient * GradientScale;
}

void SubtractGradientTShaderImpl::run() {
    if (output.empty()) return;
    const int width = output.width;
    const int height = output.height;
    const float scale = GradientScale;

    for (int j = 0; j < height; ++j) {
        const vec2* velocity = Velocity.row(j);
        vec2* out = output.row(j);
        const auto border = [&](int i) {
            const auto slope = gradient(
                Pressure.clamped(i - 1, j), Pressure.clamped(i + 1, j), Pressure.clamped(i, j - 1),
                Pressure.clamped(i, j + 1), scale);
            subtractPairs(velocity + i, slope, out + i);
        };
        int i = 0;
        if (j > 0 && j < height - 1) {
            const float* pressure = Pressure.row(j);
            const float* below = Pressure.row(j - 1);
            const float* above = Pressure.row(j + 1);
            border(i++);
            forGroups(1, width - 1, [=]<class F>(F, int x) {
                const auto slope = gradient(
                    load<F>(pressure + x - 1), load<F>(pressure + x + 1), load<F>(below + x), load<F>(above + x),
                    scale);
                subtractPairs(velocity + x, slope, out + x);
            });
            i = std::max(i, width - 1);
        }
        for (; i < width; ++i) border(i);
    }
}
