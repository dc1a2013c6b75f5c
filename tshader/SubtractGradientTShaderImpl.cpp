#include "tshader/SubtractGradientTShaderImpl.h"

#include <algorithm>

#include "base/groups.h"
#include "tshader/pairs.h"

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
        const float* pressure = Pressure.row(j);
        const float* below = Pressure.row(std::max(j - 1, 0));
        const float* above = Pressure.row(std::min(j + 1, height - 1));
        const auto texels = [=]<class F>(F, int left, int x, int right) {
            const auto slope = gradient(
                load<F>(pressure + left), load<F>(pressure + right), load<F>(below + x), load<F>(above + x), scale);
            subtractPairs(velocity + x, slope, out + x);
        };
        texels(0.0f, 0, 0, std::min(1, width - 1));
        forGroups(1, width - 1, [=](auto lanes, int x) { texels(lanes, x - 1, x, x + 1); });
        if (width > 1) texels(0.0f, width - 2, width - 1, width - 1);
    }
}
