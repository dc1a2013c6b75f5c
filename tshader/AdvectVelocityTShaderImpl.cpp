#include "tshader/AdvectVelocityTShaderImpl.h"

#include "base/groups.h"
#include "tshader/pairs.h"

namespace {

// A drag changes the velocity within this distance of the touch, screen pixels.
constexpr float kDragRadius = 25.0f;

// Returns the velocity that a drag adds near the touch: by contract -delta / 2 for a medium drag and +delta / 2 for a
// fast one.
vec2 dragPush(int drag, const vec2& delta) {
    return (static_cast<float>(drag) - 1.5f) * delta;
}

// Loads texels[at] and texels[at + 1] for each lane of `at`.
inline void gatherNeighbours(const vec2* texels, int4 at, Pair<float4>& left, Pair<float4>& right) {
    const float4 a = load<float4>(&texels[at[0]].x);
    const float4 b = load<float4>(&texels[at[1]].x);
    const float4 c = load<float4>(&texels[at[2]].x);
    const float4 d = load<float4>(&texels[at[3]].x);
    const float4 leftAB = __builtin_shufflevector(a, b, 0, 4, 1, 5);
    const float4 leftCD = __builtin_shufflevector(c, d, 0, 4, 1, 5);
    const float4 rightAB = __builtin_shufflevector(a, b, 2, 6, 3, 7);
    const float4 rightCD = __builtin_shufflevector(c, d, 2, 6, 3, 7);
    left.x = __builtin_shufflevector(leftAB, leftCD, 0, 1, 4, 5);
    left.y = __builtin_shufflevector(leftAB, leftCD, 2, 3, 6, 7);
    right.x = __builtin_shufflevector(rightAB, rightCD, 0, 1, 4, 5);
    right.y = __builtin_shufflevector(rightAB, rightCD, 2, 3, 6, 7);
}

inline Pair<float> sample(Texture<vec2> source, Pair<float> c) {
    const vec2 s = texture2DLinear(source, Vec2(c.x, c.y));
    return {s.x, s.y};
}

// texture2DLinear at four points of a source that is at least two texels wide. One load reads both texels of a row, so
// a sample in the last column reads the pair to its left with weights 0 and 1; the last row works the same way. A texel
// of weight 0 affects the result only if it is not finite, and no frame leaves such a velocity.
inline Pair<float4> sample(Texture<vec2> source, Pair<float4> c) {
    const float lastX = static_cast<float>(source.width - 1);
    const float lastY = static_cast<float>(source.height - 1);
    const bool oneRow = source.height == 1;
    const float4 fx = lastX * clampToUnit(c.x);
    const float4 fy = lastY * clampToUnit(c.y);
    // A comparison gives -1 in the lanes where it is true.
    const int4 x0 = toInt(fx) + (fx >= lastX);
    const int4 y0 = toInt(fy) + (fy >= (oneRow ? 1.0f : lastY));
    const int4 at = y0 * source.width + x0;
    Pair<float4> t00, t10, t01, t11;
    gatherNeighbours(source.data, at, t00, t10);
    gatherNeighbours(source.data + (oneRow ? 0 : source.width), at, t01, t11);
    const float4 tx = fx - toFloat(x0);
    const float4 ty = fy - toFloat(y0);
    return {bilinear(t00.x, t10.x, t01.x, t11.x, tx, ty), bilinear(t00.y, t10.y, t01.y, t11.y, tx, ty)};
}

}  // namespace

void AdvectVelocityTShaderImpl::shaderMain(const vec4& fragCoord, vec2& out) {
    const vec2 fragment = Vec2(fragCoord.x, fragCoord.y);
    const vec2 u = texture2D(VelocityTexture, InverseSize * fragment);
    vec2 s = texture2DLinear(SourceTexture, InverseSize * (fragment - u * TimeStep));
    vec2 p = Scale * fragment;
    if (drag > 0 && distance(center, p) < kDragRadius) s = s + dragPush(drag, delta);
    out = s * Dissipation;
}

void AdvectVelocityTShaderImpl::run() {
    if (output.empty()) return;
    const int width = output.width;
    const int height = output.height;
    const Texture<vec2> source = SourceTexture;
    const vec2 inverseSize = InverseSize;
    const vec2 scale = Scale;
    const float timeStep = TimeStep;
    const float dissipation = Dissipation;
    const vec2 touch = center;
    const bool dragged = drag > 0;
    const vec2 push = dragPush(drag, delta);

    for (int j = 0; j < height; ++j) {
        const vec2* velocity = VelocityTexture.row(j);
        vec2* out = output.row(j);
        const float y = static_cast<float>(j);

        // By contract the distance to the touch is measured from the texel's corner: texel (0, 0) is at screen (0, 0).
        const float dy = touch.y - scale.y * y;
        const bool reached = dragged && dy * dy < kDragRadius * kDragRadius;
        forGroups(0, width, [=]<class F>(F, int i) {
            const F x = countUp<F>(i);
            const Pair<F> u = loadPairs<F>(velocity + i);
            Pair<F> s = sample(
                source,
                Pair<F>{((x - timeStep * u.x) + 0.5f) * inverseSize.x, ((y - timeStep * u.y) + 0.5f) * inverseSize.y});
            if (reached) {
                const F dx = touch.x - scale.x * x;
                const auto near = dx * dx + dy * dy < kDragRadius * kDragRadius;
                s = {near ? s.x + push.x : s.x, near ? s.y + push.y : s.y};
            }
            storePairs(Pair<F>{s.x * dissipation, s.y * dissipation}, out + i);
        });
    }
}
