#include "tshader/JacobiTShaderImpl.h"

#include <algorithm>

#include "base/groups.h"

namespace {

// (left + right + below + above + alpha * divergence) * inverseBeta
template <class F>
F relax(F left, F right, F below, F above, F divergence, float alpha, float inverseBeta) {
    return ((((left + right) + below) + above) + alpha * divergence) * inverseBeta;
}

}  // namespace

void JacobiTShaderImpl::shaderMain(const vec4& fragCoord, float& out) {
    const vec2 uv = Vec2(fragCoord.x, fragCoord.y) * InverseSize;
    const vec2 right = Vec2(InverseSize.x, 0.0f);
    const vec2 up = Vec2(0.0f, InverseSize.y);
    out = relax(
        texture2D(Pressure, uv - right), texture2D(Pressure, uv + right), texture2D(Pressure, uv - up),
        texture2D(Pressure, uv + up), texture2D(Divergence, uv), Alpha, InverseBeta);
}

void JacobiTShaderImpl::run() {
    if (output.empty()) return;
    // Local copies: the compiler must assume that a store to the output changes a field of this object.
    const Texture<float> source = Pressure;
    const Texture<float> divergences = Divergence;
    const Texture<float> result = output;
    const int width = result.width;
    const int height = result.height;
    const float alpha = Alpha;
    const float inverseBeta = InverseBeta;

    std::fill_n(result.row(0), width, 0.0f);
    std::fill_n(result.row(height - 1), width, 0.0f);
    for (int j = 1; j < height - 1; ++j) {
        const float* pressure = source.row(j);
        const float* below = source.row(j - 1);
        const float* above = source.row(j + 1);
        const float* divergence = divergences.row(j);
        float* out = result.row(j);

        out[0] = 0.0f;
        forGroups(1, width - 1, [=]<class F>(F, int i) {
            store(
                relax(
                    load<F>(pressure + i - 1), load<F>(pressure + i + 1), load<F>(below + i), load<F>(above + i),
                    load<F>(divergence + i), alpha, inverseBeta),
                out + i);
        });
        out[width - 1] = 0.0f;
    }
}
